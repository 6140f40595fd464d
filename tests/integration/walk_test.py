#!/usr/bin/python3
"""A phone walks from work to home through the demo town, and somebody watches: the street names in a real window, one "left
work" and one "arrived home" on the desktop, and no other word. Skipped without a virtual display, a session bus and pyatspi."""

import contextlib
import json
import math
import os
import pathlib
import re
import sqlite3
import subprocess
import sys
import time
import unittest

import accessibility_test
import service_program
from accessibility_test import nodes, outside, wait_for

SERVICE = os.environ["KTR_SERVICE"]
PROGRAM = os.environ["KTR_PROGRAM"]
MAP = os.environ["KTR_MAP"]
NOTIFICATIONS = "org.freedesktop.Notifications"
WORK, HOME = (50.213113, -3.1161), (50.215666, -3.125993)
STREETS = ["Lantern Street", "Church Street"]
# Of the fixes: a step of Ann's, seconds.
STEP = 40
RADIUS = 100
AGENT = "Owntracks-Android/gms/420600004"


def distance(one, other):
    """Metres, on so small a part of the earth."""
    north = (one[0] - other[0]) * 111230
    east = (one[1] - other[1]) * 111230 * math.cos(math.radians(one[0]))
    return math.hypot(north, east)


def walk():
    """From work to home: latitude, longitude and the street in which that is."""
    file = pathlib.Path(os.environ["KTR_SOURCE"]) / "resources/service/friends.json"
    track = json.loads(file.read_text(encoding="utf-8"))["friends"][1]["track"]
    begin = next(number for number, place in enumerate(track) if place.get("label") == "Work")
    end = next(number for number, place in enumerate(track) if number > begin and place.get("label") == "Home")
    return [(place["latitude"], place["longitude"], place["street"]) for place in track[begin:end + 1]]


