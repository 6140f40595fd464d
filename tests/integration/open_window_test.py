#!/usr/bin/python3
"""An open window, as assistive technology sees it over the accessibility bus of a session of its own: its text grows and
shrinks with the desktop's, and everything that it says by itself is looked up. Skipped without a virtual display, a
session bus and pyatspi."""

import json
import os
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import time
import unittest

import mock_bus
from screen_session import SYSTEM_PYTHON, outside, tree
from serve import Service

PROGRAM = os.environ["KTR_PROGRAM"]
SCENARIOS = pathlib.Path(os.environ["KTR_SOURCE"]) / "resources" / "scenarios"

# Desktop settings that say GNOME's text size: each line on the standard input is another one.
PORTAL = """
import sys
import dbus.service
from dbus.mainloop.glib import DBusGMainLoop
from gi.repository import GLib

SETTINGS = "org.freedesktop.portal.Settings"
WHAT = ("org.gnome.desktop.interface", "text-scaling-factor")

class Portal(dbus.service.Object):
    scale = 1.0

    @dbus.service.method(SETTINGS, in_signature="ss", out_signature="v")
    def Read(self, group, key):
        if (group, key) != WHAT:
            raise dbus.exceptions.DBusException("not found", name="org.freedesktop.portal.Error.NotFound")
        return dbus.Double(self.scale, variant_level=1)

    @dbus.service.signal(SETTINGS, signature="ssv")
    def SettingChanged(self, group, key, value):
        pass

def take(*_):
    line = sys.stdin.readline()
    if not line:
        loop.quit()
        return False
    portal.scale = float(line)
    portal.SettingChanged(*WHAT, dbus.Double(portal.scale, variant_level=1))
    return True

DBusGMainLoop(set_as_default=True)
bus = dbus.SessionBus()
portal = Portal(bus, "/org/freedesktop/portal/desktop")
name = dbus.service.BusName("org.freedesktop.portal.Desktop", bus)
loop = GLib.MainLoop()
GLib.io_add_watch(0, GLib.IO_IN | GLib.IO_HUP, take)
print("there", flush=True)
loop.run()
"""


