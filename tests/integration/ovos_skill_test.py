"""The skill on a message bus, with the real `ktr` and a real service behind it."""
import json
import os
import pathlib
import signal
import sqlite3
import stat
import subprocess
import sys
import time
import unittest

from bus_double import BusDouble
from service_program import ServiceProgram

SERVICE, KTR, SKILL = sys.argv[1:4]
VCARD = "BEGIN:VCARD\r\nVERSION:3.0\r\nN:{0};;;;\r\nFN:{0}\r\nEMAIL:{1}@x.example\r\nEND:VCARD\r\n"


class OvosSkillTest(unittest.TestCase):
    def setUp(self):
        self.service = ServiceProgram(self, SERVICE)
        self.phones = {name: self.service.add(name) for name in ("Ann", "Otto", "Lea", "Mara")}
        self.service.command("share", "Ann", "Mara", "--aloud")
        self.service.command("share", "Lea", "Mara")
        folder = self.folder = self.service.folder
        text = self.service.command("reader", "Mara", "--token-file", str(folder / "token"))
        configuration = json.loads(text[text.index("{"):text.rindex("}") + 1])
        (folder / "contacts.vcf").write_text("".join(VCARD.format(name, name.lower()) for name in self.phones))
        configuration["contacts"] = [str(folder / "contacts.vcf")]
        (folder / "config.json").write_text(json.dumps(configuration))
        (folder / "config.json").chmod(0o600)
        # As if all was agreed hours ago: only what was later is seen.
        database = sqlite3.connect(folder / "data" / "service.db")
        database.execute("UPDATE share SET since = since - 14400")
        database.commit()
        database.close()
        self.service.start()
        for name in ("Ann", "Otto", "Lea"):
            status, answer = self.service.post(name, self.phones[name], _type="location", lat=50.2171, lon=-3.1118, acc=12,
                                               tst=int(time.time()) - 3600)
            self.assertEqual(status, 200, answer)
        (folder / "run").mkdir(mode=0o700)
        self.environment = {**os.environ, "KTR_CONFIG": str(folder / "config.json"), "XDG_STATE_HOME": str(folder / "state"),
                            "XDG_RUNTIME_DIR": str(folder / "run"), "PYTHONPATH": SKILL,
                            "DBUS_SESSION_BUS_ADDRESS": "unix:path=/nonexistent",
                            "DBUS_SYSTEM_BUS_ADDRESS": "unix:path=/nonexistent"}
        self.bus = BusDouble()
        self.addCleanup(self.bus.stop)
        self.addCleanup(lambda: self.assertEqual(self.bus.faults, []))

    def start(self, *options):
        self.process = subprocess.Popen([sys.executable, "-m", "ktr_ovos_skill", "--bus", self.bus.url, "--ktr", KTR,
                                         "--patience", "60", *options], env=self.environment)
        self.addCleanup(lambda: self.process.poll() is not None or (self.process.kill(), self.process.wait()))
        self.assertIsNotNone(self.bus.wait_for_type("ovos.skills.fallback.register"))

    def end(self):
        self.process.send_signal(signal.SIGTERM)
        self.assertEqual(self.process.wait(timeout=30), 0)

    def pictures(self):
        return list((self.folder / "run").rglob("*.png"))

    def terminal(self, question, language="en-GB"):
        return subprocess.run([KTR, "ask", question, "--language", language], env=self.environment,
                              capture_output=True, text=True, timeout=60, check=False).stdout.strip()

    def test_says_what_the_terminal_says_and_shows_a_private_picture_for_a_while(self):
        self.start("--shown", "3")
        said, handled = self.bus.ask("where is ann")
        self.assertEqual((said, handled), ([self.terminal("where is ann")], True))
        value = self.bus.wait_for_type("gui.value.set")["data"]
        page = self.bus.wait_for_type("gui.page.show")["data"]
        self.assertEqual(page["page_names"], ["SYSTEM_ImageFrame"])
        picture = pathlib.Path(value["image"])
        self.assertEqual(picture.read_bytes()[:8], b"\x89PNG\r\n\x1a\n")
        self.assertEqual(stat.S_IMODE(picture.stat().st_mode) & 0o077, 0)
        self.assertEqual(stat.S_IMODE(picture.parent.stat().st_mode), 0o700)
        self.assertIsNotNone(self.bus.wait_for_type("gui.clear.namespace"))
        self.assertEqual(self.pictures(), [])
        self.end()
        self.assertEqual(list((self.folder / "run").iterdir()), [])

    def test_only_who_may_be_said_aloud_is_told_of(self):
        self.start()
        unseen, handled = self.bus.ask("where is otto")
        self.assertTrue(handled)
        self.assertEqual(self.bus.ask("where is lea"), ([unseen[0].replace("Otto", "Lea")], True))
        self.assertNotIn("can’t", self.terminal("where is lea"))
        self.assertEqual(self.pictures(), [], "nobody to be seen, nothing to show")

    def test_nothing_is_changed_and_what_is_not_understood_is_left_to_others(self):
        self.start("--no-picture")
        said = {tuple(self.bus.ask(wish)[0]) for wish in (
            "hide my location", "share my location with ann", "tell me when ann leaves home", "who can see me")}
        self.assertEqual(len(said), 1, said)
        self.assertEqual(len(said.pop()), 1)
        for nothing in ("tell me a joke", "", "x" * 100_000, "--help", "-o/tmp/x", "where is ann\0"):
            self.assertEqual(self.bus.ask(nothing), ([], False), nothing[:20])

    def test_a_question_in_another_language_is_answered_in_it(self):
        self.start("--no-picture")
        said, handled = self.bus.ask("wo ist ann", "de-de")
        self.assertTrue(handled)
        self.assertEqual(said, [self.terminal("wo ist ann", "de-DE")])
        for lang in ("en;rm", "", "x" * 1000):
            self.assertTrue(self.bus.ask("where is ann", lang)[1])

    def test_what_is_no_message_does_no_harm_and_it_comes_back_to_a_bus_that_went(self):
        self.start("--no-picture")
        for junk in ("", "{", "[]", "null", '{"type":5}', '{"type":"ovos.skills.fallback.ping","data":[],"context":7}',
                     json.dumps({"type": "ovos.skills.fallback.ktr-skill.ktr.request", "data": {"utterances": [{}]}}),
                     "[" * 100_000, '{"type":"\\ud800"}', "x" * 1_000_000):
            self.bus.raw(junk)
        self.assertIsNotNone(self.bus.wait_for_type("ovos.skills.fallback.ktr-skill.ktr.response"))
        self.assertTrue(self.bus.ask("where is ann")[1])
        since = len(self.bus.heard)
        self.bus.drop()
        self.assertIsNotNone(self.bus.wait_for_type("ovos.skills.fallback.register", since))
        self.assertTrue(self.bus.ask("where is ann")[1])
        since = len(self.bus.heard)
        self.bus.say("mycroft.ready", {})
        self.assertIsNotNone(self.bus.wait_for_type("ovos.skills.fallback.register", since))

    def test_killed_it_leaves_a_picture_only_until_the_next_start(self):
        self.start()
        self.bus.ask("where is ann")
        self.assertIsNotNone(self.bus.wait_for_type("gui.page.show"))
        self.assertEqual(len(self.pictures()), 1)
        self.process.kill()
        self.process.wait()
        self.bus.heard.clear()
        self.start()
        self.assertEqual(self.pictures(), [])

    def test_without_the_program_nothing_is_said(self):
        self.start("--ktr", "/nonexistent/ktr")
        self.assertEqual(self.bus.ask("where is ann"), ([], False))

    def test_a_program_that_says_something_else_is_passed_over_each_time(self):
        other = self.folder / "other"
        other.write_text('#!/bin/sh\nfor word; do case $word in --output=*) : >"${word#--output=}";; esac; done\necho "[1]"\n')
        other.chmod(0o700)
        self.start("--ktr", str(other))
        for _ in range(2):
            self.assertEqual(self.bus.ask("where is ann"), ([], False))

    def test_it_can_be_installed(self):
        source, target = self.folder / "source", self.folder / "installed"
        subprocess.run(["cp", "-r", SKILL, source], check=True)
        subprocess.run([sys.executable, "-m", "pip", "install", "--quiet", "--no-index", "--no-deps", "--no-build-isolation",
                        "--target", target, source], check=True, env={**os.environ, "PIP_ROOT_USER_ACTION": "ignore"})
        done = subprocess.run([target / "bin" / "ktr-ovos-skill", "--help"], env={**os.environ, "PYTHONPATH": str(target)},
                              capture_output=True, text=True, check=True)
        self.assertIn("ws://127.0.0.1:8181/core", done.stdout)


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1] + sys.argv[4:])
