#!/usr/bin/env python3
"""The service of one's own from nothing to the first friend seen: its commands, phones that post, ktr that asks.

  own_service_test.py SERVICE PROGRAM [unittest options]
"""
import base64
import concurrent.futures
import http.client
import json
import os
import pathlib
import re
import signal
import socket
import sqlite3
import ssl
import subprocess
import sys
import tempfile
import time
import unittest

SERVICE, PROGRAM = sys.argv.pop(1), sys.argv.pop(1)
PATH = "/qloxservice/friends/va/"
SCENARIO = {
    "snippet": {
        "kind": "VAKtrLocationSnippet",
        "searchContext": "ktrServerContext://serverContext?clientId=own&minCallbackIntervalInMS=100&",
        "locations": [{"friend": {"data": "ann@x.example", "object": {
            "fullName": "Ann Example", "emails": [{"emailAddress": "ann@x.example"}]}}}],
    }
}


def free_port():
    with socket.socket() as probe:
        probe.bind(("127.0.0.1", 0))
        return probe.getsockname()[1]


class OwnServiceTest(unittest.TestCase):
    def setUp(self):
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="ktr-own-"))
        self.addCleanup(lambda: subprocess.run(["rm", "-rf", os.fspath(self.folder)], check=True))
        self.port = free_port()
        self.command("init", "--host", "localhost", "--port", str(self.port))
        self.process = None

    def command(self, *words, fails=False):
        done = subprocess.run([SERVICE, "--data", str(self.folder / "data"), *words], capture_output=True, text=True,
                              timeout=60, check=False)
        self.assertEqual(done.returncode != 0, fails, (words, done.stdout, done.stderr))
        return done.stderr if fails else done.stdout

    def start(self):
        self.process = subprocess.Popen([SERVICE, "--data", str(self.folder / "data"), "serve"],
                                        stdout=subprocess.PIPE, text=True)
        process = self.process
        self.addCleanup(process.stdout.close)
        self.addCleanup(lambda: process.poll() is not None or (process.kill(), process.wait()))
        self.assertTrue(process.stdout.readline().startswith(f"ready https://localhost:{self.port} "))

    def add(self, name, *options):
        text = self.command("add", name, "--handle", f"{name.lower()}@x.example", *options)
        return re.search(r"Password  (\S+)", text).group(1)

    def reader(self, name):
        """A configuration for ktr, and the secret in its token file."""
        token = self.folder / f"{name}-token"
        configuration = json.loads(self.command("reader", name, "--token-file", str(token)))
        return configuration, token.read_text().strip()

    def earlier(self):
        """As if all grants had been made two hours ago."""
        database = sqlite3.connect(self.folder / "data" / "service.db")
        database.execute("UPDATE share SET since = since - 7200")
        database.commit()
        database.close()

    def request(self, method, path, user, secret, body=b"", **headers):
        context = ssl.create_default_context(cafile=str(self.folder / "data" / "ca.pem"))
        connection = http.client.HTTPSConnection("localhost", self.port, context=context, timeout=20)
        if secret is not None:
            headers["Authorization"] = "Basic " + base64.b64encode(f"{user}:{secret}".encode()).decode()
        connection.request(method, path, body, headers)
        answer = connection.getresponse()
        text = answer.read()
        connection.close()
        return answer.status, text

    def post(self, user, secret, **message):
        status, text = self.request("POST", "/pub", user, secret, json.dumps(message),
                                    **{"Content-Type": "application/json; charset=utf-8"})
        return status, json.loads(text)

    def locate(self, user, secret, latitude=50.2104, longitude=-3.12, ago=60):
        return self.post(user, secret, _type="location", lat=latitude, lon=longitude, acc=12,
                         tst=int(time.time()) - ago, tid=user[:2], t="u")

    def ask(self, user, secret, *handles, command="getlocations", **members):
        body = {"clientContext": {}, "handles": list(handles), **members}
        status, text = self.request("POST", PATH + command, user, secret, json.dumps(body), **{
            "Content-Type": "application/json", "X-Orcha-Seek-API-Ver": "4.0", "X-Orcha-AuthScheme": "Forever"})
        return status, json.loads(text)

    def test_from_nothing_to_the_first_friend_seen(self):
        ann = self.add("Ann")
        self.add("Mara")
        configuration, _ = self.reader("Mara")
        self.command("friend", "Ann", "Mara")
        self.earlier()
        self.start()
        self.assertEqual(self.locate("Ann", ann, ago=125), (200, []))
        configuration["positions"] = {"source": "none"}
        (self.folder / "config.json").write_text(json.dumps(configuration))
        os.chmod(self.folder / "config.json", 0o600)
        (self.folder / "ann.json").write_text(json.dumps(SCENARIO))
        seen = subprocess.run([PROGRAM, "describe", "--live", "3s", str(self.folder / "ann.json")], capture_output=True, text=True, timeout=120,
                              check=False, env={**os.environ, "KTR_CONFIG": str(self.folder / "config.json"),
                                           "QT_QPA_PLATFORM": "offscreen", "LC_ALL": "en_US.UTF-8"})
        self.assertEqual(seen.returncode, 0, seen.stderr)
        self.assertIn("Ann Example", seen.stdout)
        self.assertIn("2\u00a0minutes ago", seen.stdout, seen.stdout + seen.stderr)
        self.assertIn("Accurate to 39 feet", seen.stdout)

    def test_a_link_signs_a_program_in_once(self):
        self.add("Mara")
        self.start()
        link = re.search(r"https://localhost:\d+/me/in\?link=(\w+)", self.command("link", "Mara")).group(1)

        def exchange(body):
            status, text = self.request("POST", "/me/in", "", None, json.dumps(body).encode(),
                                        **{"Content-Type": "application/json"})
            return status, json.loads(text)

        self.assertEqual(exchange({"link": "guessed"})[0], 403)
        status, given = exchange({"link": link})
        self.assertEqual((status, given["person"]), (200, "Mara"))
        self.assertEqual(self.ask("Mara", given["secret"])[0], 200)
        self.assertEqual(self.ask("Mara", given["secret"], command="friends"), (200, {"statusCode": 200, "friends": []}))
        self.assertEqual(exchange({"link": link})[0], 403)
        self.assertEqual(self.ask("Mara", link)[0], 401, "a link is no secret")
        everything = b"".join(one.read_bytes() for one in (self.folder / "data").iterdir() if one.is_file())
        self.assertNotIn(given["secret"].encode(), everything)
        self.assertNotIn(link.encode(), everything)

    def test_who_is_not_seen_cannot_be_told_from_who_does_not_exist(self):
        people = {name: self.add(name) for name in ("Ann", "Otto", "Zoe", "Ivy", "Lea")}
        self.add("Mara")
        _, mara = self.reader("Mara")
        for owner in ("Ann", "Zoe", "Ivy", "Lea"):
            self.command("share", owner, "Mara")
        self.earlier()
        self.start()
        for name in ("Ann", "Otto", "Zoe", "Ivy"):
            self.assertEqual(self.locate(name, people[name])[0], 200)
        self.command("hide", "Zoe")
        self.command("revoke", "Ivy", "Mara")
        unseen = ["lea@x.example", "otto@x.example", "zoe@x.example", "ivy@x.example", "no1@x.example"]
        status, answer = self.ask("Mara", mara, *unseen[:2], "ann@x.example", *unseen[2:])
        self.assertEqual(status, 200)
        self.assertEqual(answer["emails"], ["ann@x.example", *unseen])
        self.assertEqual(list(answer["locations"]), ["ann@x.example"])
        self.assertEqual(answer["locations"]["ann@x.example"]["location"]["latitude"], 50.2104)
        alone = {json.dumps(self.ask("Mara", mara, handle)[1]).replace(handle[:3], "xxx") for handle in unseen[1:]
                 if len(handle) == len(unseen[1])} | {
                     json.dumps(self.ask("Mara", mara, handle)[1]).replace(handle[:3], "xxx") for handle in unseen
                     if len(handle) == len(unseen[0])}
        self.assertEqual(len(alone), 2, "one for each length of the handle")

    def test_a_town_until_midnight(self):
        ann = self.add("Ann")
        self.add("Mara")
        _, mara = self.reader("Mara")
        self.assertIn("town until", self.command("share", "Ann", "Mara", "--precision", "town", "--until", "midnight"))
        self.assertIn("seen by Mara: town until", self.command("people"))
        self.earlier()
        self.start()
        self.locate("Ann", ann)
        _, answer = self.ask("Mara", mara, "ann@x.example")
        for entry in answer["locations"].values():
            self.assertGreaterEqual(entry["location"]["horizontalAccuracy"], 2000)
            self.assertNotEqual(entry["location"]["latitude"], 50.2104)
            self.assertEqual(entry["location"]["timestamp"] % 900000, 0)

    def test_hiding_holds_before_it_is_acknowledged_and_no_does_not_undo_it(self):
        ann = self.add("Ann")
        self.add("Mara")
        _, ann_reader = self.reader("Ann")
        _, mara = self.reader("Mara")
        self.command("share", "Ann", "Mara")
        self.earlier()
        self.start()
        self.locate("Ann", ann)

        def sharing(hide):
            return self.ask("Ann", ann_reader, command="showHideLocation", prefs={"hideLocation": hide})

        self.assertEqual(sharing("No")[1]["myInfo"],
                         {"preferredEmail": "ann@x.example", "hidden": False, "location": None})
        self.assertTrue(self.ask("Mara", mara, "ann@x.example")[1]["locations"])
        self.assertTrue(sharing("Yes")[1]["myInfo"]["hidden"])
        self.assertFalse(self.ask("Mara", mara, "ann@x.example")[1]["locations"])
        self.assertTrue(sharing("No")[1]["myInfo"]["hidden"], "an older answer repeats itself")
        self.assertEqual(self.locate("Ann", ann, 51.0, ago=0)[0], 200)
        self.assertFalse(self.ask("Mara", mara, "ann@x.example")[1]["locations"])
        time.sleep(1.1)
        self.command("show", "Ann")
        self.assertFalse(self.ask("Mara", mara, "ann@x.example")[1]["locations"], "what was before is not seen again")
        time.sleep(1.1)
        self.locate("Ann", ann, 52.0, ago=0)
        seen = self.ask("Mara", mara, "ann@x.example")[1]["locations"]["ann@x.example"]["location"]
        self.assertEqual(seen["latitude"], 52.0)

    def test_a_phone_number_is_not_said_to_be_an_address(self):
        self.command("add", "Ann", "--handle", "+44 1632 960001", "--handle", "ann@x.example")
        self.command("add", "Otto", "--handle", "+44 1632 960002")
        readers = {name: self.reader(name)[1] for name in ("Ann", "Otto")}
        self.start()
        preferred = {name: self.ask(name, secret, command="showHideLocation", prefs={"hideLocation": "No"})[1]["myInfo"].get(
            "preferredEmail") for name, secret in readers.items()}
        self.assertEqual(preferred, {"Ann": "ann@x.example", "Otto": None})

    def test_friends_come_back_to_the_phone(self):
        ann, otto = self.add("Ann"), self.add("Otto")
        self.command("friend", "Ann", "Otto")
        self.earlier()
        self.start()
        self.assertEqual(self.locate("Ann", ann), (200, []))
        status, answer = self.locate("Otto", otto)
        self.assertEqual(status, 200)
        self.assertEqual(answer[0], {"_type": "card", "tid": "Ann", "name": "Ann"})
        self.assertEqual({key: answer[1][key] for key in ("_type", "tid", "lat", "lon", "acc")},
                         {"_type": "location", "tid": "Ann", "lat": 50.2104, "lon": -3.12, "acc": 12})
        self.assertIsInstance(answer[1]["tst"], int)
        deadline = time.monotonic() + 10
        while len(self.locate("Otto", otto)[1]) != 1 and time.monotonic() < deadline:
            pass
        self.assertEqual([one["_type"] for one in self.locate("Otto", otto)[1]], ["location"], "a card comes once")
        self.command("revoke", "Ann", "Otto")
        self.assertEqual(self.locate("Otto", otto)[1], [])

    def test_everything_with_right_credentials_is_taken(self):
        ann = self.add("Ann")
        self.earlier()
        self.start()
        for body in (b"", b"{", b"[]", b"\xff", b'{"_type":"lwt"}', b'{"_type":"location"}', b"x" * 100000):
            self.assertEqual(self.request("POST", "/pub", "Ann", ann, body)[0], 200, body[:20])
        large = b"x" * 1500000
        self.assertEqual(self.request("POST", "/pub", "Ann", ann, large), (200, b"[]"))
        self.assertEqual(self.request("POST", "/?id=" + ann, None, None, large), (200, b""))
        self.assertEqual(self.request("POST", "/pub", "Ann", "wrong", large)[0], 401)
        self.assertEqual(self.request("POST", "/?id=wrong", None, None, large)[0], 401)
        # Who is named in the body alone cannot be known, and would send it for ever.
        self.assertEqual(self.request("POST", "/", None, None, large), (200, b""))
        self.assertEqual(self.request("POST", "/pub", None, None, large)[0], 401, "nobody's")
        self.assertEqual(self.request("POST", "/me/delete", "Ann", ann, large)[0], 413)
        now = int(time.time())
        for tst in (now - 400000, now + 400000, 0):
            self.assertEqual(self.post("Ann", ann, _type="location", lat=1, lon=2, tst=tst)[0], 200)
        numbers = self.request("GET", "/metrics", None, None)[1].decode()
        self.assertIn("ktr_service_junk_total 8", numbers)
        self.assertIn("ktr_service_dropped_too_old_total 1", numbers)
        self.assertNotIn("Ann", numbers)

    def test_wrong_credentials_are_refused_slowly_and_right_ones_at_once(self):
        ann = self.add("Ann")
        _, reader = self.reader("Ann")
        self.earlier()
        self.start()
        for user, secret in (("Ann", "wrong"), ("Ann", ""), ("Otto", ann), ("Ann", None), ("Ann", reader)):
            self.assertEqual(self.locate(user, secret)[0], 401, (user, secret))
        self.assertEqual(self.ask("Ann", ann, "x@x.example")[0], 401, "a phone's secret does not ask")
        begin = time.monotonic()
        self.assertEqual(self.locate("Ann", ann)[0], 200)
        self.assertLess(time.monotonic() - begin, 2)
        self.command("revoke", "Ann")
        self.assertEqual(self.locate("Ann", ann)[0], 401)

    def test_trackers_that_know_only_a_url(self):
        ann = self.add("Ann")
        self.add("Mara")
        _, mara = self.reader("Mara")
        self.command("share", "Ann", "Mara")
        self.earlier()
        self.start()
        now = int(time.time())

        def seen():
            return self.ask("Mara", mara, "ann@x.example")[1]["locations"]["ann@x.example"]["location"]["latitude"]

        self.assertEqual(self.request("GET", f"/?id={ann}&lat=50.1&lon=-3&timestamp={now - 30}", None, None), (200, b""))
        self.assertEqual(seen(), 50.1)
        form = f"lat=50.2&lon=-3&timestamp={(now - 20) * 1000}"
        self.assertEqual(self.request("POST", f"/?id={ann}&{form}", None, None)[0], 200)
        self.assertEqual(seen(), 50.2)
        body = {"location": {"timestamp": time.strftime("%Y-%m-%dT%H:%M:%S.000Z", time.gmtime(now - 10)), "coords": {
            "latitude": 50.3, "longitude": -3, "accuracy": 9, "speed": -1}}, "device_id": ann}
        self.assertEqual(self.request("POST", "/", None, None, json.dumps(body),
                                      **{"Content-Type": "application/json"})[0], 200)
        self.assertEqual(seen(), 50.3)
        self.assertEqual(self.request("GET", "/?id=wrong&lat=50.1&lon=-3", None, None)[0], 401)

    def test_what_was_acknowledged_survives_a_kill(self):
        ann = self.add("Ann")
        self.add("Mara")
        _, mara = self.reader("Mara")
        self.command("share", "Ann", "Mara")
        self.earlier()
        for turn in range(5):
            self.start()
            # Each fix is nearer to the present than all before.
            base = 3600 - turn * 600

            def send(number, start=base):
                try:
                    return number if self.locate("Ann", ann, 40 + number / 1000, ago=start - number)[0] == 200 else -1
                except (OSError, http.client.HTTPException):
                    return -1

            with concurrent.futures.ThreadPoolExecutor(8) as pool:
                futures = [pool.submit(send, number) for number in range(200)]
                time.sleep(0.1 + turn * 0.05)
                self.process.send_signal(signal.SIGKILL)
                self.process.wait()
                acknowledged = max(future.result() for future in futures)
            if acknowledged < 0:
                continue
            self.start()
            seen = self.ask("Mara", mara, "ann@x.example")[1]["locations"]["ann@x.example"]["location"]["latitude"]
            self.assertGreaterEqual(round((seen - 40) * 1000), acknowledged)
            self.process.send_signal(signal.SIGTERM)
            self.assertEqual(self.process.wait(timeout=20), 0)

    def test_commands_beside_the_running_service_lose_nothing(self):
        ann = self.add("Ann")
        self.add("Mara")
        _, mara = self.reader("Mara")
        self.command("share", "Ann", "Mara")
        self.earlier()
        self.start()
        for number in range(3):
            self.assertEqual(self.locate("Ann", ann, 50 + number, ago=60 - number)[0], 200)
            # Another process opens the store, and is through with it.
            self.command("people")
        self.process.send_signal(signal.SIGKILL)
        self.process.wait()
        database = sqlite3.connect(self.folder / "data" / "service.db")
        self.addCleanup(database.close)
        self.assertEqual(database.execute("SELECT count(*) FROM fix").fetchone(), (3,))
        self.start()
        seen = self.ask("Mara", mara, "ann@x.example")[1]["locations"]["ann@x.example"]["location"]["latitude"]
        self.assertEqual(seen, 52)

    def test_mistakes_get_a_sentence(self):
        self.add("Ann")
        self.add("Otto")
        for words, part in ((("add", "Ann"), "is there already"), (("add", "a:b"), "expected a name"),
                            (("add", "Zoe", "--handle", "ANN@x.example"), "belongs to somebody else"),
                            (("share", "Ann", "Nobody"), "there is nobody called"),
                            (("share", "Ann", "Ann"), "nobody shares with themselves"),
                            (("share", "Ann", "Otto", "--precision", "street"), "expected exact, 1km, town or places"),
                            (("share", "Ann", "Otto", "--until", "yesterday"), "--until: expected"),
                            (("revoke", "Ann", "Otto"), "does not see"), (("init", "--host", "b"), "already"),
                            (("hide", "Nobody"), "there is nobody called")):
            self.assertIn(part, self.command(*words, fails=True), words)
        pipe, text = self.folder / "pipe", self.folder / "text"
        os.mkfifo(pipe)
        text.write_text("no picture")
        for picture, part in (("/not/there", "no such file"), (pipe, "not a file"), (self.folder, "not a file"),
                              (text, "is neither a JPEG nor a PNG")):
            self.assertIn(part, self.command("face", "Ann", str(picture), fails=True))
        for words, part in ((("--friend", "Nobody"), "there is nobody called"), (("--friend", "Ivy"), "with themselves"),
                            (("--ktr", str(self.folder)), "has a configuration already")):
            (self.folder / "config.json").write_text("mine")
            self.assertIn(part, self.command("add", "Ivy", *words, fails=True))
        self.assertEqual((self.folder / "config.json").read_text(), "mine")
        self.assertNotIn("Ivy", self.command("people"), "nothing is done when not all of it can be done")
        self.assertIn("whole", self.command("check"))
        self.assertEqual(subprocess.run([SERVICE, "--data", "/not/there", "people"], capture_output=True, timeout=60,
                                        check=False).returncode, 1)


if __name__ == "__main__":
    unittest.main(warnings="ignore")
