#!/usr/bin/python3
"""Runs the whole program with names, numbers, positions, typed words and a token that occur nowhere else, and looks for them
where nothing of them may be: the log at every level, state and cache, command lines, and whoever listens on this machine without
being the service. Skipped without Xvfb and xdotool."""

import base64
import json
import os
import pathlib
import shutil
import socket
import subprocess
import sys
import threading
import time
import unittest

from serve import Service
from window_case import WindowCase

PROGRAM = os.environ["KTR_PROGRAM"]

NAME, FAMILY, NICK = "Zwenhild", "Quibbleton", "Zwenny"
ADDRESS = "zwenhild.q@harbour.example"
NUMBER = "+441632960777"
LABEL, CITY = "Grottenolmhaus", "Vexelstadt"
FRIEND, USER = (50.273819, -3.174628), (50.281937, -3.163847)
TYPED = "Where is Zwenhild? xylofunkel"
CANARIES = [NAME, FAMILY, NICK, ADDRESS, "zwenhild.q", NUMBER, NUMBER[3:], "960777", "960 777", LABEL, CITY, "xylofunkel",
            *(f"{abs(number):.4f}" for number in FRIEND + USER)]
LEVELS = ("debug", "info", "default", "error")


class Listener:
    """Takes what comes on a port that is nobody's business."""

    def __init__(self):
        self.heard = []
        self.socket = socket.create_server(("127.0.0.1", 0))
        self.port = self.socket.getsockname()[1]
        threading.Thread(target=self.listen, daemon=True).start()

    def listen(self):
        while True:
            try:
                connection, _ = self.socket.accept()
            except OSError:
                return
            with connection:
                connection.settimeout(2)
                try:
                    self.heard.append(connection.recv(65536))
                except OSError:
                    self.heard.append(b"")

    def close(self):
        self.socket.close()