class OpenWindow(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory(ignore_cleanup_errors=True)
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        (self.folder / "config").mkdir()
        self.environment = {**os.environ, "QT_LINUX_ACCESSIBILITY_ALWAYS_ON": "1", "QT_QPA_PLATFORM": "xcb",
                            "LC_ALL": "C.UTF-8", "XDG_CONFIG_HOME": str(self.folder / "config"),
                            "XDG_STATE_HOME": str(self.folder / "state"), "XDG_CURRENT_DESKTOP": "",
                            "KTR_CONFIG": str(self.folder / "config.json")}

    def open(self, *arguments):
        self.program = subprocess.Popen([PROGRAM, "show", *map(str, arguments)], env=self.environment,
                                        stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        self.addCleanup(self.program.wait)
        self.addCleanup(self.program.kill)

    def tree(self):
        return tree(self.program.pid)

    def wait_for(self, what, condition, seconds=60):
        from gi.repository import GLib

        deadline = time.monotonic() + seconds
        while time.monotonic() < deadline:
            try:
                if result := condition():
                    return result
            except (AttributeError, RuntimeError, LookupError, GLib.Error):
                pass
            time.sleep(0.1)
        raise AssertionError(f"{what} did not come; {[(node.getRoleName(), node.name) for node in self.tree()]}")


class DesktopTextSizeTest(OpenWindow):
    def rows(self):
        """What the rows say, and how high they are."""
        import pyatspi

        links = [node for node in self.tree() if node.getRoleName() == "link"]
        return [(link.name, link.queryComponent().getExtents(pyatspi.DESKTOP_COORDS).height) for link in links]

    def check(self, larger, usual):
        """The rows follow what `larger` and `usual` do to the desktop's text."""
        self.open(SCENARIOS / "dinner.json")
        before = self.wait_for("six rows", lambda: len(rows := self.rows()) == 6 and rows)
        larger()
        after = self.wait_for("large rows", lambda: len(rows := self.rows()) == 6
                              and all(row[1] > 1.5 * old[1] for row, old in zip(rows[:5], before)) and rows)
        self.assertEqual([name for name, _ in after], [name for name, _ in before])
        usual()
        self.wait_for("the rows as they were", lambda: self.rows() == before)

    def portal(self):
        portal = subprocess.Popen([SYSTEM_PYTHON, "-c", PORTAL], stdin=subprocess.PIPE, stdout=subprocess.PIPE, text=True)
        self.addCleanup(lambda: (portal.kill(), portal.wait(), portal.stdin.close(), portal.stdout.close()))
        self.assertEqual(portal.stdout.readline(), "there\n")

        def say(scale):
            portal.stdin.write(f"{scale}\n")
            portal.stdin.flush()
        return say

    def test_gnomes_text_size_makes_the_cards_anew(self):
        say = self.portal()
        self.environment["XDG_CURRENT_DESKTOP"] = "GNOME"
        self.check(lambda: say(2.5), lambda: say(1.0))

    def test_gnomes_text_size_counts_nowhere_else(self):
        say = self.portal()
        self.environment["XDG_CURRENT_DESKTOP"] = "XFCE"
        self.open(SCENARIOS / "dinner.json")
        before = self.wait_for("six rows", lambda: len(rows := self.rows()) == 6 and rows)
        say(2.5)
        time.sleep(3)
        self.assertEqual(self.rows(), before)

    def test_kdes_font_makes_the_cards_anew(self):
        self.environment["XDG_CURRENT_DESKTOP"] = "KDE"

        def write(points):
            beside = self.folder / "config" / "kdeglobals.new"
            beside.write_text(f"[General]\nfont=Noto Sans,{points},-1,5,50,0,0,0,0,0\n")
            beside.rename(self.folder / "config" / "kdeglobals")

        write(10)
        self.check(lambda: write(25), lambda: write(10))


@unittest.skipUnless(mock_bus.is_possible() and shutil.which("xwd"), "python3-dbusmock or xwd is not installed")
class AccentTest(OpenWindow):
    """The ring of the keyboard's focus has the colour that the desktop's user has chosen, while the window is open."""

    NAME, PATH, SETTINGS = "org.freedesktop.portal.Desktop", "/org/freedesktop/portal/desktop", "org.freedesktop.portal.Settings"

    def mock(self, method, *arguments):
        return subprocess.run(["gdbus", "call", "--session", "-d", self.NAME, "-o", self.PATH, "-m",
                               f"org.freedesktop.DBus.Mock.{method}", *arguments], capture_output=True, check=False).returncode == 0

    def painted(self, red, green, blue):
        """How many pixels of the screen have this colour."""
        screen = subprocess.run(["xwd", "-silent", "-root"], env=self.environment, capture_output=True, check=True).stdout
        pixels = screen[len(screen) % 4:]
        wanted = bytes((blue, green, red))
        return sum(pixels[i:i + 3] == wanted for i in range(0, len(pixels), 4))

    def test_ring_has_the_chosen_colour_and_another_one_once_that_is_chosen(self):
        portal = subprocess.Popen([SYSTEM_PYTHON, "-m", "dbusmock", "--session", self.NAME, self.PATH, self.SETTINGS],
                                  stdout=subprocess.DEVNULL)
        self.addCleanup(portal.wait)
        self.addCleanup(portal.terminate)
        # Violet, 5C2480.
        reply = ("ret = dbus.Struct((92 / 255, 36 / 255, 128 / 255), signature='ddd', variant_level=1) "
                 "if args[1] == 'accent-color' else dbus.UInt32(0, variant_level=1)")
        self.wait_for("the portal", lambda: self.mock("AddMethod", self.SETTINGS, "Read", "ss", "v", reply))
        self.open(SCENARIOS / "dinner.json", "--light")
        self.wait_for("six rows", lambda: len([node for node in self.tree() if node.getRoleName() == "link"]) == 6)
        window = subprocess.run(["xdotool", "search", "--onlyvisible", "--name", "^ktr$"], env=self.environment, text=True,
                                capture_output=True, check=True).stdout.split()[0]
        subprocess.run(["xdotool", "windowfocus", "--sync", window, "key", "Tab"], env=self.environment, check=True)
        self.wait_for("a violet ring", lambda: self.painted(0x5C, 0x24, 0x80) > 200)
        self.assertTrue(self.mock("EmitSignal", self.SETTINGS, "SettingChanged", "ssv",
                                  "[<'org.freedesktop.appearance'>, <'accent-color'>, <<(0.0, 0.4, 0.0)>>]"))
        self.wait_for("a green ring", lambda: self.painted(0, 102, 0) > 200)
        self.assertEqual(self.painted(0x5C, 0x24, 0x80), 0)
        self.assertTrue(self.mock("EmitSignal", self.SETTINGS, "SettingChanged", "ssv",
                                  "[<'org.freedesktop.appearance'>, <'accent-color'>, <<(-1.0, -1.0, -1.0)>>]"))
        self.wait_for("the program's own colour", lambda: self.painted(0x1E, 0x66, 0x53) > 200)


class PseudoLanguageTest(OpenWindow):
    """What has no accents in a pseudo-language, and is nobody's own, was not looked up. Answers are in the language in which was
    asked, and nobody asks in a pseudo-language."""

    OWN = ("Zofia Zabek", "Ferry Pier", "zofia@harbour.example", "where are my friends", "hide my location", "Mara Lind", "ktr",
           "brin.example")
    ANSWERS = re.compile(r"At \d+:\d+.[AP]M Zofia Zabek was at Ferry Pier\.|Friends can’t see where you are\.|"
                         r"Sign in, then I’ll tell you\.|Your service didn’t answer\.|^Sign in$|^Try again$")
    PLAIN = re.compile("[AaCcDdEeGgIiLlNnOoRrSsTtUuWwYyZz]+")

    def texts(self):
        # The toolkit describes the program by its file.
        return [text for node in self.tree() if node.getRoleName() != "application"
                for text in (node.name, node.description) if text]

    def check(self, *, until):
        """Every text of the window, once there is one that holds each of these."""
        wanted = [re.compile(one) for one in until]
        texts = self.wait_for(until, lambda: all(any(one.search(text) for text in texts) for one in wanted) and texts
                              if (texts := self.texts()) else None)
        for text in texts:
            left = self.ANSWERS.sub("", text)
            for own in sorted(self.OWN, key=len, reverse=True):
                left = left.replace(own, "")
            self.assertIsNone(self.PLAIN.search(left), f"not looked up: {text}")
            self.assertEqual(text.count("["), text.count("]"), f"cut: {text}")

    def serve(self, **changes):
        (self.folder / "friends.json").write_text(json.dumps({"friends": [{
            "fullName": "Zofia Zabek", "emails": ["zofia@harbour.example"],
            "track": [{"at": 0, "label": "Ferry Pier", "latitude": 50.2114, "longitude": -3.115}]}]}))
        service = Service(PROGRAM, "--friends", self.folder / "friends.json", "--write-config", self.folder / "config.json",
                          "--interval", "0.5")
        self.addCleanup(service.__exit__)
        config = json.loads((self.folder / "config.json").read_text())
        config = {name: value for name, value in {**config, **changes}.items() if value is not None}
        (self.folder / "config.json").write_text(json.dumps(config))
        return service

    def ask(self, question):
        window = self.wait_for("the window", lambda: subprocess.run(
            ["xdotool", "search", "--onlyvisible", "--pid", str(self.program.pid), "--name", "^ktr$"], capture_output=True,
            text=True, check=False, env=self.environment).stdout.split()[:1])[0]
        for arguments in (["windowfocus", "--sync", window], ["type", "--delay", "5", question], ["key", "Return"]):
            subprocess.run(["xdotool", *arguments], check=True, env=self.environment)

    def test_answers_and_their_status(self):
        service = self.serve()
        for language in ("qps", "qps-plocm"):
            with self.subTest(language):
                self.open("--language", language, "--ask", "where are my friends")
                # Field, button, question and answer, title, row, status.
                self.check(until=["Zofia Zabek.*Ferry Pier", "·"])
                self.program.kill()
        self.open("--language", "qps", "--ask", "hide my location")
        self.check(until=["Mara Lind", "Friends can’t see", "Ľöčáťíöñ|híďďéñ"])
        self.program.kill()
        self.open("--language", "qps", "--ask", "where are my friends")
        self.check(until=["Zofia Zabek.*Ferry Pier"])
        service.end()
        self.check(until=["Öffľíñé"])
        self.ask("where are my friends")
        self.check(until=["řéáčh.*"])

    def test_nobody_is_signed_in(self):
        self.serve(account=None)
        self.open("--language", "qps", "--ask", "where are my friends")
        self.check(until=["Šíğñ íñ"])

    def test_settings_that_cannot_be_read(self):
        self.serve(account={"personId": 5})
        self.open("--language", "qps", "--ask", "where are my friends")
        self.check(until=["šéťťíñğš"])

    def test_device_that_allows_nothing(self):
        self.serve(restrictions={"friendLocationRestricted": True})
        self.open("--language", "qps", "--ask", "where are my friends")
        self.check(until=["šŵíťčhéď öff"])


if __name__ == "__main__":
    if "KTR_INSIDE" not in os.environ:
        sys.exit(outside(__file__, "xdotool", modules=("pyatspi", "dbus.service"), seconds=560))
    unittest.main()
