#!/usr/bin/python3
"""Each outcome against a real service, twice: from a terminal, and in the window as assistive technology sees it over the
accessibility bus of a session of its own. The same question gets the same answer. Skipped without a virtual display, a session
bus and pyatspi."""

import contextlib
import json
import os
import re
import sqlite3
import subprocess
import sys
import time
import unittest

from screen_session import outside
from service_program import ServiceProgram, free_port

SERVICE, KTR = sys.argv[1:3]
VCARD = "BEGIN:VCARD\r\nVERSION:3.0\r\nN:{1};{0};;;\r\nFN:{0} {1}\r\nEMAIL:{2}@x.example\r\nEND:VCARD\r\n"
# Ann is seen; the others are not, each for a reason of their own.
UNSEEN = {"Hana": "hides", "Nora": "never shared", "Rita": "took it back", "Fio": "was never heard", "Una": "is unknown"}
CONTACTS = [("Ann", "Marsh"), *((name, "Unseen") for name in UNSEEN), ("Max", "Weber"), ("Max", "Stone")]


class OutcomesTest(unittest.TestCase):
    def setUp(self):
        self.service = ServiceProgram(self, SERVICE)
        self.folder = self.service.folder
        phones = {name: self.service.add(name) for name in ("Mara", "Ann", "Hana", "Nora", "Rita", "Fio")}
        for name in ("Ann", "Hana", "Rita", "Fio"):
            self.service.command("share", name, "Mara")
        text = self.service.command("reader", "Mara", "--token-file", str(self.folder / "token"))
        self.configuration = json.loads(text[text.index("{"):text.rindex("}") + 1])
        (self.folder / "contacts.vcf").write_text("".join(
            VCARD.format(first, last, first.lower() if first != "Max" else last.lower()) for first, last in CONTACTS))
        self.configuration["contacts"] = [str(self.folder / "contacts.vcf")]
        self.configuration["positions"] = {"source": "none"}
        self.service.start()
        for name in ("Mara", "Ann", "Hana", "Nora", "Rita"):
            status, answer = self.service.post(name, phones[name], _type="location", lat=50.2171, lon=-3.1118, acc=12,
                                               tst=int(time.time()))
            self.assertEqual(status, 200, answer)
        self.service.command("hide", "Hana")
        self.service.command("revoke", "Rita", "Mara")

    def configure(self, **account):
        configuration = json.loads(json.dumps(self.configuration))
        configuration["account"].update(account)
        if account.get("personId", "there") is None:
            del configuration["account"]
        file = self.folder / "config.json"
        file.write_text(json.dumps(configuration))
        file.chmod(0o600)
        return {**os.environ, "KTR_CONFIG": str(file), "XDG_STATE_HOME": str(self.folder / "state"), "LANG": "C.UTF-8",
                "QT_QPA_PLATFORM": "xcb", "QT_LINUX_ACCESSIBILITY_ALWAYS_ON": "1",
                "DBUS_SYSTEM_BUS_ADDRESS": "unix:path=/nonexistent"}

    def asked(self, environment, question):
        """What a terminal gets."""
        done = subprocess.run([KTR, "ask", question, "--json", "--language", "en-GB"], env=environment, capture_output=True,
                              text=True, timeout=60, check=False)
        return done.returncode, json.loads(done.stdout)

    def nodes(self, process):
        """Everything in the window of this program."""
        import pyatspi

        def walk(node):
            yield node
            for child in node:
                if child is not None:
                    yield from walk(child)

        for program in pyatspi.Registry.getDesktop(0):
            if program is not None and program.get_process_id() == process.pid:
                yield from walk(program)

    def texts(self, process):
        """All that the window of this program says, and the names of what can be pressed in it."""
        texts, links = [], []
        for node in self.nodes(process):
            (links if node.getRoleName() == "link" else texts).append(node.name.replace("\u00a0", " "))
        return texts, links

    def press(self, process, name):
        action = next(node for node in self.nodes(process) if node.getRoleName() == "link" and node.name == name).queryAction()
        action.doAction([action.getName(i) for i in range(action.nActions)].index("Press"))

    def open(self, environment, questions):
        program = subprocess.Popen([KTR, "show", "--language", "en-GB", "--reduced-motion",
                                    *(word for question in questions for word in ("--ask", question))], env=environment)
        self.addCleanup(program.wait)
        self.addCleanup(program.kill)
        return program

    def shown(self, environment, questions, sentences):
        """The same from one window, once it has said all of this."""
        return self.said_by(self.open(environment, questions), sentences)

    def said_by(self, program, sentences):
        deadline = time.monotonic() + 60
        said = ([], [])
        while time.monotonic() < deadline:
            try:
                said = self.texts(program)
            except Exception:  # The tree changes while it is walked.
                pass
            if all(any(sentence in text for text in said[0]) for sentence in sentences):
                break
            time.sleep(0.2)
        return said

    def assert_alike(self, environment, table):
        answers = {}
        for question, (status, outcome) in table.items():
            code, answer = self.asked(environment, question)
            self.assertEqual((code, answer["outcome"]), (status, outcome), answer)
            self.assertEqual("snippet" in answer, outcome in ("found", "hidden"), answer)
            answers[question] = answer
        # What goes on changing says in the window when it was true.
        sentences = [answer["sentence"] for answer in answers.values() if answer["outcome"] != "found"]
        texts, links = self.shown(environment, table, sentences)
        for sentence in sentences:
            self.assertTrue(any(sentence in text for text in texts), (sentence, texts))
        return answers, texts, links

    def test_answers_of_a_service_that_is_there(self):
        environment = self.configure()
        questions = {"Where is Ann?": (0, "found"), "Where is Max?": (11, "ambiguous"),
                     "Where is Xyzzy?": (12, "unknownPerson"), "Where is An?": (12, "unknownPerson"),
                     "Tell me a joke": (16, "notUnderstood"), "Share my location until six": (18, "refused"),
                     **{f"Where is {name}?": (10, "notSeen") for name in UNSEEN}}
        answers, texts, links = self.assert_alike(environment, questions)
        # Nobody learns from an answer which of the reasons it is: not from a byte of it, but for the name.
        unseen = {json.dumps(answers[f"Where is {name}?"]).replace(name, "X").replace(name.lower(), "x") for name in UNSEEN}
        self.assertEqual(len(unseen), 1, unseen)
        self.assertTrue(any(re.match(r"(At .+ Ann Marsh was|This is where Ann Marsh was at) ", text) for text in texts), texts)
        for name in UNSEEN:
            self.assertIn(f"Ask {name} Unseen to share", links)
        for choice in ("Max Weber", "Max Stone", "See all friends", *answers["Tell me a joke"]["suggestions"]):
            self.assertIn(choice, links)

    def test_what_is_offered_is_done(self):
        """A choice asks about the one who was chosen, a suggestion is asked, and a wish to be shared with is sent."""
        environment = self.configure()
        stone = self.asked(environment, "Where is Max Stone?")[1]
        joke = self.asked(environment, "Tell me a joke")[1]
        unseen = self.asked(environment, "Where is Hana?")[1]
        program = self.open(environment, ["Where is Max?", "Tell me a joke", "Where is Hana?"])
        texts, links = self.said_by(program, [joke["sentence"], unseen["sentence"]])
        self.assertIn("Max Stone", links)
        self.assertFalse(any(stone["sentence"] in text for text in texts), texts)
        self.press(program, "Max Stone")
        texts, _ = self.said_by(program, [stone["sentence"]])
        self.assertTrue(any(stone["sentence"] in text for text in texts), texts)
        self.press(program, joke["suggestions"][0])
        texts, _ = self.said_by(program, [joke["suggestions"][0]])
        self.assertIn(joke["suggestions"][0], texts, "it stands as a question now")
        self.press(program, "Ask Hana Unseen to share")
        deadline = time.monotonic() + 30
        while not self.asks() and time.monotonic() < deadline:
            time.sleep(0.2)
        self.assertEqual(self.asks(), ["hana@x.example"])

    def asks(self):
        """Of whom the service was asked that they share."""
        with contextlib.closing(sqlite3.connect(self.folder / "data" / "service.db")) as database:
            return [handle for handle, in database.execute("SELECT handle FROM ask")]

    def test_user_who_hides(self):
        environment = self.configure()
        self.assertEqual(self.asked(environment, "Hide my location")[0], 0)
        self.assert_alike(environment, {"Who sees me?": (13, "hidden")})

    def test_service_that_is_not_there(self):
        environment = self.configure(host=f"localhost:{free_port()}")
        _, _, links = self.assert_alike(environment, {"Where is Ann?": (14, "unreachable")})
        self.assertIn("Try again", links)

    def test_locked_computer(self):
        from private_bus import Logind, PrivateBus

        environment = self.configure()
        system = PrivateBus(self.folder, "system")
        self.addCleanup(system.stop)
        login = Logind(system)
        self.addCleanup(login.stop)
        environment["DBUS_SYSTEM_BUS_ADDRESS"] = system.address
        login.lock(True)
        answers, texts, _ = self.assert_alike(environment, {"Where is Ann?": (17, "locked")})
        self.assertFalse(any("Ann Marsh" in text for text in texts), "nobody is named to whoever passes by")
        login.lock(False)
        self.assertEqual(self.asked(environment, "Where is Ann?")[1]["outcome"], "found")

    def test_account_that_the_service_does_not_know(self):
        (self.folder / "token").write_text("x" * 22 + "\n")
        answers, texts, _ = self.assert_alike(self.configure(), {"Where is Ann?": (15, "notSignedIn")})
        self.assertEqual(answers["Where is Ann?"]["action"]["kind"], "signIn")
        self.assertIn("Sign in again to see your friends.", texts)

    def test_nobody_is_signed_in(self):
        answers, texts, _ = self.assert_alike(self.configure(personId=None), {"Where is Ann?": (15, "notSignedIn")})
        self.assertEqual(answers["Where is Ann?"]["action"]["kind"], "signIn")
        self.assertIn("Where are your friends?", texts, "the page that signs in")
        self.assertNotIn("Sign in again to see your friends.", texts, "for nobody was before")

    def test_asking_to_share_says_the_same_whoever_is_there(self):
        environment = self.configure()
        answers = set()
        for name in UNSEEN:
            for _ in range(2):
                code, answer = self.asked(environment, f"Ask {name} to share")
                self.assertEqual((code, answer["wish"]), (0, "AskToShare"), answer)
                answers.add(re.sub(r"\d+:\d\d", "T", answer["sentence"].replace(name, "X")))
        self.assertEqual(len(answers), 1, answers)


if __name__ == "__main__":
    if "KTR_INSIDE" not in os.environ:
        sys.exit(outside(__file__, modules=("dbusmock", "pyatspi"), seconds=590))
    unittest.main(argv=[sys.argv[0], *sys.argv[3:]])
