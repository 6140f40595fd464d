#!/usr/bin/env python3
"""The units that systemd starts the service with: whole, and closed to all that it does not need.

  unit_test.py SERVICE [unittest options]
"""
import os
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import unittest

SERVICE = sys.argv.pop(1)
PACKAGING = pathlib.Path(os.environ["KTR_SOURCE"]) / "packaging"
HIGHEST = 1.5


@unittest.skipUnless(shutil.which("systemd-analyze"), "systemd-analyze is not installed")
class UnitTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory(prefix="ktr-units-")
        self.addCleanup(folder.cleanup)
        self.root = pathlib.Path(folder.name)
        self.units = self.root / "etc/systemd/system"
        self.units.mkdir(parents=True)
        for name in ("ktr-service.service", "ktr-service.socket"):
            shutil.copy(PACKAGING / name, self.units)
        program = self.root / "usr/bin/ktr-service"
        program.parent.mkdir(parents=True)
        program.touch(0o755)

    def analyze(self, *words):
        done = subprocess.run(["systemd-analyze", f"--root={self.root}", "--no-pager", *words], capture_output=True,
                              text=True, timeout=60, check=False, env={**os.environ, "LC_ALL": "C.UTF-8"})
        return done.stdout + done.stderr

    def exposure(self):
        text = self.analyze("security", "--offline=true", "ktr-service.service")
        self.assertNotIn("Unknown", text)
        return float(re.search(r"Overall exposure level for ktr-service.service: ([0-9.]+)", text).group(1))

    def home_network(self):
        folder = self.units / "ktr-service.service.d"
        folder.mkdir()
        shutil.copy(PACKAGING / "home-network.conf", folder)

    def test_service_is_exposed_to_little(self):
        self.assertLessEqual(self.exposure(), HIGHEST)

    def test_service_of_a_home_network_is_exposed_to_little(self):
        closed = self.exposure()
        self.home_network()
        self.assertGreater(self.exposure(), closed, "the drop-in is read")
        self.assertLessEqual(self.exposure(), HIGHEST)

    def test_units_are_understood(self):
        self.home_network()
        text = self.analyze("verify", "ktr-service.service", "ktr-service.socket")
        # Of the rest of the system nothing lies in this folder.
        about = [line for line in text.splitlines() if "sysinit.target" not in line and "not found" not in line]
        self.assertEqual(about, [], text)

    def test_the_users_unit_may_write_where_its_state_is(self):
        """Wherever that is in the user's home: systemd names another folder before version 254 than from then on."""
        unit = (PACKAGING / "ktr-watch.service.in").read_text()
        directives = dict(re.findall(r"^(\w+)=(.*)$", unit, re.MULTILINE))
        self.assertEqual(directives["ProtectSystem"], "full", "strict closes the home as well")
        self.assertEqual(directives.keys() & {"ProtectHome", "ReadOnlyPaths", "InaccessiblePaths", "ReadWritePaths"}, set())

    def test_commands_of_the_units_are_those_of_the_program(self):
        words = " ".join(re.findall(r"^ExecStart=(.*\S)", (PACKAGING / "ktr-service.service").read_text()
                                    + (PACKAGING / "home-network.conf").read_text(), re.MULTILINE)).split()
        usage = subprocess.run([SERVICE, "serve", "--help"], capture_output=True, text=True, timeout=60, check=True).stdout
        usage += subprocess.run([SERVICE, "--help"], capture_output=True, text=True, timeout=60, check=True).stdout
        options = {word for word in words if word.startswith("--")}
        self.assertEqual(options, {"--data", "--address"})
        for option in options:
            self.assertIn(option, usage)


if __name__ == "__main__":
    unittest.main(warnings="ignore")
