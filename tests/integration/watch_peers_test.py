#!/usr/bin/python3
"""`ktr watch` beside services that lie, pour or send it elsewhere: what it says that it has heard, it has told."""

import http.server
import json
import os
import pathlib
import re
import ssl
import subprocess
import tempfile
import threading
import time
import unittest

PROGRAM = os.environ["KTR_PROGRAM"]


def event(number, **more):
    data = {"id": str(number), "name": "Ann", "handle": "ann@x.example", "trigger": "OnArrival", "place": {"name": "Home"},
            "timestamp": 1763760000000, **more}
    return f"id: {number}\nevent: crossing\ndata: {json.dumps(data)}\n\n".encode()


class Peer:
    """A service of the test's own; `stream(handler)` writes the event stream."""

    def __init__(self, case, folder, stream):
        certificate = folder / "peer.pem"
        if not certificate.exists():
            subprocess.run(["openssl", "req", "-x509", "-newkey", "ec", "-pkeyopt", "ec_paramgen_curve:prime256v1", "-nodes",
                            "-subj", "/CN=localhost", "-addext", "subjectAltName=DNS:localhost", "-days", "2",
                            "-keyout", folder / "peer.key", "-out", certificate], check=True, capture_output=True)
        self.heard, self.asked = [], []
        peer = self

        class Handler(http.server.BaseHTTPRequestHandler):
            def do_GET(self):
                peer.asked.append(self.headers.get("Last-Event-ID"))
                try:
                    stream(self)
                except OSError:
                    pass

            def do_POST(self):
                body = self.rfile.read(int(self.headers["Content-Length"]))
                peer.heard.append(json.loads(body)["heard"])
                self.send_response(200)
                self.send_header("Content-Length", "2")
                self.end_headers()
                self.wfile.write(b"{}")

            def log_message(self, *_):
                pass

        self.server = http.server.ThreadingHTTPServer(("127.0.0.1", 0), Handler)
        self.server.daemon_threads = True
        context = ssl.SSLContext(ssl.PROTOCOL_TLS_SERVER)
        context.load_cert_chain(certificate, folder / "peer.key")
        self.server.socket = context.wrap_socket(self.server.socket, server_side=True)
        thread = threading.Thread(target=self.server.serve_forever)
        thread.start()
        case.addCleanup(lambda: (self.server.shutdown(), thread.join(), self.server.server_close()))
        self.host = f"localhost:{self.server.server_port}"


def begin(handler):
    handler.send_response(200)
    handler.send_header("Content-Type", "text/event-stream")
    handler.end_headers()


class WatchPeersTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        (self.folder / "token").write_text("secret\n")
        (self.folder / "token").chmod(0o600)

    def start(self, peer, out=None, options=("--print",), **account):
        config = self.folder / "config.json"
        config.write_text(json.dumps({"account": {"personId": "1000", "host": peer.host, **account},
                                      "certificates": [str(self.folder / "peer.pem")]}))
        config.chmod(0o600)
        environment = {**os.environ, "KTR_CONFIG": str(config), "XDG_STATE_HOME": str(self.folder / "state"),
                       "DBUS_SESSION_BUS_ADDRESS": "disabled:", "DBUS_SYSTEM_BUS_ADDRESS": "disabled:"}
        self.out, self.err = self.folder / "out", self.folder / "err"
        with open(self.out, "w", encoding="utf-8") as own, open(self.err, "w", encoding="utf-8") as err:
            process = subprocess.Popen([PROGRAM, "watch", *options], env=environment, stdout=own if out is None else out,
                                       stderr=err)
        self.addCleanup(lambda: (process.kill(), process.wait()))
        return process

    def wait_for_line(self, file, words):
        self.wait_until(lambda: re.search(words, file.read_text(encoding="utf-8"), re.M))

    def wait_until(self, holds, seconds=30):
        end = time.monotonic() + seconds
        while time.monotonic() < end and not holds():
            time.sleep(0.05)
        self.assertTrue(holds())

    def rest(self, *events):
        """A stream that says these and then nothing."""
        def stream(handler):
            begin(handler)
            handler.wfile.write(b"".join(events))
            handler.wfile.flush()
            time.sleep(20)
        return stream

    def test_what_cannot_be_printed_is_not_heard(self):
        peer = Peer(self, self.folder, self.rest(event(1), event(2)))
        with open("/dev/full", "w", encoding="utf-8") as full:
            process = self.start(peer, full)
            self.assertEqual(process.wait(timeout=30), 1)
        self.wait_for_line(self.err, "the crossings cannot be written")
        self.assertEqual(peer.heard, [])
        self.assertFalse((self.folder / "state" / "ktr" / "watch").exists())

    def test_what_nobody_shows_is_not_heard(self):
        peer = Peer(self, self.folder, self.rest(event(1)))
        process = self.start(peer, options=())
        self.wait_for_line(self.err, "nobody on the desktop who shows notifications")
        time.sleep(0.5)
        self.assertIsNone(process.poll())
        self.assertEqual(peer.heard, [])

    def test_moments_that_are_none_are_passed_over(self):
        peer = Peer(self, self.folder, self.rest(event(1, timestamp=1e300), event(2, timestamp=-1e18), event(3)))
        self.start(peer)
        self.wait_for_line(self.out, "^3  2025-")
        self.wait_until(lambda: peer.heard == ["3"])

    def test_service_that_pours_is_read_as_fast_as_it_is_told(self):
        def stream(handler):
            begin(handler)
            first = int(handler.headers.get("Last-Event-ID") or 0) + 1
            for start in range(first, first + 10 ** 7, 1000):
                handler.wfile.write(b"".join(event(number) for number in range(start, start + 1000)))
        peer = Peer(self, self.folder, stream)
        # Nobody reads its lines: nothing is told.
        reading, writing = os.pipe()
        self.addCleanup(os.close, reading)
        process = self.start(peer, writing)
        os.close(writing)
        time.sleep(8)
        status = pathlib.Path(f"/proc/{process.pid}/status").read_text()
        most = int(next(line for line in status.splitlines() if line.startswith("VmHWM")).split()[1])
        self.assertLess(most, 150_000, "KiB")

    def test_what_came_while_enough_waited_comes_again_and_nothing_is_passed_over(self):
        def stream(handler):
            begin(handler)
            first = int(handler.headers.get("Last-Event-ID") or 0) + 1
            handler.wfile.write(b"".join(event(number) for number in range(first, 2501)))
            handler.wfile.flush()
            time.sleep(20)
        peer = Peer(self, self.folder, stream)
        self.start(peer)
        self.wait_until(lambda: "2500" in peer.heard, 200)
        told = [int(line.split()[0]) for line in self.out.read_text(encoding="utf-8").splitlines()]
        self.assertEqual(told, list(range(1, 2501)))
        self.assertGreater(len(peer.asked), 1)

    def test_redirect_is_followed_to_the_accounts_hosts_alone(self):
        second = Peer(self, self.folder, self.rest(event(1)))

        def elsewhere(handler):
            handler.send_response(307)
            handler.send_header("Location", f"https://{second.host}{handler.path}")
            handler.send_header("Content-Length", "0")
            handler.end_headers()
        first = Peer(self, self.folder, elsewhere)
        process = self.start(first)
        self.wait_for_line(self.err, "redirect that is not followed")
        self.assertEqual(second.asked, [])
        process.kill()
        process.wait()
        self.start(first, domains=[second.host])
        self.wait_for_line(self.out, "^1  ")

    def test_journal_that_is_no_number_is_said(self):
        journal = self.folder / "state" / "ktr" / "watch"
        journal.parent.mkdir(parents=True)
        journal.write_text("junk")
        peer = Peer(self, self.folder, self.rest(event(1)))
        self.start(peer)
        self.wait_for_line(self.err, "watch: expected the number of the last crossing")
        self.wait_for_line(self.out, "^1  ")


if __name__ == "__main__":
    unittest.main()