class PrivacyTest(WindowCase):
    def setUp(self):
        super().setUp()
        self.listener = Listener()
        self.addCleanup(self.listener.close)
        self.given = self.folder / "given"
        self.given.mkdir()
        self.own = {}
        for name in ("HOME", "XDG_DATA_HOME", "XDG_CACHE_HOME", "XDG_STATE_HOME", "XDG_CONFIG_HOME", "XDG_RUNTIME_DIR"):
            self.own[name] = str(self.folder / "own" / name.lower())
            os.makedirs(self.own[name], 0o700)
        nobody = f"http://127.0.0.1:{self.listener.port}"
        self.environment = {**os.environ, **self.own, "DISPLAY": self.display, "QT_QPA_PLATFORM": "xcb", "NO_AT_BRIDGE": "1",
                            "LANG": "C.UTF-8", "KTR_CONFIG": str(self.given / "config.json"),
                            "DBUS_SESSION_BUS_ADDRESS": "unix:path=/nonexistent", "http_proxy": nobody,
                            "https_proxy": nobody, "HTTPS_PROXY": nobody, "all_proxy": nobody}
        self.environment.pop("KTR_LOG_PRIVATE", None)

    def serve(self, *options):
        """The service with one friend who moves, and the configuration of whoever asks it."""
        def place(at):
            return {"at": at, "latitude": FRIEND[0] + at * 1e-6, "longitude": FRIEND[1], "label": LABEL, "city": CITY}
        friends = self.given / "friends.json"
        friends.write_text(json.dumps({"friends": [
            {"fullName": f"{NAME} {FAMILY}", "firstName": NAME, "lastName": FAMILY, "emails": [ADDRESS], "phones": [NUMBER],
             "track": [place(0), place(5)]}]}))
        (self.given / "own.gpx").write_text(
            '<gpx version="1.1" xmlns="http://www.topografix.com/GPX/1/1"><trk><trkseg>' +
            "".join(f'<trkpt lat="{USER[0] + n * 1e-6}" lon="{USER[1]}"><time>2026-05-16T17:00:{n:02d}Z</time></trkpt>'
                    for n in range(5)) + "</trkseg></trk></gpx>")
        (self.given / "contacts.vcf").write_text(
            f"BEGIN:VCARD\r\nVERSION:3.0\r\nFN:{NAME} {FAMILY}\r\nN:{FAMILY};{NAME};;;\r\nNICKNAME:{NICK}\r\nEMAIL:{ADDRESS}\r\n"
            f"TEL:{NUMBER}\r\nEND:VCARD\r\nBEGIN:VCARD\r\nNOTE:{NAME}\r\nEND:VCARD\r\n")
        service = Service(PROGRAM, "--friends", friends, "--write-config", self.given / "config.json", "--interval", "0.3",
                          "--positions", self.given / "own.gpx", "--contacts", self.given / "contacts.vcf", *options)
        self.addCleanup(service.__exit__)
        return service

    def canaries(self, service):
        token = service.token
        return [*CANARIES, token, service.credentials.split()[1], base64.b64encode(token.encode()).decode()]

    def command_lines(self, program):
        """Of the program and whatever it has started."""
        return [path.read_bytes() for pid in [program.pid, *self.children(program.pid)]
                for path in [pathlib.Path(f"/proc/{pid}/cmdline")] if path.exists()]

    def children(self, pid):
        listed = pathlib.Path(f"/proc/{pid}/task/{pid}/children")
        return [int(child) for child in listed.read_text().split()] if listed.exists() else []

    def use_window(self, level):
        """Opens a window, types a question and a wish, and closes it; gives the log and the command lines meanwhile."""
        program = subprocess.Popen([PROGRAM, "show", "--ask", "Where are my friends?", "--language", "en-GB"],
                                   env={**self.environment, "KTR_LOG": level}, stdout=subprocess.PIPE, stderr=subprocess.STDOUT)
        try:
            self.find_window()
            time.sleep(2)
            self.xdotool("windowfocus", "--sync", self.window)
            for words in (TYPED, "Share my location", "Where are my friends?"):
                self.xdotool("type", "--window", self.window, words)
                self.xdotool("key", "--window", self.window, "Return")
                time.sleep(2)
            lines = self.command_lines(program)
        finally:
            program.terminate()
            said, _ = program.communicate(timeout=30)
        return said, lines

    def assert_nothing_of(self, canaries, data, where):
        for canary in canaries:
            self.assertNotIn(canary.encode().lower(), data.lower(), f"{canary} in {where}")

    def assert_kept_nothing(self, canaries):
        for path in (self.folder / "own").rglob("*"):
            self.assert_nothing_of(canaries, str(path).encode(), "a file's name")
            if path.is_file() and not path.is_symlink():
                self.assert_nothing_of(canaries, path.read_bytes(), path)

    def test_nothing_of_it_is_said_kept_or_sent_elsewhere(self):
        service = self.serve()
        canaries = self.canaries(service)
        for level in LEVELS:
            said, lines = self.use_window(level)
            self.assert_nothing_of(canaries, said, f"the log, level {level}")
            if level == "debug":
                self.assertIn(b"Sending location refresh command", said, "it did ask")
                self.assertIn(b"Sending visibility refresh command", said, "and did share")
                self.assertIn(b"contact passed over", said)
            for line in lines:
                self.assert_nothing_of(canaries, line, "a command line")
        self.assert_kept_nothing(canaries)
        self.assertEqual(self.listener.heard, [], "a proxy of the environment is not asked")

    def test_nothing_of_it_leaves_when_the_service_goes_wrong(self):
        nobody = f"https://localhost:{self.listener.port}"
        for fault in (f"redirect={nobody}{{path}}", "status=503", "status=401", "body=not-json", "cut=body"):
            with self.subTest(fault):
                service = self.serve("--fault", fault)
                canaries = self.canaries(service)
                result = subprocess.run([PROGRAM, "describe", "--live", "2s", "--ask", "Where are my friends?"],
                                        env={**self.environment, "KTR_LOG": "debug"}, capture_output=True, timeout=60)
                self.assert_nothing_of(canaries, result.stderr, "the log")
                for heard in self.listener.heard:
                    # A redirect within the account's host may be followed, but no byte of a command goes out before the other
                    # side has proved who it is.
                    self.assert_nothing_of(canaries, heard, "what somebody else heard")
                self.assert_kept_nothing(canaries)


if __name__ == "__main__":
    if not all(shutil.which(tool) for tool in ("Xvfb", "xdotool")):
        print("skipped: Xvfb and xdotool are needed")
        sys.exit(77)
    unittest.main()
