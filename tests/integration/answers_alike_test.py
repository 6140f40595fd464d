"""One question, one answer: in the terminal, from a voice client, on an assistant's bus and in the desktop's search, in some
languages, with KTR_LONG_TESTS=1 in every one, against the real programs and a real service."""
import html
import json
import os
import pathlib
import socket
import sqlite3
import subprocess
import sys
import time
import unittest

import dbus

from bus_double import BusDouble
from private_bus import Logind, PrivateBus
from service_program import ServiceProgram

SERVICE, KTR = sys.argv[1:3]
SOURCE = pathlib.Path(os.environ["KTR_SOURCE"])
LONG = bool(os.environ.get("KTR_LONG_TESTS"))
SOME = ("en", "ja", "pl")
LANGUAGES = sorted(file.stem for file in (SOURCE / "resources" / "questions").glob("*.json"))
NAME, PATH, SHELL, RUNNER = "org.ktr.ktr.Search", "/org/ktr/ktr/Search", "org.gnome.Shell.SearchProvider2", "org.kde.krunner1"
VCARD = "BEGIN:VCARD\r\nVERSION:3.0\r\nN:{1};{0};;;\r\nFN:{0} {1}\r\nEMAIL:{2}@x.example\r\nEND:VCARD\r\n"
# Seen, not seen, two of one name, and nobody of that name.
ASKED = {"Ann": "found", "Otto": "notSeen", "Max": "ambiguous", "Xyzzy": "unknownPerson"}


