#!/usr/bin/python3
"""The real program against the real `ktr serve`, without a display: what is live moves, and every fault of the service leaves
the last words where they are."""

import concurrent.futures
import fcntl
import json
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import time
import unittest

from serve import Service

PROGRAM = os.environ["KTR_PROGRAM"]
SOURCE = pathlib.Path(os.environ["KTR_SOURCE"])


def place(at, label, latitude=51.45):
    return {"at": at, "latitude": latitude, "longitude": -2.6, "label": label, "city": "Bristol"}


def person(first, last, track, **more):
    return {"fullName": f"{first} {last}", "firstName": first, "lastName": last, "track": track, "repeats": False,
            "emails": [f"{first.lower()}@harbour.example"], **more}


def moving(at):
    """Whoever asks before that second of the service sees Ann at Home, and afterwards elsewhere."""
    return [person("Ann", "Marsh", [place(0, "Home"), place(at, "Fish Market", 51.46)]),
            person("Otto", "Brandt", [place(0, "Work")])]


MOVING = moving(2)


class LiveTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def serve(self, friends, *options, timeout=600):
        """A service with these friends; gives the environment of a program that uses it."""
        folder = pathlib.Path(tempfile.mkdtemp(dir=self.folder))
        (folder / "friends.json").write_text(json.dumps({"timeoutSeconds": timeout, "friends": friends}))
        service = Service(PROGRAM, "--friends", folder / "friends.json", "--write-config", folder / "config.json",
                          *map(str, options))
        self.addCleanup(service.__exit__)
        environment = {k: v for k, v in os.environ.items() if k not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM")}
        return {**environment, "KTR_CONFIG": str(folder / "config.json"), "XDG_STATE_HOME": str(folder / "state")}

    def run_live(self, environment, command, seconds, *arguments, question="Where are my friends?"):
        ask = [] if question is None else ["--ask", question]
        begin = time.monotonic()
        result = subprocess.run([PROGRAM, command, "--live", f"{seconds}s", *ask, "--language", "en-GB", *map(str, arguments)],
                                env=environment, capture_output=True, timeout=seconds + 60, text=True, encoding="utf-8")
        result.seconds = time.monotonic() - begin
        return result

    def describe(self, friends, seconds, *options, question="Where are my friends?", timeout=600):
        return self.run_live(self.serve(friends, *options, timeout=timeout), "describe", seconds, question=question)

    def test_friends_move(self):
        result = self.describe(MOVING, 3, "--interval", "0.4")
        self.assertEqual(result.returncode, 0, result.stderr)
        self.assertIn("Ann Marsh, Place: Fish Market", result.stdout)
        self.assertIn("Otto Brandt, Place: Work", result.stdout)
        self.assertRegex(result.stdout, r"At \d?\d:\d\d Ann Marsh was at home\. At \d?\d:\d\d Otto Brandt was at work\.")
        self.assertIn("Live · updated just now", result.stderr)
        self.assertRegex(result.stderr, r"the service was asked: [2-9]\d* answers, 0 failures")

    def test_picture_shows_where_they_have_moved_to(self):
        environment = self.serve(moving(6), "--interval", "0.4")
        before, after = self.folder / "before.png", self.folder / "after.png"
        self.assertEqual(self.run_live(environment, "render", 0.1, "-o", before).returncode, 0)
        self.assertEqual(self.run_live(environment, "render", 8, "-o", after).returncode, 0)
        self.assertNotEqual(before.read_bytes(), after.read_bytes())

    def snippet_of(self, friends, timeout=60000):
        """A list of these, of whom nothing is known."""
        scenario = self.folder / "list.json"
        context = f"ktrServerContext://serverContext?minCallbackIntervalInMS=300&callbackTimeoutIntervalInMS={timeout}&"
        scenario.write_text(json.dumps({"clock": "2001-05-16T17:42:00+01:00", "sentence": "Here they are.", "snippet": {
            "kind": "VAKtrLocationSnippet", "proximity": "friends", "searchContext": context, "locations": [
                {"friend": {"data": one["emails"][0], "object": {
                    "fullName": one["fullName"], "emails": [{"emailAddress": one["emails"][0]}]}}} for one in friends]}}))
        return scenario

    def snippet_of_ann(self):
        """An answer that asks the service twice after 0.3 seconds, and then as the service says."""
        scenario = self.folder / "ann.json"
        context = "ktrServerContext://serverContext?minCallbackIntervalInMS=300&callbackTimeoutIntervalInMS=60000&"
        scenario.write_text(json.dumps({"clock": "2001-05-16T17:42:00+01:00", "sentence": "Here is Ann.", "snippet": {
            "kind": "VAKtrLocationSnippet", "proximity": "here", "searchContext": context, "locations": [
                {"friend": {"object": {"fullName": "Ann Marsh", "emails": [{"emailAddress": "ann@harbour.example"}]}}}]}}))
        return scenario

    def test_one_friend_is_on_a_map_that_follows(self):
        walk = [person("Ann", "Marsh", [{"at": at, "latitude": latitude, "longitude": -3.1162, "label": label, "accuracy": 30}
                                        for at, latitude, label in ((0, 50.2117, "Home"), (2, 50.2133, "Fish Market"))])]
        result = self.describe(walk, 3, "--interval", "0.4", "--positions", SOURCE / "resources/scenarios/single.json",
                               question="where is ann")
        self.assertEqual(result.returncode, 0, result.stderr)
        self.assertRegex(result.stdout, r"\nMap: Ann Marsh, Fish Market\. Accurate to (30 metres|33 yards)\. .+ of you \(link\)")

    def test_scenario_is_asked_about_at_the_service(self):
        result = self.run_live(self.serve(MOVING), "describe", 2, self.snippet_of_ann(), question=None)
        self.assertEqual(result.returncode, 0, result.stderr)
        self.assertRegex(result.stdout, r"Ann Marsh, Place: (Home|Fish Market), (.*, )?Located now")

    def test_question_that_is_not_understood_gets_its_sentence(self):
        result = self.describe(MOVING, 0.2, question="Tell me a joke")
        self.assertEqual(result.returncode, 0, result.stderr)
        self.assertIn("I didn’t understand that.", result.stdout)
        self.assertIn("Where is Ann? (link)", result.stdout)
        self.assertNotIn("Friends", result.stdout)

    def test_looking_for_friends_becomes_none_found(self):
        nobody = [person("Zofia", "Wrona", []), person("Kwame", "Asare", [])]
        result = self.describe(nobody, 0.3)
        self.assertIn("I can’t see where any of your friends are.", result.stdout)
        self.assertNotIn("Friends", result.stdout, "no card where there is nothing to show")
        looked_for = self.snippet_of(nobody, timeout=500)
        self.assertIn("Finding your friends…", self.run_live(self.serve(nobody, "--interval", "60"), "describe", 0.3,
                                                             looked_for, question=None).stdout)
        # The answer comes after the asking has ended, and is the last.
        result = self.run_live(self.serve(nobody, "--interval", "0.3", "--fault", "delay=0.6", timeout=0.5), "describe", 2,
                               looked_for, question=None)
        self.assertIn("No friends found there.", result.stdout)

    def test_friend_appears_once_found(self):
        late = [person("Kwame", "Asare", [place(0, "Home")], locatedAfter=1.5), person("Zofia", "Wrona", [])]
        result = self.run_live(self.serve(late, "--interval", "0.3"), "describe", 3, self.snippet_of(late), question=None)
        self.assertIn("Kwame Asare, Place: Home", result.stdout)

    # Faults: words of the fault, what the status line says at the end, what is on screen at the end.
    WAS, IS = "Ann Marsh, Place: Home", "Ann Marsh, Place: Fish Market"
    OFFLINE = r"Offline\. Showing what was known at \d?\d:\d\d"
    FAULTY = r"Service error\. Showing what was known at \d?\d:\d\d"
    LIVE = "Live · updated just now"
    FAULTS = {
        "slow answers": ("delay=0.5", LIVE, IS),
        "cut before the answer": ("cut=before", OFFLINE, WAS),
        "cut after the headers": ("cut=headers", FAULTY, WAS),
        "cut in the body": ("cut=body", FAULTY, WAS),
        "credentials refused": ("status=401", "Sign in again to see your friends", WAS),
        "forbidden": ("status=403", FAULTY, WAS),
        "server error": ("status=500", FAULTY, WAS),
        "unavailable later": ("status=503,at=3", FAULTY, None),
        "redirect to itself": ("redirect={origin}{path},count=1", LIVE, IS),
        "redirect for ever": ("redirect={origin}{path}", FAULTY, WAS),
        "redirect elsewhere": ("redirect=https://127.0.0.1:{port}{path}", FAULTY, WAS),
        "redirect without encryption": ("redirect=http://localhost:{port}{path}", FAULTY, WAS),
        "redirect that makes a GET": ("redirect={origin}{path},redirectStatus=302", FAULTY, WAS),
        "no JSON": ("body=not-json", FAULTY, WAS),
        "a list": ("body=array", FAULTY, WAS),
        "a million brackets": ("body=deep", FAULTY, WAS),
        "an endless body": ("body=endless", None, WAS),
        "an empty body": ("body=empty", FAULTY, WAS),
        "a truncated body": ("body=truncated", FAULTY, WAS),
        "a slow body": ("bytesPerSecond=20", LIVE, WAS),
        "an object of nothing": ("text={}", None, "Finding your friends…"),
        "half of the friends": ("statusCode=416", LIVE, IS),
        "nobody is reported": ("entryStatus=411", LIVE, "Finding your friends…"),
        "one is not reported": ("entryStatus=411,entry=ann@harbour.example", LIVE, "Otto Brandt, Place: Work"),
        "asking ends": ("interval=0", "Paused · updated just now", None),
        "asking goes on in an hour": ("interval=3600", LIVE, None),
    }

    def check_fault(self, name):
        words, status, shown = self.FAULTS[name]
        # Nobody may be so slow as to ask only after Ann has moved: four ask at once, perhaps under a sanitizer.
        # The question itself is answered.
        words += "" if "at=" in words else ",at=2"
        result = self.describe(moving(7), 9, "--interval", "0.4", "--fault", words)
        told = f"{name}\n{result.stdout}\n{result.stderr}"
        assert result.returncode == 0, told
        assert result.seconds < 40.0, told
        assert "Where are my friends?" in result.stdout, told
        assert shown is None or shown in result.stdout, told
        last = result.stderr.rstrip().rsplit("ktr: ", 1)[-1]
        assert status is None or re.search(status, result.stderr), told
        assert status is None or re.match(status, last) or last.startswith("the service was asked"), told

    def test_every_fault_leaves_the_last_words(self):
        with concurrent.futures.ThreadPoolExecutor(4) as pool:
            for name, check in [(name, pool.submit(self.check_fault, name)) for name in self.FAULTS]:
                with self.subTest(name):
                    check.result()

    def test_service_that_ends_leaves_the_last_words(self):
        friends = self.folder / "friends.json"
        friends.write_text(json.dumps({"friends": MOVING}))
        config = self.folder / "config.json"
        service = Service(PROGRAM, "--friends", friends, "--write-config", config, "--interval", "0.3")
        self.addCleanup(service.__exit__)
        environment = {**os.environ, "KTR_CONFIG": str(config), "XDG_STATE_HOME": str(self.folder / "state")}
        program = subprocess.Popen([PROGRAM, "describe", "--live", "3s", "--ask", "Where are my friends?"], env=environment,
                                   stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True, encoding="utf-8")
        first = program.stderr.readline()
        self.assertIn("Live", first)
        service.end()
        told, rest = program.communicate(timeout=30)
        self.assertEqual(program.returncode, 0)
        self.assertIn("Ann Marsh", told)
        self.assertIn("Offline. Showing what was known at", rest)

    def shard(self, *options):
        """Another host of the same service, at a port of its own."""
        shard = Service(PROGRAM, "--ca-dir", str(self.folder / "ca"), "--friends", self.folder / "shard.json", *options)
        self.addCleanup(shard.__exit__)
        return shard

    def serve_with_shard(self, shard, *options):
        """The account's own service, which may lead commands to the shard; gives it and the environment of a program."""
        config = self.folder / "config.json"
        service = Service(PROGRAM, "--ca-dir", str(self.folder / "ca"), "--friends", self.folder / "shard.json",
                          "--write-config", config, "--interval", "60", *options)
        self.addCleanup(service.__exit__)
        written = json.loads(config.read_text())
        written["account"]["domains"] = [f"localhost:{shard.port}"]
        config.write_text(json.dumps(written))
        return service, {**os.environ, "KTR_CONFIG": str(config), "XDG_STATE_HOME": str(self.folder / "state")}

    def remembered(self):
        file = self.folder / "state" / "ktr" / "preferences" / "org.ktr.snippets.json"
        return json.loads(file.read_text()).get("RedirectedHostKey") if file.exists() else None

    def told(self, environment):
        """The last words of the status line once a snippet has asked, with both its starts in one request: the second joins
        the first while that is under way."""
        return self.run_live(environment, "describe", 1.5, self.snippet_of_ann(), question=None).stderr

    def commands(self, service):
        return [line for line in service.end()[1] if "getlocations" in line]

    def test_redirect_is_remembered_by_the_next_program_until_another_host_answers(self):
        (self.folder / "shard.json").write_text(json.dumps({"friends": MOVING}))
        # An answer that takes its time is waited for by both starts.
        shard = self.shard("--fault", "delay=0.3,count=2", "--fault", "status=401,at=3,delay=0.3")
        redirect = f"redirect=https://localhost:{shard.port}{{path}},count=1,delay=0.3"
        service, environment = self.serve_with_shard(shard, "--fault", redirect, "--fault", "delay=0.3")
        self.assertIn("Live", self.told(environment))
        self.assertEqual(self.remembered(), f"localhost:{shard.port}")
        self.assertIn("Live", self.told(environment))
        self.assertEqual(self.remembered(), f"localhost:{shard.port}")
        self.assertIn("Sign in again", self.told(environment))
        self.assertEqual(self.remembered(), f"localhost:{shard.port}", "the account's own host has not been asked yet")
        self.assertIn("Live", self.told(environment))
        self.assertIsNone(self.remembered())
        self.assertEqual(len(self.commands(shard)), 3)
        self.assertEqual(len(self.commands(service)), 2)

    def test_exit_is_not_held_up_by_a_lock_held_elsewhere(self):
        (self.folder / "shard.json").write_text(json.dumps({"friends": MOVING}))
        shard = self.shard()
        redirect = f"redirect=https://localhost:{shard.port}{{path}}"
        _, environment = self.serve_with_shard(shard, "--fault", redirect)
        lock = self.folder / "state" / "ktr" / "preferences" / "org.ktr.snippets.json.lock"
        lock.parent.mkdir(parents=True)
        with lock.open("w") as held:
            fcntl.flock(held, fcntl.LOCK_EX)
            result = self.run_live(environment, "describe", 1.5, self.snippet_of_ann(), question=None)
        self.assertEqual(result.returncode, 0, result.stderr)
        self.assertIn("Ann Marsh", result.stdout)
        self.assertIn("another process holds the lock", result.stderr)
        # It waits five seconds for the lock, once.
        self.assertLess(result.seconds, 9)
        self.assertIsNone(self.remembered())
        self.assertIn("Live", self.told(environment))
        self.assertEqual(self.remembered(), f"localhost:{shard.port}", "with the lock free it is kept")

    def test_remembered_host_that_cannot_prove_itself_hears_nothing_and_is_forgotten(self):
        (self.folder / "shard.json").write_text(json.dumps({"friends": MOVING}))
        for kind in ("expired", "wrong-host", "foreign"):
            with self.subTest(kind):
                shard = self.shard("--certificate", kind)
                service, environment = self.serve_with_shard(shard, "--fault", "delay=0.3")
                file = self.folder / "state" / "ktr" / "preferences" / "org.ktr.snippets.json"
                file.parent.mkdir(parents=True, exist_ok=True)
                file.write_text(json.dumps({"RedirectedHostKey": f"localhost:{shard.port}"}))
                self.assertIn("Live", self.told(environment))
                self.assertIsNone(self.remembered())
                self.assertIn("Live", self.told(environment))
                self.assertEqual(self.commands(shard), [])
                self.assertEqual(len(self.commands(service)), 2)

    @unittest.skipUnless(os.environ.get("KTR_LONG_TESTS"), "a minute of asking: KTR_LONG_TESTS=1 runs it")
    def test_asking_thousands_of_times_grows_nothing(self):
        told = self.folder / "told"
        with told.open("w") as output:
            program = subprocess.Popen([PROGRAM, "describe", "--live", "60s", "--ask", "Where are my friends?"],
                                       env=self.serve(MOVING, "--interval", "0.02"), stdout=output, stderr=output)
        begin = time.monotonic()

        def grown(at):
            """The most memory, KiB, and files that it had at three moments from there on."""
            seen = []
            for _ in range(3):
                time.sleep(max(begin + at - time.monotonic(), 1.0))
                status = pathlib.Path(f"/proc/{program.pid}/status").read_text()
                seen.append((int(re.search(r"VmRSS:\s+(\d+)", status).group(1)),
                             len(os.listdir(f"/proc/{program.pid}/fd"))))
            return max(memory for memory, _ in seen), max(files for _, files in seen)

        early, late = grown(20), grown(50)
        self.assertEqual(program.wait(timeout=60), 0)
        answers = re.findall(r"was asked: (\d+) answers, 0 failures", told.read_text(encoding="utf-8"))
        self.assertGreater(int(answers[-1]), 500)
        self.assertLess(late[0], early[0] + 4096)
        self.assertLess(late[1], early[1] + 8)

    def test_without_an_account_nobody_is_asked(self):
        environment = {**os.environ, "KTR_CONFIG": str(self.folder / "none.json"), "XDG_STATE_HOME": str(self.folder)}
        result = self.run_live(environment, "describe", 0.3)
        self.assertEqual(result.returncode, 1)
        self.assertIn("Sign in, then I’ll tell you.", result.stdout)
        self.assertIn("Sign in to see your friends.", result.stderr)

    def test_service_of_another_certificate_is_not_believed(self):
        result = self.describe(MOVING, 0.3, "--certificate", "foreign")
        self.assertEqual(result.returncode, 1)
        self.assertIn("Your service didn’t answer.", result.stdout)
        self.assertIn("nobody who is trusted vouches for its certificate", result.stderr)
        self.assertIn("ktr: Service not trusted.\n", result.stderr)

    def test_broken_configuration_is_told(self):
        config = self.folder / "config.json"
        config.write_text('{"account": {"personId": 5}}')
        environment = {**os.environ, "KTR_CONFIG": str(config), "XDG_STATE_HOME": str(self.folder)}
        result = self.run_live(environment, "describe", 0.3)
        self.assertEqual(result.returncode, 1)
        self.assertIn("$.account.personId", result.stderr)

    def test_run_without_a_display_draws_and_ends_the_service(self):
        environment = {k: v for k, v in os.environ.items() if k not in ("DISPLAY", "WAYLAND_DISPLAY")}
        environment.update(KTR_RUN_SECONDS="1", XDG_STATE_HOME=str(self.folder / "state"),
                           KTR_RUN_LOG=str(self.folder / "service.log"))
        result = subprocess.run([SOURCE / "scripts" / "show", PROGRAM], cwd=self.folder, env=environment, timeout=300,
                                capture_output=True, text=True, encoding="utf-8")
        self.assertEqual(result.returncode, 0, result.stderr)
        self.assertTrue((self.folder / "out" / "live.png").exists())
        self.assertTrue((self.folder / "out" / "dinner.png").exists())
        self.assertIn("Ann Marsh", result.stdout)
        port = re.search(r"localhost:(\d+)", result.stdout).group(1)
        listening = pathlib.Path("/proc/net/tcp").read_text()
        self.assertNotRegex(listening, rf"0100007F:{int(port):04X} 00000000:0000 0A")


if __name__ == "__main__":
    sys.exit(unittest.main())
