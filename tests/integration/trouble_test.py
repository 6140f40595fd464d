#!/usr/bin/python3
"""What the user gets to see when something around the program is wrong: one line with the cause, soon, and no signal."""

import json
import os
import pathlib
import socket
import subprocess
import sys
import tempfile
import time
import unittest

PROGRAM = os.environ["KTR_PROGRAM"]


class TroubleTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.preferences = self.folder / "state" / "ktr" / "preferences" / "org.ktr.snippets.json"
        self.preferences.parent.mkdir(parents=True)
        token = self.folder / "token"
        token.write_text("secret\n")
        token.chmod(0o600)
        # Nobody listens there.
        with socket.create_server(("127.0.0.1", 0)) as free:
            host = f"localhost:{free.getsockname()[1]}"
        self.config = {"account": {"personId": "1000", "host": host}, "positions": {"source": "none"}}

    def run_live(self, config=None, before=(), **environment):
        text = config if isinstance(config, str) else json.dumps(config or self.config)
        (self.folder / "config.json").write_text(text)
        words = {k: v for k, v in os.environ.items() if k not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM", "KTR_LOG")}
        words.update(KTR_CONFIG=str(self.folder / "config.json"), XDG_STATE_HOME=str(self.folder / "state"),
                     DBUS_SESSION_BUS_ADDRESS="disabled:", DBUS_SYSTEM_BUS_ADDRESS="disabled:", **environment)
        begin = time.monotonic()
        result = subprocess.run([*before, PROGRAM, "describe", "--live", "0.2s", "--ask", "Where are my friends?", "--language",
                                 "en-GB"], env=words, capture_output=True, timeout=300, text=True, encoding="utf-8")
        result.seconds = time.monotonic() - begin
        return result

    def test_track_that_is_not_there(self):
        result = self.run_live({**self.config, "positions": {"source": "track", "file": "nowhere.gpx"}})
        self.assertEqual(result.stderr.count("nowhere.gpx"), 1, result.stderr)
        self.assertRegex(result.stderr, r"positions: .*/nowhere\.gpx: .*no such file")

    def test_preferences_that_are_junk(self):
        self.preferences.write_text("junk")
        result = self.run_live()
        self.assertEqual(result.stderr.count("org.ktr.snippets.json"), 1, result.stderr)
        self.assertRegex(result.stderr, r"preferences: .*/org\.ktr\.snippets\.json:1:1: ")

    def test_preferences_that_are_a_folder(self):
        self.preferences.mkdir()
        result = self.run_live()
        self.assertEqual(result.stderr.count("org.ktr.snippets.json"), 1, result.stderr)

    def test_broken_configuration_is_one_line(self):
        result = self.run_live('{"account": {"personId": 5}}')
        self.assertEqual(result.returncode, 1)
        self.assertEqual(len(result.stderr.splitlines()), 1, result.stderr)
        self.assertRegex(result.stderr, r"account: .*/config\.json:1:\d+: \$\.account\.personId: expected ")
        self.assertIn("Your settings cannot be read.", result.stdout)
        self.assertNotIn("Sign in", result.stdout)

    def test_missing_token_is_named_once(self):
        self.config["account"]["tokenFile"] = "other-token"
        result = self.run_live()
        self.assertEqual(result.stderr.count("other-token"), 1, result.stderr)
        self.assertIn("Sign in", result.stderr)

    def test_restricted_device_asks_nothing(self):
        with socket.create_server(("127.0.0.1", 0)) as service:
            service.settimeout(0.1)
            self.config["account"]["host"] = f"localhost:{service.getsockname()[1]}"
            for restrictions in ({"friendLocationRestricted": True}, {"friendLocationAllowed": False}):
                with self.subTest(restrictions):
                    result = self.run_live({**self.config, "restrictions": restrictions})
                    self.assertIn("Friends’ locations are switched off on this device.", result.stdout)
                    self.assertRaises(TimeoutError, service.accept)

    def silent(self, name):
        """The address of a bus that takes connections and says nothing."""
        bus = socket.socket(socket.AF_UNIX)
        self.addCleanup(bus.close)
        bus.bind(str(self.folder / name))
        bus.listen(20)
        return f"unix:path={self.folder / name}"

    def test_silent_buses_hold_nothing_up(self):
        (self.folder / "config.json").write_text("{}")
        environment = {"DBUS_SESSION_BUS_ADDRESS": self.silent("session"), "DBUS_SYSTEM_BUS_ADDRESS": self.silent("system")}
        before = ["env", *(f"{name}={address}" for name, address in environment.items())]
        result = self.run_live({**self.config, "positions": {"source": "geoclue"}}, before)
        # Each call would wait for 25 seconds, the secret for 60.
        self.assertLess(result.seconds, 20, result.stderr)
        self.assertIn("the session's message bus does not answer", result.stderr)
        self.assertIn("the system's message bus does not answer", result.stderr)
        self.assertNotIn("Sign in", result.stdout + result.stderr)

    def start(self, *command, **environment):
        process = subprocess.Popen(command, env={**os.environ, **environment}, stdout=subprocess.PIPE, text=True)
        self.addCleanup(lambda: (process.kill(), process.wait(), process.stdout.close()))
        return process, process.stdout.readline().strip()

    def test_silent_secret_service_beside_a_token_file(self):
        _, bus = self.start("dbus-daemon", "--session", "--print-address", "--nofork")
        silent = ('import dbus, time; bus = dbus.SessionBus(); name = dbus.service.BusName("org.freedesktop.secrets", bus); '
                  'print("there", flush=True); time.sleep(300)')
        _, there = self.start("/usr/bin/python3", "-c", "import dbus.service; " + silent, DBUS_SESSION_BUS_ADDRESS=bus)
        self.assertEqual(there, "there")
        result = self.run_live(before=["env", f"DBUS_SESSION_BUS_ADDRESS={bus}"])
        self.assertLess(result.seconds, 20, result.stderr)
        self.assertNotIn("Sign in", result.stdout + result.stderr)

    def test_working_folder_that_has_gone_ends_nothing_with_a_signal(self):
        words = dict(os.environ, KTR_CONFIG="config.json", XDG_STATE_HOME=str(self.folder / "state"),
                     DBUS_SESSION_BUS_ADDRESS="disabled:", DBUS_SYSTEM_BUS_ADDRESS="disabled:")
        words.pop("QT_QPA_PLATFORM", None)
        for command, status in ((["config", "list"], 0), (["config", "set", "textSize", "XL"], 1), (["describe", "x.json"], 3),
                                (["ask", "Hello"], 16), (["watch", "--print"], 1), (["serve", "--ca-dir", "x"], 1)):
            with self.subTest(command):
                gone = self.folder / "gone"
                gone.mkdir()
                result = subprocess.run(["sh", "-c", 'cd "$0" && rmdir "$0" && exec "$@"', gone, PROGRAM, *command], env=words,
                                        capture_output=True, timeout=60, text=True, check=False)
                self.assertEqual(result.returncode, status, result.stderr)

    def test_few_files_is_a_failure_that_says_so(self):
        for files in (6, 8, 10, 12, 15, 16, 24, 32):
            with self.subTest(files):
                result = self.run_live(before=["sh", "-c", f'ulimit -n {files}; exec "$@"', "sh"])
                self.assertEqual(result.returncode, 1, result.stderr)
                self.assertIn("too few files may be open at a time", result.stderr)


if __name__ == "__main__":
    sys.exit(unittest.main())