class AnswersAlikeTest(unittest.TestCase):
    def setUp(self):
        self.service = ServiceProgram(self, SERVICE)
        phones = {name: self.service.add(name) for name in ("Ann", "Otto", "Mara")}
        self.service.command("share", "Ann", "Mara", "--aloud")
        folder = self.folder = self.service.folder
        text = self.service.command("reader", "Mara", "--token-file", str(folder / "token"))
        configuration = json.loads(text[text.index("{"):text.rindex("}") + 1])
        (folder / "contacts.vcf").write_text("".join(VCARD.format(*one) for one in (
            ("Ann", "Marsh", "ann"), ("Otto", "Brandt", "otto"), ("Max", "Weber", "max1"), ("Max", "Stone", "max2"))))
        configuration["contacts"] = [str(folder / "contacts.vcf")]
        (folder / "config.json").write_text(json.dumps(configuration))
        (folder / "config.json").chmod(0o600)
        # As if all was agreed hours ago: only what was later is seen.
        database = sqlite3.connect(folder / "data" / "service.db")
        database.execute("UPDATE share SET since = since - 14400")
        database.commit()
        database.close()
        self.service.start()
        # Long enough ago that every answer says when it was.
        status, answer = self.service.post("Ann", phones["Ann"], _type="location", lat=50.2171, lon=-3.1118, acc=12,
                                           tst=int(time.time()) - 1200)
        self.assertEqual(status, 200, answer)
        system = PrivateBus(folder, "system")
        self.addCleanup(system.stop)
        self.logind = Logind(system)
        self.addCleanup(self.logind.stop)
        self.session = PrivateBus(folder, "session")
        self.addCleanup(self.session.stop)
        (folder / "run").mkdir(mode=0o700)
        self.environment = {**os.environ, "KTR_CONFIG": str(folder / "config.json"), "XDG_STATE_HOME": str(folder / "state"),
                            "XDG_RUNTIME_DIR": str(folder / "run"), "DBUS_SYSTEM_BUS_ADDRESS": system.address,
                            "DBUS_SESSION_BUS_ADDRESS": self.session.address, "LANG": "C.UTF-8",
                            "PYTHONPATH": str(SOURCE / "voice" / "ovos")}
        for name in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM"):
            self.environment.pop(name, None)
        self.wyoming = self.start(KTR, "wyoming", "--port", "0")
        self.port = int(self.wyoming.stdout.readline().rsplit(":", 1)[1])
        self.bus = BusDouble()
        self.addCleanup(self.bus.stop)
        self.start(sys.executable, "-m", "ktr_ovos_skill", "--bus", self.bus.url, "--ktr", KTR, "--no-picture",
                   "--patience", "60")
        self.assertIsNotNone(self.bus.wait_for_type("ovos.skills.fallback.register"))

    def start(self, *words):
        process = subprocess.Popen(words, env=self.environment, stdout=subprocess.PIPE, text=True)
        self.addCleanup(process.stdout.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        return process

    def in_the_terminal(self, question, language):
        done = subprocess.run([KTR, "ask", question, "--language", language, "--json"], env=self.environment,
                              capture_output=True, text=True, encoding="utf-8", timeout=60, check=False)
        answer = json.loads(done.stdout)
        return answer["outcome"], answer["sentence"]

    def by_voice(self, question, language):
        with socket.create_connection(("127.0.0.1", self.port), timeout=60) as peer:
            data = json.dumps({"text": question, "language": language}).encode()
            peer.sendall(json.dumps({"type": "transcript", "data_length": len(data)}).encode() + b"\n" + data)
            frame = json.loads(peer.makefile("rb").readline())
        self.assertEqual(frame["type"], "handled")
        return frame["data"]["text"]

    def on_the_bus(self, question, language):
        (sentence,), handled = self.bus.ask(question, language)
        self.assertTrue(handled)
        return sentence

    def in_the_search(self, question, connection):
        """What both searches say, once the answer is there: typed again, as they ask again with each key."""
        shell, runner = (dbus.Interface(connection.get_object(NAME, PATH, introspect=False), interface)
                         for interface in (SHELL, RUNNER))
        end = time.monotonic() + 60
        while True:
            first = runner.Match(question)[0]
            text, other = html.unescape(str(first[1])), str(first[5]["subtext"])
            if text != question:
                break
            self.assertLess(time.monotonic(), end, question)
            time.sleep(0.45)
        self.assertEqual(other, question)
        meta = shell.GetResultMetas(shell.GetInitialResultSet(question.split(" ")))[0]
        self.assertEqual(str(meta["description"]), text)
        return text

    def label_in_the_row(self, language):
        """As the service words Ann's place for the card's own requests in a language."""
        status, answer = self.service.ask("Mara", (self.folder / "token").read_text().strip(), "ann@x.example",
                                          locale=language)
        self.assertEqual(status, 200, answer)
        return json.loads(answer)["locations"]["ann@x.example"]["location"]["labels"][0]["label"]

    def test_the_same_question_has_one_answer(self):
        self.assertEqual(len(LANGUAGES), 21)
        connection = self.session.connect()
        for language in LANGUAGES if LONG else SOME:
            suggestions = json.loads((SOURCE / "resources" / "questions" / f"{language}.json").read_text())["suggestions"]
            search = self.start(KTR, "search", "--language", language)
            while not connection.name_has_owner(NAME):
                self.assertIsNone(search.poll())
                time.sleep(0.02)
            for name, outcome in ASKED.items():
                question = suggestions[0].replace("{name}", name)
                with self.subTest(language=language, question=question):
                    said = self.in_the_terminal(question, language)
                    self.assertEqual(said[0], outcome)
                    if outcome == "found":
                        self.assertIn(self.label_in_the_row(language), said[1], "whatever the session's language")
                    self.assertEqual(self.by_voice(question, language), said[1])
                    self.assertEqual(self.on_the_bus(question, language.lower()), said[1])
                    self.assertEqual(self.in_the_search(question, connection), said[1])
            wish = suggestions[5]
            with self.subTest(language=language, wish=wish):
                refusal = self.by_voice(wish, language)
                self.assertEqual(self.on_the_bus(wish, language.lower()), refusal)
                self.assertEqual(self.in_the_search(wish, connection), refusal)
            search.kill()
            search.wait()
            while connection.name_has_owner(NAME):
                time.sleep(0.02)
        self.assertEqual(self.bus.faults, [])
        last = self.in_the_terminal("Where is Ann?", "en")[1]
        self.assertIn("Ann", last, "no wish was granted on the way")
        self.assertNotIn(" at near ", last)

    def test_a_locked_computer_says_nothing_of_anybody(self):
        connection = self.session.connect()
        self.logind.lock(True)
        # Whoever asked before the lock was known would be answered now and then.
        said = {self.in_the_terminal("Where is Ann?", "en") for _ in range(12)}
        self.assertEqual(said, {("locked", "Unlock this computer, then I’ll tell you.")})
        sentence = said.pop()[1]
        self.assertEqual(self.by_voice("Where is Ann?", "en"), sentence)
        self.assertEqual(self.on_the_bus("Where is Ann?", "en"), sentence)
        self.start(KTR, "search", "--language", "en")
        while not connection.name_has_owner(NAME):
            time.sleep(0.02)
        runner = dbus.Interface(connection.get_object(NAME, PATH, introspect=False), RUNNER)
        self.assertEqual(list(runner.Match("Where is Ann?")), [])


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1] + sys.argv[3:])
