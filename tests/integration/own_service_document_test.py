#!/usr/bin/env python3
"""Follows docs/your-own-service.md from nothing to the first friend seen, word for word: only the host's name, a free port and
the folder are those of this test. The phone is a stand-in of either kind.

  own_service_document_test.py SERVICE PROGRAM DOCUMENT [unittest options]
"""
import json
import os
import pathlib
import re
import shlex
import signal
import sqlite3
import subprocess
import sys
import tempfile
import time
import unittest

from own_service import free_port
from phone import Phone

SERVICE, PROGRAM, DOCUMENT = (pathlib.Path(sys.argv.pop(1)).resolve() for _ in range(3))
HOST = "home.example"
ANN = (50.21043, -3.12051)


def section(title):
    """The lines of a section of the document that are to be typed or saved."""
    text = re.search(rf"^## {title}\n(.*?)^## ", DOCUMENT.read_text(encoding="utf-8"), re.M | re.S).group(1)
    return [re.sub(r"^    ", "", block, flags=re.M).strip() for block in re.findall(r"(?:^    .*\n)+", text, re.M)]


class DocumentTest(unittest.TestCase):
    def setUp(self):
        # "Until midnight" shall last longer than the test.
        local = time.localtime()
        left = 86400 - (local.tm_hour * 3600 + local.tm_min * 60 + local.tm_sec)
        time.sleep(left + 1 if left < 300 else 0)
        self.home = pathlib.Path(tempfile.mkdtemp(prefix="ktr-document-"))
        self.addCleanup(lambda: subprocess.run(["rm", "-rf", os.fspath(self.home)], check=True))
        (self.home / "bin").mkdir()
        for program in (SERVICE, PROGRAM):
            (self.home / "bin" / program.name).symlink_to(program)
        self.port = free_port()
        self.environment = {name: value for name, value in os.environ.items() if not name.startswith(("XDG_", "KTR_"))}
        self.environment.update(HOME=str(self.home), PATH=f"{self.home}/bin:{os.environ['PATH']}",
                                QT_QPA_PLATFORM="offscreen", LC_ALL="en_US.UTF-8")
        self.server_commands = []
        self.service = None

    def here(self, line):
        """A line of the document on this machine."""
        return line.replace(f"--host {HOST}", f"--host localhost --port {self.port}").replace("0.0.0.0", "127.0.0.1")

    def type(self, line):
        if line.startswith("ktr-service serve"):
            self.service = subprocess.Popen(shlex.split(self.here(line)), env=self.environment, cwd=self.home,
                                            stdout=subprocess.PIPE, text=True)
            self.addCleanup(self.stop)
            self.assertTrue(self.service.stdout.readline().startswith("ready "))
            return ""
        done = subprocess.run(["bash", "-c", self.here(line)], env=self.environment, cwd=self.home, capture_output=True,
                              text=True, timeout=120, check=False)
        self.assertEqual(done.returncode, 0, (line, done.stdout, done.stderr))
        return done.stdout

    def stop(self):
        if self.service.poll() is None:
            self.service.send_signal(signal.SIGTERM)
        self.service.wait(timeout=30)
        self.service.stdout.close()

    def phone(self, kind, printed):
        """A phone into which somebody types what `add` printed: three fields, and no more."""
        fields = dict(re.findall(r"^  (URL|User name|Password) +(\S+)$", printed, re.M))
        self.assertEqual(len(fields), 3, printed)
        phone = Phone(kind, fields["URL"], fields["User name"], fields["Password"], self.authority())
        self.addCleanup(phone.close)
        return phone

    def authority(self):
        return str(self.home / ".local/share/ktr-service/ca.pem")

    def time_passes(self, seconds):
        """As if all that has happened so far had happened earlier."""
        database = sqlite3.connect(self.home / ".local/share/ktr-service/service.db", timeout=20)
        database.execute("UPDATE share SET since = since - ?", (seconds,))
        database.execute("UPDATE fix SET time = time - ?, heard = heard - ?", (seconds, seconds))
        database.commit()
        database.close()

    def follow(self, kind):
        server, plain, question, asking, sister = section("From nothing to the first friend seen")
        lines = server.splitlines()
        self.assertLessEqual(len(lines), 4, "at most four commands on the server")
        self.assertTrue(all(line.startswith("ktr-service ") for line in lines))
        printed = {line.split()[2]: self.type(line) for line in lines}
        (self.home / "where-is-ann.json").write_text(question)
        self.assertEqual(json.loads(question)["question"], "Where is Ann?")

        phone = self.phone(kind, printed["Ann"])
        # On the way without a network, and with one that breaks: what was noticed first comes first, and nothing is lost.
        phone.online = False
        phone.locate(49.0, -3.0, time.time() - 2)
        phone.locate(*ANN, time.time() - 1)
        self.assertFalse(phone.send())
        phone.online = True
        self.assertTrue(phone.send())
        self.assertEqual((phone.lost, phone.alerts), (0, []))
        self.time_passes(3600)
        phone.locate(*ANN, time.time() - 130)
        self.assertTrue(phone.send())

        # In plain words, with nothing but what `add` wrote.
        self.assertRegex(self.type(plain), r"^At \d[^\n]* Ann was [^\n]*near [^\n]*\n$", "it is two minutes old")
        shows = [line for line in asking.splitlines() if "describe" in line]
        answer = self.type(shows[0])
        self.assertIn("Where is Ann?", answer)
        self.assertRegex(answer, r"Ann[^\n]*2\u00a0minutes ago")
        self.assertIn("Accurate to 39 feet", answer)

        *wishes, asks = sister.splitlines()
        printed = [self.type(line) for line in wishes]
        self.assertIn("no place known for Ann", self.type(asks), "what was before the grant is not seen")
        phone.locate(*ANN)
        self.assertTrue(phone.send())
        self.time_passes(3600)
        seen = self.type(asks)
        self.assertIn("Accurate to 1.", seen, "a cell of a town, in miles")
        self.assertNotIn("feet", seen)
        # Zoe's own phone is told the same, and no more.
        zoe = self.phone(kind, printed[0])
        zoe.locate(51.0, -3.0)
        self.assertTrue(zoe.send())
        self.assertEqual(list(zoe.contacts), ["owntracks/http/Ann"])
        told = zoe.contacts["owntracks/http/Ann"].location
        self.assertGreaterEqual(told["acc"], 2000)
        self.assertEqual(told["tst"] % 900, 0)
        for name, exact in zip(("lat", "lon"), ANN):
            self.assertNotAlmostEqual(told[name], exact, 3)
        # Until midnight: one second later, nothing.
        database = sqlite3.connect(self.home / ".local/share/ktr-service/service.db", timeout=20)
        (until,), = database.execute("SELECT until FROM share WHERE until IS NOT NULL").fetchall()
        database.close()
        self.assertEqual(time.localtime(until)[3:6], (0, 0, 0))
        self.assertLessEqual(until - time.time(), 25 * 3600)
        return phone

    def test_with_a_phone_of_the_one_kind(self):
        phone = self.follow("android")
        # The service is away: the phone keeps what it has, and sends it in order when it is back.
        self.stop()
        for number in range(3):
            phone.locate(50.3 + number / 100, -3, time.time() - 30 + number)
        self.assertFalse(phone.send())
        self.assertEqual(len(phone.queue), 3)
        self.type(next(line for line in section("From nothing to the first friend seen")[0].splitlines() if " serve" in line))
        self.assertTrue(phone.send())
        self.assertIn("Accurate to 39 feet", self.type("ktr describe --live 3s where-is-ann.json"))

    def test_with_a_phone_of_the_other_kind(self):
        phone = self.follow("ios")
        # A secret that ended: this kind drops what it cannot send, and tells its owner; nobody is locked out of the rest.
        self.type("ktr-service revoke Ann")
        phone.locate(50.5, -3)
        self.assertTrue(phone.send())
        self.assertEqual(phone.alerts, [401])


if __name__ == "__main__":
    unittest.main(warnings="ignore")