class WalkTest(accessibility_test.WindowTest):
    def setUp(self):
        self.service = service_program.ServiceProgram(self, SERVICE)
        self.service.command("maps", MAP)
        self.phone = self.service.add("Ann")
        self.service.add("Mara")
        for name, place in (("Work", WORK), ("Home", HOME)):
            self.service.command("place", "Ann", "--name", name, "--label", name.lower(), "--said", "--radius", str(RADIUS),
                                 "--at", f"{place[0]},{place[1]}")
        self.service.command("share", "Ann", "Mara", "--fences")
        with contextlib.closing(sqlite3.connect(self.service.folder / "data" / "service.db")) as database:
            # As if all was agreed hours ago: a walk of many minutes then takes no time.
            database.execute("UPDATE share SET since = since - 14400")
            database.commit()
        folder = self.service.folder
        configuration = self.service.command("reader", "Mara", "--token-file", str(folder / "token"))
        (folder / "config.json").write_text(configuration[configuration.index("{"):configuration.rindex("}") + 1])
        (folder / "config.json").chmod(0o600)
        self.token = (folder / "token").read_text().strip()
        (folder / "ann.json").write_text(json.dumps({"question": "Where is Ann?", "snippet": {
            "kind": "VAKtrLocationSnippet", "searchContext": "ktrServerContext://serverContext?clientId=own&minCallbackIntervalInMS=1000&callbackTimeoutIntervalInMS=600000&",
            "locations": [{"friend": {"data": "ann@x.example", "object": {
                "fullName": "Ann", "emails": [{"emailAddress": "ann@x.example"}]}}}]}}))
        self.environment = {"KTR_CONFIG": str(folder / "config.json"), "XDG_STATE_HOME": str(folder / "state")}
        self.clock = int(time.time()) - 100 * STEP
        self.shown = folder / "shown"
        self.service.start("--socket", self.service.socket, "--address", "127.0.0.1")

    def at(self, latitude, longitude):
        self.clock += STEP
        status, answer = self.service.request(
            "POST", "/pub", json.dumps({"_type": "location", "lat": latitude, "lon": longitude, "tst": self.clock, "acc": 10,
                                        "tid": "an"}), False, ("Ann", self.phone),
            **{"Content-Type": "application/json", "User-Agent": AGENT})
        self.assertEqual(status, 200, answer)

    def fence(self, trigger, place):
        status, answer = self.service.request(
            "POST", service_program.COMMANDS + "setFence",
            json.dumps({"clientContext": {}, "handle": "ann@x.example", "trigger": trigger, "place": {"name": place}}), False,
            ("Mara", self.token), **{"Content-Type": "application/json", "X-Orcha-Seek-API-Ver": "4.0",
                                     "X-Orcha-AuthScheme": "Forever"})
        self.assertEqual(status, 200, answer)

    def start_notifications(self):
        """A notification server that writes down what it was told to show."""
        with self.shown.open("w") as stream:
            server = subprocess.Popen(["/usr/bin/python3", "-u", "-m", "dbusmock", "--session", NOTIFICATIONS,
                                       "/org/freedesktop/Notifications", NOTIFICATIONS], stdout=stream)
        self.addCleanup(server.wait)
        self.addCleanup(server.terminate)
        wait_for("the notification server", lambda: subprocess.run(
            ["gdbus", "call", "--session", "-d", NOTIFICATIONS, "-o", "/org/freedesktop/Notifications", "-m",
             "org.freedesktop.DBus.Mock.AddMethod", NOTIFICATIONS, "Notify", "susssasa{sv}i", "u", "ret = args[1] or 1"],
            capture_output=True, check=False).returncode == 0)

    def notifications(self):
        """Title and body of each, in order."""
        return re.findall(r' Notify "ktr" \d+ "" "([^"]*)" "([^"]*)"', self.shown.read_text())

    def start_watch(self):
        self.start_notifications()
        watch = subprocess.Popen([PROGRAM, "watch", "--language", "en"], env={
            **os.environ, **self.environment, "DBUS_SYSTEM_BUS_ADDRESS": "unix:path=/nonexistent"})
        self.addCleanup(watch.wait)
        self.addCleanup(watch.terminate)
        wait_for("the event stream", lambda: self.service.numbers(True)["ktr_service_event_streams"] == 1)

    def requests(self):
        return sum(number for name, number in self.service.numbers(True).items()
                   if name.startswith("ktr_service_requests_total") and 'route="getlocations"' in name)

    def row(self):
        """What the window's row says."""
        return next(node.name for node in nodes(self.frame) if node.getRoleName() == "link" and node.name.startswith("Ann"))

    def place(self):
        found = re.search(r"Place: (.*?), (?:Located|Updated|\d)", self.row().replace("\u00a0", " "))
        return found.group(1) if found else self.row()

    def wait_for_place(self, wanted):
        try:
            wait_for(wanted, lambda: self.place() == wanted, 15)
        except AssertionError:
            self.fail(f"the row says {self.row()!r}, and not {wanted!r}")

    def test_walk_from_work_to_home(self):
        self.at(*WORK)
        self.fence("OnDeparture", "work")
        self.fence("OnArrival", "home")
        self.start_watch()
        tree, _ = self.open(2, str(self.service.folder / "ann.json"), "--live", "--language", "en-GB", environment=self.environment)
        self.frame = tree[0]
        self.wait_for_place("Work")
        # Nothing happens: each question waits at the service for ten seconds.
        before, began = self.requests(), time.monotonic()
        time.sleep(25)
        asked, seconds = self.requests() - before, time.monotonic() - began
        self.assertLessEqual(asked, seconds / 10 + 2, "the window's questions are held")
        self.assertGreaterEqual(asked, 2)
        said = ["Work"]
        for latitude, longitude, street in walk()[1:]:
            self.at(latitude, longitude)
            posted = time.monotonic()
            edges = [distance((latitude, longitude), place) - RADIUS for place in (WORK, HOME)]
            if any(abs(edge) < 25 for edge in edges):
                time.sleep(1.5)  # either is right
            else:
                wanted = "Work" if edges[0] < 0 else "Home" if edges[1] < 0 else f"{street}, Brinmouth"
                self.wait_for_place(wanted)
                self.assertLess(time.monotonic() - posted, 8.0, "live: below what a held answer waits at most")
            if self.place() != said[-1]:
                said.append(self.place())
        self.at(*HOME)
        self.wait_for_place("Home")
        said += ["Home"] if said[-1] != "Home" else []
        self.assertEqual(said, ["Work", *(f"{street}, Brinmouth" for street in STREETS), "Home"])
        wait_for("two notifications", lambda: len(self.notifications()) >= 2)
        time.sleep(3)
        self.assertEqual([f"{title}: {body}" for title, body in self.notifications()], ["Ann: Left: Work", "Ann: Arrived: Home"])


if __name__ == "__main__":
    if "KTR_INSIDE" not in os.environ:
        sys.exit(outside(__file__, seconds=400))
    unittest.main()
