#!/usr/bin/python3
"""What somebody hears who only listens, and somebody who has walked the window's tree: announcements and name changes of a
live window with `ktr serve` behind it, over the accessibility bus of a session of its own. Skipped without a virtual display,
a session bus, xdotool and pyatspi."""

import json
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import time
import unittest

from screen_session import outside, tree
from serve import Service

PROGRAM = os.environ["KTR_PROGRAM"]
FOREVER = 100000


def waypoint(at, label, north=0.0, **more):
    return {"at": at, "label": label, "latitude": 50.2104 + north, "longitude": -3.12, **more}


def friend(first, last, track, **more):
    handle = f"{first.lower()}@harbour.example"
    return {"fullName": f"{first} {last}", "firstName": first, "emails": [handle], "track": track, **more}


class Listener:
    """Collects what comes over the bus from one program: (seconds since the start, kind, text)."""

    def __init__(self, process):
        import pyatspi

        self.heard = []
        self._begin = time.monotonic()
        self._process = process
        self._registry = pyatspi.Registry
        self._kinds = ("object:state-changed:showing", "object:property-change:accessible-name", "object:announcement")
        self._registry.registerEventListener(self._take, *self._kinds)

    def _take(self, event):
        from gi.repository import GLib

        try:
            if event.host_application.get_process_id() != self._process.pid:
                return
            if event.type.startswith("object:property-change"):
                self._note("name", event.source.name)
            elif event.type.startswith("object:announcement"):
                self._note("announcement", str(event.any_data))
            elif event.detail1 == 1 and event.source.getRoleName() == "notification":
                self._note("announcement", event.source.name)
        except (AttributeError, RuntimeError, LookupError, GLib.Error):
            pass

    def _note(self, kind, text):
        self.heard.append((time.monotonic() - self._begin, kind, text.replace("\u00a0", " ")))

    def listen(self, seconds, until=None):
        """Runs the bus for so long, or until so many announcements have come."""
        from gi.repository import GLib

        loop = GLib.MainLoop()
        deadline = time.monotonic() + seconds

        def look():
            over = time.monotonic() > deadline or (until is not None and len(self.announcements) >= until)
            if over:
                loop.quit()
            return not over

        GLib.timeout_add(50, look)
        loop.run()

    def texts(self, kind):
        return [text for _, one, text in self.heard if one == kind]

    @property
    def announcements(self):
        return self.texts("announcement")

    def close(self):
        self._registry.deregisterEventListener(self._take, *self._kinds)


class HeardTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.environment = {**os.environ, "LANG": "C.UTF-8", "XDG_STATE_HOME": str(self.folder / "state"),
                            "XDG_CONFIG_HOME": str(self.folder / "config"), "QT_LINUX_ACCESSIBILITY_ALWAYS_ON": "1",
                            "QT_QPA_PLATFORM": "xcb", "KTR_CONFIG": str(self.folder / "config.json")}

    def serve(self, friends, *options):
        path = self.folder / "friends.json"
        path.write_text(json.dumps({"friends": friends}))
        service = Service(PROGRAM, "--friends", path, "--write-config", self.folder / "config.json", *options)
        self.addCleanup(service.__exit__)
        return service

    def xdotool(self, *arguments, check=True):
        return subprocess.run(["xdotool", *map(str, arguments)], env=self.environment, capture_output=True, text=True,
                              check=check).stdout.strip()

    def window_of(self, program):
        found = self.xdotool("search", "--onlyvisible", "--pid", program.pid, "--name", "^ktr$", check=False).split()
        return found[0] if found else None

    def open(self, *options):
        """A window that has the keyboard, and a listener that has heard everything of it."""
        program = subprocess.Popen([PROGRAM, "show", "--print-urls", "--language", "en-GB", *options],
                                   env=self.environment, stdout=subprocess.DEVNULL)
        self.addCleanup(program.wait)
        self.addCleanup(program.kill)
        listener = Listener(program)
        self.addCleanup(listener.close)
        deadline = time.monotonic() + 30
        while not (window := self.window_of(program)) and time.monotonic() < deadline:
            time.sleep(0.05)
        self.xdotool("windowfocus", "--sync", window)
        return listener, window

    def walk(self, listener):
        """Every node's name, asked once the rows are there."""
        for _ in range(100):
            listener.listen(0.1)
            if names := [node.name for node in tree(listener._process.pid) if node.getRoleName() == "link"]:
                return names
        raise AssertionError("no rows on the bus")

    def here(self):
        """The user stands still."""
        path = self.folder / "here.gpx"
        point = '<trkpt lat="50.2104" lon="-3.12"><time>2026-01-01T00:{:02}:00Z</time></trkpt>'
        path.write_text(f"<gpx><trk><trkseg>{point.format(0)}{point.format(30)}</trkseg></trk></gpx>")
        return path

    def spend_an_evening(self, walks):
        """Ann walks about at home. Otto comes to another place, hides, and shows himself again; the service goes; the user
        hides, and shows themselves, which brings the service back."""
        ann = friend("Ann", "Marsh", [waypoint(0, "Home", 0.001), waypoint(FOREVER, "Home", 5.0)], repeats=False)
        otto = friend("Otto", "Brandt", [waypoint(0, "Work", 0.002), waypoint(22, "Gym", 0.002),
                                         waypoint(40, "Gym", 0.002, hidden=True), waypoint(58, "Gym", 0.002)],
                      repeats=False)
        # Requests are counted, two a second, since each takes its time: when one fails, nobody asks any more until the next wish.
        self.serve([ann, otto], "--interval", "0.4", "--positions", self.here(),
                   "--fault", "status=503,at=150,count=1", "--fault", "delay=0.1")
        listener, _ = self.open("--ask", "where are my friends")
        names = self.walk(listener) if walks else []
        listener.listen(300, until=5)
        for wish in ("hide my location", "share my location"):
            before = len(listener.announcements)
            self.xdotool("type", "--delay", 5, wish)
            self.xdotool("key", "Return")
            listener.listen(30, until=before + 1)
        listener.listen(13)
        return listener, names

    def check_an_evening(self, heard):
        # The answer says when it was true, and how far each was then.
        answer = re.compile(r"At [\d:]+(\sAM|\sPM)? Ann Marsh was at home, \d+\s\w+ away\. "
                            r"At [\d:]+(\sAM|\sPM)? Otto Brandt was at work, \d+\s\w+ away\. People: 2\.")
        heard = [answer.sub("ANSWER.", text) for text in heard]
        things = ["ANSWER.", "Otto Brandt: Gym.",
                  "Otto Brandt is no longer visible.",
                  "Otto Brandt is visible again: Gym.",
                  "Your friends are out of reach. What is shown may be old.",
                  "Friends can’t see where you are.", "Friends can see where you are, as you allowed.",
                  "Your friends are within reach again."]
        for thing in things:
            self.assertEqual(sum(text.count(thing) for text in heard), 1, (thing, heard))
        self.assertEqual(heard[:5], things[:5])
        rest = " ".join(heard)
        for thing in things:
            rest = rest.replace(thing, "")
        self.assertEqual(rest.strip(), "", "nothing else is said")

    def test_listener_who_never_looked_hears_each_thing_once(self):
        listener, _ = self.spend_an_evening(walks=False)
        self.check_an_evening(listener.announcements)
        times = [at for at, kind, _ in listener.heard if kind == "announcement"]
        self.assertTrue(all(later - earlier > 9 for earlier, later in zip(times, times[1:])), times)
        # A button that does something else from now on is called otherwise.
        names = [name for name in listener.texts("name") if name not in ("Send", "Stop", "Check-up", "-")]
        self.assertEqual(names, [], "who has not looked is not told of names")

    def test_listener_who_walked_the_tree_hears_each_thing_once_and_of_metres_once_a_minute(self):
        begin = time.monotonic()
        listener, names = self.spend_an_evening(walks=True)
        self.assertTrue(names[0].startswith("Ann Marsh, Place: Home, "), names)
        self.check_an_evening(listener.announcements)
        minutes = (time.monotonic() - begin) / 60
        of_ann = [text for text in listener.texts("name") if text.startswith("Ann Marsh")]
        self.assertLessEqual(len(of_ann), minutes + 1, of_ann)
        self.assertTrue(any(text.startswith("Otto Brandt, Place: Gym") for text in listener.texts("name")), listener.heard)

    def test_metres_alone_are_not_announced(self):
        ann = friend("Ann", "Marsh", [waypoint(0, "Home", 0.001), waypoint(FOREVER, "Home", 5.0)])
        otto = friend("Otto", "Brandt", [waypoint(0, "Work", 0.002)])
        self.serve([ann, otto], "--interval", "0.5", "--positions", self.here())
        listener, _ = self.open("--ask", "where are my friends")
        listener.listen(30, until=1)
        self.assertEqual(len(listener.announcements), 1)
        listener.listen(12)
        self.assertEqual(len(listener.announcements), 1, "over twenty polls")

    def test_window_that_is_not_used_says_nothing(self):
        ann = friend("Ann", "Marsh", [waypoint(0, "Home"), waypoint(25, "Gym")], repeats=False)
        otto = friend("Otto", "Brandt", [waypoint(0, "Work", 0.002)])
        self.serve([ann, otto], "--interval", "0.5")
        listener, _ = self.open("--ask", "where are my friends")
        listener.listen(20, until=1)
        self.assertEqual(len(listener.announcements), 1)
        # Another window takes the keyboard.
        other = subprocess.Popen(["xeyes"], env=self.environment)
        self.addCleanup(other.wait)
        self.addCleanup(other.kill)
        deadline = time.monotonic() + 20
        while not (found := self.xdotool("search", "--onlyvisible", "--name", "xeyes", check=False).split()) \
                and time.monotonic() < deadline:
            time.sleep(0.05)
        self.xdotool("windowfocus", "--sync", found[0])
        listener.listen(28)
        self.assertEqual(len(listener.announcements), 1, "Ann has moved meanwhile")


if __name__ == "__main__":
    if "KTR_INSIDE" not in os.environ:
        sys.exit(outside(__file__, "xdotool", seconds=590))
    unittest.main()
