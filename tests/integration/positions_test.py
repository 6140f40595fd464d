#!/usr/bin/python3
"""Where the user is, in the real program: from GeoClue, from gpsd and from a GPX track, and without any, which is no failure."""

import json
import os
import pathlib
import re
import socket
import subprocess
import sys
import tempfile
import threading
import unittest

import mock_bus
from serve import Service

PROGRAM = os.environ["KTR_PROGRAM"]
# Two kilometres south of the friend.
HERE = (51.432, -2.6)
DISTANCE = "1.2\N{NO-BREAK SPACE}mi"


class Gpsd:
    """Says once where it is, and hangs up when it is told to; then nobody listens there any more."""

    def __init__(self):
        self.asked = []
        self.released = threading.Event()
        self.listening = socket.create_server(("127.0.0.1", 0))
        self.port = self.listening.getsockname()[1]
        self.thread = threading.Thread(target=self.serve, daemon=True)
        self.thread.start()

    def serve(self):
        connection, _ = self.listening.accept()
        self.listening.close()
        self.asked.append(connection.recv(1000))
        report = {"class": "TPV", "mode": 3, "lat": HERE[0], "lon": HERE[1], "eph": 6.5}
        connection.sendall(json.dumps(report).encode() + b"\n")
        self.released.wait(30)
        connection.close()

    def stop(self):
        self.released.set()
        self.thread.join(timeout=30)


class PositionsTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        friends = self.folder / "friends.json"
        friends.write_text(json.dumps({"friends": [
            {"fullName": "Ann Marsh", "firstName": "Ann", "emails": ["ann@harbour.example"],
             "track": [{"at": 0, "latitude": 51.45, "longitude": -2.6, "label": "Home"}]}]}))
        self.config = self.folder / "config.json"
        service = Service(PROGRAM, "--friends", friends, "--write-config", self.config, "--interval", "0.3")
        self.addCleanup(service.__exit__)

    def start(self, positions, seconds=2, **environment):
        config = json.loads(self.config.read_text())
        del config["positions"]
        if positions is not None:
            config["positions"] = positions
        self.config.write_text(json.dumps(config))
        return subprocess.Popen(
            [PROGRAM, "describe", "--live", f"{seconds}s", "--ask", "Where are my friends?", "--language", "en-GB"],
            env={**os.environ, "KTR_CONFIG": str(self.config), "XDG_STATE_HOME": str(self.folder / "state"), **environment},
            stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True, encoding="utf-8")

    def told(self, program, complains_of=None):
        told, rest = program.communicate(timeout=60)
        self.assertEqual(program.returncode, 0, rest)
        if complains_of:
            self.assertIn(complains_of, rest)
        self.assertRegex(rest, r"was asked: \d+ answers, 0 failures\n$")
        return told

    def test_gpsd_is_heard_and_its_end_is_borne(self):
        gpsd = Gpsd()
        program = self.start({"source": "gpsd", "host": "127.0.0.1", "port": gpsd.port}, seconds=4)
        # It goes when the service has been asked twice: the last position stays.
        while not re.search(r"[2-9] answers", line := program.stderr.readline()):
            self.assertNotEqual(line, "")
        gpsd.stop()
        self.assertIn(f"Ann Marsh, Place: Home, {DISTANCE} away", self.told(program))
        self.assertEqual(gpsd.asked, [b'?WATCH={"enable":true,"json":true};\n'])

    def test_gpsd_that_is_not_there(self):
        with socket.create_server(("127.0.0.1", 0)) as free:
            port = free.getsockname()[1]
        told = self.told(self.start({"source": "gpsd", "host": "127.0.0.1", "port": port}))
        self.assertIn("Ann Marsh, Place: Home, Located now", told)

    def test_gpsd_that_says_nothing(self):
        with socket.create_server(("127.0.0.1", 0)) as silent:
            told = self.told(self.start({"source": "gpsd", "host": "127.0.0.1", "port": silent.getsockname()[1]}))
        self.assertIn("Ann Marsh, Place: Home, Located now", told)

    def test_gpx_track(self):
        track = self.folder / "walk.gpx"
        track.write_text('<gpx xmlns="http://www.topografix.com/GPX/1/1"><trk><trkseg>'
                         f'<trkpt lat="{HERE[0]}" lon="{HERE[1]}"><time>2026-05-16T16:00:00Z</time></trkpt>'
                         "</trkseg></trk></gpx>")
        told = self.told(self.start({"source": "track", "file": str(track)}))
        self.assertIn(f"Ann Marsh, Place: Home, {DISTANCE} away", told)

    def test_no_track_there(self):
        told = self.told(self.start({"source": "track", "file": "nowhere.gpx"}), complains_of="nowhere.gpx: there is no such file")
        self.assertIn("Ann Marsh, Place: Home, Located now", told)

    def test_geoclue_without_a_bus(self):
        told = self.told(self.start(None, DBUS_SYSTEM_BUS_ADDRESS="unix:path=/nonexistent"))
        self.assertIn("Ann Marsh, Place: Home, Located now", told)

    @unittest.skipUnless(mock_bus.is_possible(), "python3-dbusmock is not installed")
    def test_geoclue_tells(self):
        self.play_geoclue("self.EmitSignal('org.freedesktop.GeoClue2.Client', 'LocationUpdated', 'oo', "
                          "[dbus.ObjectPath('/'), dbus.ObjectPath('/org/freedesktop/GeoClue2/Location/1')])")
        told = self.told(self.start({"source": "geoclue"}, DBUS_SYSTEM_BUS_ADDRESS=self.bus.address))
        self.assertIn(f"Ann Marsh, Place: Home, {DISTANCE} away", told)

    @unittest.skipUnless(mock_bus.is_possible(), "python3-dbusmock is not installed")
    def test_geoclue_that_refuses(self):
        self.play_geoclue("raise dbus.exceptions.DBusException('no', name='org.freedesktop.DBus.Error.AccessDenied')")
        told = self.told(self.start({"source": "geoclue"}, DBUS_SYSTEM_BUS_ADDRESS=self.bus.address))
        self.assertIn("Ann Marsh, Place: Home, Located now", told)

    def play_geoclue(self, start):
        """GeoClue with one client, which does this when it is started, and one place."""
        name, manager = "org.freedesktop.GeoClue2", "/org/freedesktop/GeoClue2/Manager"
        client, location = "/org/freedesktop/GeoClue2/Client/1", "/org/freedesktop/GeoClue2/Location/1"
        self.bus = mock_bus.MockBus(self.folder)
        self.addCleanup(self.bus.stop)
        self.bus.play(name, manager, f"{name}.Manager")
        for words in (
                (manager, "AddMethod", f"{name}.Manager", "CreateClient", "", "o", f"ret = dbus.ObjectPath('{client}')"),
                (manager, "AddMethod", f"{name}.Manager", "DeleteClient", "o", "", ""),
                (manager, "AddObject", client, f"{name}.Client",
                 "{'DesktopId': <''>, 'RequestedAccuracyLevel': <uint32 0>, 'Active': <false>}", "@a(ssss) []"),
                (client, "AddMethod", f"{name}.Client", "Start", "", "", start),
                (client, "AddMethod", f"{name}.Client", "Stop", "", "", ""),
                (manager, "AddObject", location, f"{name}.Location",
                 f"{{'Latitude': <{HERE[0]}>, 'Longitude': <{HERE[1]}>, 'Accuracy': <12.5>, 'Altitude': <-1.7976931348623157e308>, "
                 "'Speed': <-1.0>, 'Heading': <-1.0>, 'Description': <''>}", "@a(ssss) []")):
            self.assertTrue(self.bus.tell(name, *words), words)

    def test_none(self):
        self.assertIn("Ann Marsh, Place: Home, Located now", self.told(self.start({"source": "none"})))


if __name__ == "__main__":
    sys.exit(unittest.main())
