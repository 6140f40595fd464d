#!/usr/bin/python3
"""What nobody sees does not ask: the live window on a virtual display, hidden as window managers hide windows, with `ktr serve`
behind it. Skipped without Xvfb, xdotool, xprop, gdbus and dbus-daemon."""

import json
import os
import shutil
import subprocess
import sys
import time
import unittest

import mock_bus
from serve import Service
from window_case import WindowCase

PROGRAM = os.environ["KTR_PROGRAM"]
INTERVAL = 0.5
LOGIND, MANAGER, SESSION = "org.freedesktop.login1", "/org/freedesktop/login1", "/org/freedesktop/login1/session/_31"


class UnseenTest(WindowCase):
    def serve(self, *options):
        config = self.folder / "config.json"
        self.service = Service(PROGRAM, "--write-config", config, "--interval", str(INTERVAL), *options)
        self.addCleanup(self.service.__exit__)
        self.environment["KTR_CONFIG"] = str(config)

    def walk(self):
        """Served to a user who walks on and on."""
        walk = self.folder / "walk.json"
        walk.write_text(json.dumps({"sentence": "-", "positions": [
            {"at": n, "latitude": 50.2 + n * 1e-3, "longitude": -3.1} for n in range(300)]}))
        self.serve("--positions", walk)

    def open(self, question):
        program = subprocess.Popen([PROGRAM, "show", "--language", "en-GB", "--ask", question], env=self.environment)
        self.addCleanup(program.wait)
        self.addCleanup(program.terminate)
        self.find_window()

    def xprop(self, *words):
        subprocess.run(["xprop", *words], env=self.environment, check=True, stdout=subprocess.DEVNULL)

    def asked(self, command="getlocations"):
        """Asked of the service since this was called last."""
        lines = self.service.process.stdout
        os.set_blocking(lines.fileno(), False)
        count = (lines.buffer.read() or b"").count(b": " + command.encode())
        os.set_blocking(lines.fileno(), True)
        return count

    def wait_until_asked(self, command="getlocations"):
        deadline = time.monotonic() + 30
        while not self.asked(command):
            self.assertLess(time.monotonic(), deadline, "it does not ask")
            time.sleep(0.05)

    def assert_asks_nothing(self, why):
        # What was on its way when the window went is over at some time.
        deadline = time.monotonic() + 30
        self.asked()
        time.sleep(6 * INTERVAL)
        while self.asked():
            self.assertLess(time.monotonic(), deadline, why)
            time.sleep(6 * INTERVAL)

    def test_window_that_is_hidden_or_elsewhere_asks_nothing_and_asks_when_it_is_back(self):
        self.walk()
        self.open("Where are my friends?")
        self.wait_until_asked()
        self.xprop("-id", self.window, "-f", "_NET_WM_STATE", "32a", "-set", "_NET_WM_STATE", "_NET_WM_STATE_HIDDEN")
        self.assert_asks_nothing("minimised by a compositing window manager, which leaves it mapped")
        self.xprop("-id", self.window, "-remove", "_NET_WM_STATE")
        self.wait_until_asked()
        self.xprop("-root", "-f", "_NET_CURRENT_DESKTOP", "32c", "-set", "_NET_CURRENT_DESKTOP", "0")
        self.xprop("-id", self.window, "-f", "_NET_WM_DESKTOP", "32c", "-set", "_NET_WM_DESKTOP", "1")
        self.assert_asks_nothing("on another workspace")
        self.xprop("-root", "-f", "_NET_CURRENT_DESKTOP", "32c", "-set", "_NET_CURRENT_DESKTOP", "1")
        self.wait_until_asked()
        self.xprop("-id", self.window, "-f", "_NET_WM_DESKTOP", "32c", "-set", "_NET_WM_DESKTOP", "4294967295")
        self.asked()
        self.wait_until_asked()
        subprocess.run(["xdotool", "windowunmap", "--sync", self.window], env=self.environment, check=True)
        self.assert_asks_nothing("taken off the screen")
        subprocess.run(["xdotool", "windowmap", "--sync", self.window], env=self.environment, check=True)
        self.wait_until_asked()

    def start_logind(self):
        """A login manager on a system bus of the test's own, which says whether the session is locked."""
        self.bus = mock_bus.MockBus(self.folder)
        self.addCleanup(self.bus.stop)
        self.environment["DBUS_SYSTEM_BUS_ADDRESS"] = self.bus.address
        self.bus.play(LOGIND, MANAGER, f"{LOGIND}.Manager")
        self.assertTrue(self.bus.tell(LOGIND, MANAGER, "AddMethod", f"{LOGIND}.Manager", "GetSessionByPID", "u", "o",
                                      f"ret = dbus.ObjectPath('{SESSION}')"))
        self.assertTrue(self.bus.tell(LOGIND, MANAGER, "AddObject", SESSION, f"{LOGIND}.Session", "{'LockedHint': <false>}",
                                      "@a(ssss) []"))

    def lock(self, locked):
        self.assertTrue(self.bus.tell(LOGIND, SESSION, "UpdateProperties", f"{LOGIND}.Session",
                                      f"{{'LockedHint': <{str(locked).lower()}>}}"))

    def test_locked_session_asks_nothing_and_asks_when_it_is_unlocked(self):
        self.walk()
        self.start_logind()
        self.open("Where are my friends?")
        self.wait_until_asked()
        self.lock(True)
        self.assert_asks_nothing("behind a lock")
        self.lock(False)
        self.wait_until_asked()

    def test_sharing_ends_where_nobody_sees_it(self):
        self.walk()
        self.open("Share my location")
        self.wait_until_asked("showHideLocation")
        self.xprop("-id", self.window, "-f", "_NET_WM_STATE", "32a", "-set", "_NET_WM_STATE", "_NET_WM_STATE_HIDDEN")
        time.sleep(4 * INTERVAL)
        self.asked()
        time.sleep(6 * INTERVAL)
        self.assertEqual(self.asked("showHideLocation"), 0)
        self.xprop("-id", self.window, "-remove", "_NET_WM_STATE")
        time.sleep(6 * INTERVAL)
        self.assertEqual(self.asked("showHideLocation"), 0, "what would have shown the user is given up, not held")

    def test_two_starts_of_a_card_are_one_request(self):
        # An answer takes its time, as anywhere but on one machine, and nobody moves: two questions are alike.
        self.serve("--fault", f"delay={INTERVAL / 2}")
        self.open("Where are my friends?")
        self.wait_until_asked()
        self.asked()
        begin = time.monotonic()
        time.sleep(10 * INTERVAL)
        count = self.asked()
        rounds = (time.monotonic() - begin) / (1.5 * INTERVAL)
        self.assertGreater(count, 1)
        self.assertLessEqual(count, 1.5 * rounds + 1, "one an interval, though the card started twice")


if __name__ == "__main__":
    if not all(shutil.which(tool) for tool in ("Xvfb", "xdotool", "xprop", "gdbus", "dbus-daemon")):
        print("skipped: Xvfb, xdotool, xprop, gdbus and dbus-daemon are needed")
        sys.exit(77)
    unittest.main()
