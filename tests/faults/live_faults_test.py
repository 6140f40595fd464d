#!/usr/bin/python3
"""Lets every file and socket call of a live client fail, one after the other: configuration, token, contacts, track, preferences,
maps, the assistant and the service. It may fail with a line that says why, and show less with a line that says why, but never
crash, hang, lose what it kept or leave a broken file. Long: it runs with KTR_LONG_TESTS=1 alone."""

import http.server
import json
import os
import pathlib
import re
import sqlite3
import ssl
import struct
import subprocess
import sys
import tempfile
import threading
import zlib

from shim import PROGRAM, SCENARIOS, Faults

sys.path.insert(0, os.path.join(os.path.dirname(__file__), "..", "integration"))
from serve import Service  # noqa: E402

PREFERENCES = pathlib.Path("state/ktr/preferences/org.ktr.snippets.json")
# A port at which nobody listens.
GONE = "localhost:9"
KEPT = {"RedirectedHostKey": GONE, "Another": "program's"}


def tile():
    """A plain PNG of 256 points."""
    def chunk(kind, data):
        return struct.pack(">I", len(data)) + kind + data + struct.pack(">I", zlib.crc32(kind + data))
    header = struct.pack(">IIBBBBB", 256, 256, 8, 2, 0, 0, 0)
    rows = zlib.compress((b"\0" + b"\x80\xa0\xc0" * 256) * 256)
    return b"\x89PNG\r\n\x1a\n" + chunk(b"IHDR", header) + chunk(b"IDAT", rows) + chunk(b"IEND", b"")


class LiveFaultsTest(Faults):
    def setUp(self):
        super().setUp()
        self.config = self.folder / "config.json"
        self.service = Service(PROGRAM, "--write-config", self.config, "--interval", "0.3", "--positions",
                               SCENARIOS / "single.json")
        self.addCleanup(self.service.__exit__)
        config = json.loads(self.config.read_text())
        config["account"]["domains"] = [config["account"]["host"], GONE]
        self.config.write_text(json.dumps(config))

    def serve_tiles(self):
        """Maps: a file that has the world at a glance, and a server for everything."""
        class Tiles(http.server.BaseHTTPRequestHandler):
            def do_GET(self):
                body = tile()
                self.send_response(200)
                for name, value in (("Content-Type", "image/png"), ("Cache-Control", "max-age=3600"),
                                    ("Content-Length", str(len(body)))):
                    self.send_header(name, value)
                self.end_headers()
                self.wfile.write(body)

            def log_message(self, *_):
                pass

        class Server(http.server.ThreadingHTTPServer):
            def handle_error(self, *_):
                pass

        certificate = self.folder / "tiles.pem"
        subprocess.run(["openssl", "req", "-x509", "-newkey", "ec", "-pkeyopt", "ec_paramgen_curve:prime256v1", "-nodes",
                        "-subj", "/CN=localhost", "-addext", "subjectAltName=DNS:localhost", "-days", "2",
                        "-keyout", self.folder / "tiles.key", "-out", certificate], check=True, capture_output=True)
        server = Server(("127.0.0.1", 0), Tiles)
        context = ssl.SSLContext(ssl.PROTOCOL_TLS_SERVER)
        context.load_cert_chain(certificate, self.folder / "tiles.key")
        server.socket = context.wrap_socket(server.socket, server_side=True, do_handshake_on_connect=False)
        thread = threading.Thread(target=server.serve_forever)
        thread.start()
        self.addCleanup(lambda: (server.shutdown(), thread.join(), server.server_close()))
        world = self.folder / "world.mbtiles"
        with sqlite3.connect(world) as database:
            database.executescript("CREATE TABLE metadata (name TEXT, value TEXT);"
                                   "CREATE TABLE tiles (zoom_level INTEGER, tile_column INTEGER, tile_row INTEGER, tile_data BLOB)")
            database.executemany("INSERT INTO metadata VALUES (?, ?)", [("format", "png"), ("minzoom", "0"), ("maxzoom", "0")])
            database.execute("INSERT INTO tiles VALUES (0, 0, 0, ?)", (tile(),))
        config = json.loads(self.config.read_text())
        config["certificates"].append(str(certificate))
        config["maps"] = {"sources": [{"file": str(world)}, {
            "url": f"https://localhost:{server.server_port}/{{z}}/{{x}}/{{y}}.png", "attribution": "A test"}]}
        self.config.write_text(json.dumps(config))

    def live(self, command, question, *more):
        """What runs the command in a folder of its own, which the result names."""
        def run(call, kind, place, times):
            folder = pathlib.Path(tempfile.mkdtemp(dir=self.folder))
            preferences = folder / PREFERENCES
            preferences.parent.mkdir(parents=True)
            preferences.write_text(json.dumps(KEPT))
            result, count = self.run_with(
                (command, "--live", "0.4s", "--ask", question, "--language", "en-GB", *(word.format(folder) for word in more)),
                call, kind, place, times,
                {"KTR_CONFIG": str(self.config), "XDG_STATE_HOME": str(folder / "state"), "XDG_CACHE_HOME": str(folder / "cache")})
            result.folder = folder
            return result, count
        return run

    def assert_kept(self, result):
        """The preferences are whole. The host that is gone was forgotten once the account's own has answered the card: the
        first answer is to the question, and those who ask that know the account's own host alone."""
        kept = json.loads((result.folder / PREFERENCES).read_text())
        self.assertEqual(kept["Another"], KEPT["Another"])
        if "RedirectedHostKey" in kept and re.search(r"asked: ([2-9]|\d\d)", result.stderr):
            self.assert_says_why(result)

    def assert_says_why(self, result):
        lines = [line for line in result.stderr.splitlines()
                 if not re.match(r"ktr: (the service was asked: \d+ answers, 0 failures|Live · updated |Looking)", line)]
        self.assertTrue(lines, "nothing says why: " + result.stdout + result.stderr)

    def test_answer_in_words(self):
        def whole(result):
            self.assert_kept(result)
            if result.returncode != 0:
                return
            for shown in ("I can see Ann Marsh, ", "Ann Marsh, Place: ", r"Otto Brandt, Place: Work, [\d.]+\s\w+\saway"):
                if not re.search(shown, result.stdout):
                    self.assert_says_why(result)

        self.check_each("describe --live", self.live("describe", "Where are my friends?"), whole)

    def test_picture_with_a_map(self):
        self.serve_tiles()

        def whole(result):
            self.assert_kept(result)
            picture = result.folder / "a.png"
            if result.returncode == 0 or picture.exists():
                self.assertTrue(picture.read_bytes().endswith(b"IEND\xaeB`\x82"))
            self.assertLessEqual({entry.name for entry in result.folder.iterdir()}, {"a.png", "state", "cache"})

        self.check_each("render --live", self.live("render", "Where is Otto?", "-o", "{}/a.png"), whole)


if __name__ == "__main__":
    Faults.main()
