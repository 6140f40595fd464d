#!/usr/bin/env python3
"""Where is Ann right now? From the question on one computer to what her phone is told, and back.

  fresh_test.py SERVICE PROGRAM [unittest options]
"""
import json
import os
import subprocess
import sys
import time
import unittest

from own_service import OwnService
from phone import Phone

SERVICE, PROGRAM = sys.argv.pop(1), sys.argv.pop(1)
REPORT = {"_type": "cmd", "action": "reportLocation"}
HARBOUR, MARKET = (50.2104, -3.1200), (50.2171, -3.1118)
VCARD = "BEGIN:VCARD\r\nVERSION:3.0\r\nN:{0};;;;\r\nFN:{0}\r\nEMAIL:{1}@x.example\r\nEND:VCARD\r\n"


class FreshTest(unittest.TestCase):
    def setUp(self):
        self.service = OwnService(SERVICE)
        self.addCleanup(self.service.__exit__)
        self.phones = {}
        for name, kind in (("Ann", "android"), ("Otto", "ios")):
            self.phones[name] = Phone(kind, self.service.url, name, self.service.add(name), self.service.authority)
        self.service.add("Mara")
        for name, place in (("Ann", HARBOUR), ("Otto", MARKET)):
            self.service.command("share", name, "Mara")
            self.service.command("place", name, "--name", f"{name}'s quay", "--said", "--at", f"{place[0]},{place[1]}")
        self.service.earlier()
        folder = self.service.folder
        configuration = json.loads(self.service.command("reader", "Mara", "--token-file", str(folder / "token")))
        (folder / "contacts.vcf").write_text("".join(VCARD.format(name, name.lower()) for name in ("Ann", "Otto", "Zoe")))
        (folder / "config.json").write_text(json.dumps({**configuration, "contacts": [str(folder / "contacts.vcf")]}))
        (folder / "config.json").chmod(0o600)
        self.service.start()

    def ask(self, question, *options):
        environment = {k: v for k, v in os.environ.items() if k not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM")}
        environment.update(KTR_CONFIG=str(self.service.folder / "config.json"),
                           XDG_STATE_HOME=str(self.service.folder / "state"),
                           DBUS_SESSION_BUS_ADDRESS="unix:path=/nonexistent",
                           DBUS_SYSTEM_BUS_ADDRESS="unix:path=/nonexistent")
        done = subprocess.run([PROGRAM, "ask", question, *(options or ("--language", "en-GB"))], env=environment,
                              capture_output=True, timeout=120, text=True, encoding="utf-8", check=False)
        return done.stdout.strip().replace("\u202f", " ").replace("\u00a0", " ")

    def locate(self, name, place, ago):
        phone = self.phones[name]
        phone.locate(*place, time.time() - ago)
        self.assertTrue(phone.send())
        self.assertEqual(phone.lost, 0)
        return phone.answers[-1]

    def test_the_phone_reports_and_the_next_question_knows(self):
        self.assertEqual(self.locate("Ann", HARBOUR, 1800), [])
        said = self.ask("Where is Ann right now?")
        self.assertRegex(said, r"^At .* Ann was at Ann's quay\. A newer place was asked for at .*; it may not come\.$")
        asked = said.rsplit(" at ", 1)[1].split(";")[0]
        # It has not moved since: what it posts by itself is as old as before.
        self.assertEqual(self.locate("Ann", HARBOUR, 1700), [REPORT])
        # Whoever asks again hears since when, and nothing of what became of it.
        self.assertIn(f"A newer place was asked for at {asked};", self.ask("Where is Ann this very moment?"))
        self.assertEqual(self.locate("Ann", HARBOUR, 1600), [], "once")
        # What it reports is a place of now: nothing newer is wanted.
        self.locate("Ann", HARBOUR, 0)
        self.assertEqual(self.ask("Where is Ann right now?"), "Ann is at Ann's quay.")

    def test_a_question_that_is_not_about_this_moment_makes_no_phone_work(self):
        self.locate("Ann", HARBOUR, 1800)
        self.assertNotIn("newer", self.ask("Where is Ann?"))
        self.assertNotIn("newer", self.ask("Where is Ann now?"))
        self.assertEqual(self.locate("Ann", HARBOUR, 1700), [])

    def test_other_phones_hear_nothing(self):
        self.locate("Otto", MARKET, 1800)
        self.assertIn("A newer place was asked for", self.ask("Where is Otto right now?"))
        self.assertEqual(self.locate("Otto", MARKET, 1700), [])

    def test_whoever_hides_is_asked_nothing_and_reads_like_whom_nobody_knows(self):
        self.locate("Ann", HARBOUR, 1800)
        self.service.command("hide", "Ann")
        hidden, unknown = self.ask("Where is Ann right now?"), self.ask("Where is Zoe right now?")
        self.assertEqual(hidden.replace("Ann", "Zoe"), unknown)
        self.assertNotIn("newer", hidden)
        self.assertEqual(self.locate("Ann", HARBOUR, 1700), [])
        self.service.command("show", "Ann")
        self.assertEqual(self.locate("Ann", HARBOUR, 0), [])

    def test_it_is_asked_and_said_in_other_languages(self):
        self.locate("Ann", HARBOUR, 1800)
        self.assertIn("wurde um einen neueren Ort gebeten", self.ask("Wo ist Ann jetzt gerade?", "--language", "de"))
        self.assertIn("新しい位置を求めました", self.ask("Annは今すぐどこ？", "--language", "ja"))
        self.assertEqual(self.locate("Ann", HARBOUR, 1700), [REPORT])


if __name__ == "__main__":
    unittest.main()
