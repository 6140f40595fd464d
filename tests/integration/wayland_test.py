#!/usr/bin/python3
"""The window on Wayland, in a compositor without a screen: it comes by itself where that is all there is, says whose it is, and draws.
Skipped without weston and Qt's plugin for Wayland."""

import glob
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import time
import unittest

PROGRAM = os.environ["KTR_PROGRAM"]
SCENARIO = pathlib.Path(os.environ["KTR_SOURCE"]) / "resources" / "scenarios" / "single.json"


class WaylandTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        os.chmod(folder.name, 0o700)
        self.folder = pathlib.Path(folder.name)
        self.environment = {k: v for k, v in os.environ.items() if k not in ("DISPLAY", "QT_QPA_PLATFORM")}
        self.environment.update({"XDG_RUNTIME_DIR": folder.name, "XDG_STATE_HOME": folder.name, "WAYLAND_DISPLAY": "wayland-test",
                                 "DBUS_SESSION_BUS_ADDRESS": "disabled:", "LANG": "C.UTF-8"})
        self.run_beside(["weston", "--backend=headless-backend.so", "--socket=wayland-test", "--use-pixman"], "weston")
        self.wait_for("the compositor", (self.folder / "wayland-test").exists)

    def run_beside(self, command, name, **more):
        log = self.folder / name
        with log.open("w") as stream:
            program = subprocess.Popen([*map(str, command)], env={**self.environment, **more}, stdout=stream, stderr=stream)
        self.addCleanup(program.wait)
        self.addCleanup(program.kill)
        return program, log

    def wait_for(self, what, condition):
        deadline = time.monotonic() + 30
        while not condition():
            self.assertLess(time.monotonic(), deadline, f"{what} does not come")
            time.sleep(0.1)

    def test_window_comes_by_itself_says_whose_it_is_and_draws(self):
        program, log = self.run_beside([PROGRAM, "show", SCENARIO, "--language", "en-GB"], "ktr", WAYLAND_DEBUG="1")
        for words in ('set_title("ktr")', 'set_app_id("org.ktr.ktr")', ".attach(wl_buffer", ".commit("):
            self.wait_for(words, lambda words=words: words in log.read_text(errors="replace"))
        self.assertIsNone(program.poll())
        said = [line for line in log.read_text(errors="replace").splitlines() if line and not line.startswith("[")]
        self.assertEqual(said, [])


if __name__ == "__main__":
    if not shutil.which("weston") or not glob.glob("/usr/lib/*/qt6/plugins/platforms/libqwayland*.so"):
        print("weston and Qt's plugin for Wayland are not installed")
        sys.exit(77)
    unittest.main()
