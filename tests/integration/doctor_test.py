#!/usr/bin/python3
"""`ktr doctor` beside a service that is well and ones that are not, and beside peers that say nothing: what is wrong is named with
what mends it, and nobody waits for ever."""

import json
import os
import pathlib
import socket
import subprocess
import tempfile
import time
import unittest

from serve import Service

PROGRAM = os.environ["KTR_PROGRAM"]


class DoctorTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.config = self.folder / "config.json"
        self.environment = {**os.environ, "KTR_CONFIG": str(self.config), "XDG_STATE_HOME": str(self.folder / "state"),
                            "DBUS_SESSION_BUS_ADDRESS": "disabled:", "DBUS_SYSTEM_BUS_ADDRESS": "disabled:", "LC_ALL": "C.UTF-8"}

    def serve(self):
        """A development service, and a configuration for it."""
        service = Service(PROGRAM, "--write-config", self.folder / "served.json")
        self.addCleanup(service.__exit__)
        return json.loads((self.folder / "served.json").read_text())

    def doctor(self, configuration, *arguments, **environment):
        if configuration is not None:
            self.config.write_text(json.dumps(configuration))
            self.config.chmod(0o600)
        return subprocess.run([PROGRAM, "doctor", *arguments], env={**self.environment, **environment}, capture_output=True,
                              text=True, timeout=120)

    def findings(self, configuration, **environment):
        result = self.doctor(configuration, "--json", **environment)
        told = json.loads(result.stdout)
        self.assertEqual(result.returncode, 0 if told["ok"] else 1)
        for finding in told["findings"]:
            if finding["state"] == "wrong":
                self.assertTrue(finding["remedy"], finding)
        return {finding["thing"]: finding for finding in told["findings"]}

    def test_service_that_is_well_is_fine_and_a_wrong_secret_is_told(self):
        made = self.serve()
        found = self.findings(made)
        for thing in ("settings", "account", "secret", "name", "service", "redirect", "contacts"):
            self.assertEqual(found[thing]["state"], "fine", found[thing])
        self.assertRegex(found["service"]["words"], r"after \d+ ms")
        token = pathlib.Path(made["account"]["tokenFile"])
        secret = token.read_text().strip()
        other = self.folder / "other-token"
        other.write_text("wrong\n")
        other.chmod(0o600)
        made["account"]["tokenFile"] = str(other)
        found = self.findings(made)
        self.assertEqual(found["service"]["state"], "wrong")
        self.assertIn("person and secret together", found["service"]["words"])
        made["certificates"] = []
        self.assertIn("cannot prove", self.findings(made)["service"]["words"])
        told = self.doctor(made)
        self.assertNotIn(secret, told.stdout + told.stderr)

    def test_nobody_signed_in_is_one_thing_and_not_ten(self):
        found = self.findings(None)
        self.assertEqual(found["account"]["state"], "wrong")
        for thing in ("secret", "name", "service", "clock", "redirect"):
            self.assertEqual(found[thing]["state"], "not used", thing)

    def test_broken_settings_and_missing_files_are_named(self):
        self.config.write_text('{"language": 5}')
        self.config.chmod(0o600)
        self.assertIn("language", self.findings(None)["settings"]["words"])
        found = self.findings({"contacts": ["gone.vcf"], "maps": {"sources": [{"file": "gone.mbtiles"}]},
                               "positions": {"source": "track", "file": "gone.gpx"}})
        for thing in ("contacts", "maps", "position"):
            self.assertEqual(found[thing]["state"], "wrong", found[thing])
            self.assertIn(str(self.folder / "gone."), found[thing]["words"])

    def test_track_is_read_and_added_maps_count(self):
        track = self.folder / "walk.gpx"
        os.mkfifo(track)
        positions = {"positions": {"source": "track", "file": "walk.gpx"}}
        self.assertIn("a pipe", self.findings(positions)["position"]["words"])
        track.unlink()
        track.write_text("hello")
        self.assertEqual(self.findings(positions)["position"]["state"], "wrong")
        track.write_text('<gpx><wpt lat="50.2" lon="-3.1"/></gpx>')
        self.assertEqual(self.findings(positions)["position"]["state"], "fine")
        data = {"XDG_DATA_HOME": str(self.folder / "data")}
        self.assertEqual(self.findings({}, **data)["maps"]["state"], "not used")
        town = pathlib.Path(PROGRAM).parent.parent / "share" / "ktr" / "maps" / "brinmouth.mbtiles"
        subprocess.run([PROGRAM, "maps", "add", str(town)], env={**self.environment, **data}, check=True, capture_output=True)
        self.assertEqual(self.findings({}, **data)["maps"]["words"], "1 map with streets")

    def test_silent_host_and_silent_bus_are_not_waited_for(self):
        # Both take every connection and say nothing.
        with socket.create_server(("127.0.0.1", 0)) as host, socket.socket(socket.AF_UNIX) as bus:
            path = str(self.folder / "bus")
            bus.bind(path)
            bus.listen(16)
            token = self.folder / "token"
            token.write_text("secret\n")
            token.chmod(0o600)
            made = {"account": {"personId": "1", "host": f"localhost:{host.getsockname()[1]}", "tokenFile": "token"}}
            began = time.monotonic()
            found = self.findings(made, DBUS_SESSION_BUS_ADDRESS=f"unix:path={path}", DBUS_SYSTEM_BUS_ADDRESS=f"unix:path={path}")
            self.assertLess(time.monotonic() - began, 30)
            for thing in ("service", "position", "screen reader", "portals"):
                self.assertEqual(found[thing]["state"], "wrong", found[thing])


if __name__ == "__main__":
    unittest.main()
