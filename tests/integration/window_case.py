"""Windows of the program on a virtual display, for tests."""
import os
import pathlib
import subprocess
import tempfile
import time
import unittest

from virtual_display import VirtualDisplay


def wait_for(what, condition, seconds=30.0):
    deadline = time.monotonic() + seconds
    while time.monotonic() < deadline:
        if found := condition():
            return found
        time.sleep(0.05)
    raise AssertionError(f"{what} did not come")


class WindowCase(unittest.TestCase):
    """A display for the class; a folder of its own and an environment for each test, with no desktop around it."""

    @classmethod
    def setUpClass(cls):
        display = VirtualDisplay("1300x900")
        cls.addClassCleanup(display.stop)
        cls.display = display.name

    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        os.chmod(folder.name, 0o700)
        self.folder = pathlib.Path(folder.name)
        self.environment = {**os.environ, "DISPLAY": self.display, "XDG_RUNTIME_DIR": folder.name, "LANG": "C.UTF-8",
                            "XDG_STATE_HOME": str(self.folder / "state"), "QT_QPA_PLATFORM": "xcb", "NO_AT_BRIDGE": "1"}

    def xdotool(self, *arguments, check=True):
        return subprocess.run(["xdotool", *map(str, arguments)], env=self.environment, capture_output=True, text=True,
                              check=check).stdout.strip()

    def find_window(self):
        self.window = wait_for("the window", lambda: self.xdotool("search", "--onlyvisible", "--name", "^ktr$",
                                                                  check=False).split()[:1])[0]
