#!/usr/bin/python3
"""The user's own sharing and fences: the real program against the real `ktr serve`, without a display."""

import concurrent.futures
import http.server
import json
import os
import pathlib
import re
import ssl
import subprocess
import sys
import tempfile
import threading
import time
import unittest

from serve import Service

PROGRAM = os.environ["KTR_PROGRAM"]

ANN = {"fullName": "Ann Marsh", "firstName": "Ann", "emails": ["ann@harbour.example"], "repeats": False, "track": [
    {"at": 0, "latitude": 50.2104, "longitude": -3.12, "street": "Quay Road", "city": "Brinmouth", "stateCode": "HB"},
    {"at": 1000, "latitude": 50.2204, "longitude": -3.12, "street": "Top Road", "city": "Brinmouth", "stateCode": "HB",
     "label": "Work"}]}


def track(steps, seconds):
    """A walk to the north, of about 55 metres a step."""
    points = "".join(f'<trkpt lat="{50.2104 + 0.0005 * step:.6f}" lon="-3.12"><time>2026-05-16T16:00:'
                     f'{int(step * seconds):02}.{int(step * seconds * 1000) % 1000:03}Z</time></trkpt>' for step in range(steps))
    return f'<gpx version="1.1" xmlns="http://www.topografix.com/GPX/1/1"><trk><trkseg>{points}</trkseg></trk></gpx>'


class SharingTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def serve(self, positions, *options):
        (self.folder / "friends.json").write_text(json.dumps({"friends": [ANN], "user": {
            "fullName": "Mara Lind", "firstName": "Mara", "lastName": "Lind", "emails": ["mara.lind@harbour.example"]}}))
        (self.folder / "walk.gpx").write_text(positions)
        self.service = Service(PROGRAM, "--friends", self.folder / "friends.json", "--positions", self.folder / "walk.gpx",
                               "--write-config", self.folder / "config.json", "--interval", "0.4", *options)
        self.addCleanup(self.service.__exit__)

    def live(self, seconds, *questions, command="describe", more=()):
        environment = {k: v for k, v in os.environ.items() if k not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM")}
        environment.update(KTR_CONFIG=str(self.folder / "config.json"), XDG_STATE_HOME=str(self.folder / "state"))
        asked = [word for question in questions for word in ("--ask", question)]
        result = subprocess.run([PROGRAM, command, "--live", f"{seconds}s", *asked, "--language", "en-GB", *more],
                                env=environment, capture_output=True, timeout=seconds + 30, text=True, encoding="utf-8")
        self.assertEqual(result.returncode, 0, result.stderr)
        return result

    def is_visible(self, wish="read"):
        return not self.service.hides(wish)

    def commands(self):
        """What was sent to the service, in order; ends it."""
        _, lines = self.service.end()
        return [re.fullmatch(r"request \d+: (\w+), (\d+).*", line).groups() for line in lines]

    def test_resting_user_one_command_then_quiet(self):
        self.serve(track(1, 1))
        result = self.live(3, "Share my location")
        self.assertIn("Mara Lind, Friends can see where you are, Place: Brinmouth, HB", result.stdout)
        self.assertNotIn("Locating", result.stdout)
        self.assertEqual(self.commands(), [("showHideLocation", "200")])

    def test_moving_user_is_told_of_until_at_rest(self):
        self.serve(track(8, 0.25))
        result = self.live(5, "Share my location")
        sent = self.commands()
        # The walk is over after two seconds; a command a move at most, and none afterwards.
        self.assertEqual(set(sent), {("showHideLocation", "200")})
        self.assertGreaterEqual(len(sent), 3)
        self.assertLessEqual(len(sent), 7)
        self.assertIn("the service was asked: %d answers, 0 failures" % len(sent), result.stderr)

    def test_hidden_user_is_shown_to_nobody(self):
        self.serve(track(8, 0.25))
        result = self.live(2, "Hide my location")
        self.assertIn("Mara Lind, Hidden from friends", result.stdout)
        self.assertIn("Friends can’t see where you are.", result.stdout)
        self.assertIn("Your location is hidden", result.stderr)
        self.assertFalse(self.is_visible())
        self.assertEqual({name for name, _ in self.commands()}, {"getlocations"})

    def test_answer_that_goes_on_does_not_undo_hiding(self):
        self.serve(track(60, 0.25))
        with concurrent.futures.ThreadPoolExecutor(1) as pool:
            run = pool.submit(self.live, 4, "Share my location")
            time.sleep(2)
            self.assertFalse(self.is_visible("hide"))
            self.assertIn("Mara Lind", run.result().stdout)
        self.assertFalse(self.is_visible())
        self.assertGreater(len(self.commands()), 3)

    def assistant(self, handler):
        """Service and assistant's server in one."""
        certificate = self.folder / "assistant.pem"
        subprocess.run(["openssl", "req", "-x509", "-newkey", "ec", "-pkeyopt", "ec_paramgen_curve:prime256v1", "-nodes",
                        "-subj", "/CN=localhost", "-addext", "subjectAltName=DNS:localhost", "-days", "2",
                        "-keyout", self.folder / "assistant.key", "-out", certificate], check=True, capture_output=True)
        server = http.server.ThreadingHTTPServer(("127.0.0.1", 0), handler)
        context = ssl.SSLContext(ssl.PROTOCOL_TLS_SERVER)
        context.load_cert_chain(certificate, self.folder / "assistant.key")
        server.socket = context.wrap_socket(server.socket, server_side=True)
        thread = threading.Thread(target=server.serve_forever)
        thread.start()
        self.addCleanup(lambda: (server.shutdown(), thread.join(), server.server_close()))
        config = json.loads((self.folder / "config.json").read_text())
        config["account"]["host"] = config["account"]["assistant"] = f"localhost:{server.server_port}"
        config["certificates"].append(str(certificate))
        (self.folder / "config.json").write_text(json.dumps(config))

    def test_wishes_are_asked_for_in_their_order(self):
        seen = []

        class Slow(http.server.BaseHTTPRequestHandler):
            """The sooner it is asked, the later it answers."""

            def do_POST(self):
                question = json.loads(self.rfile.read(int(self.headers["Content-Length"])))["question"]
                seen.append("asked: " + question)
                time.sleep(max(0.8 - 0.2 * len(seen), 0.1))
                seen.append("answered: " + question)
                body = json.dumps({"sentence": "This is about: " + question}).encode()
                self.send_response(200)
                self.send_header("Content-Type", "application/json")
                self.send_header("Content-Length", str(len(body)))
                self.end_headers()
                self.wfile.write(body)

            def log_message(self, *_):
                pass

        self.serve(track(1, 1))
        self.assistant(Slow)
        wishes = ["Share my location", "Hide my location", "Share it with me"]
        result = self.live(0.2, *wishes)
        self.assertEqual(seen, [event + wish for wish in wishes for event in ("asked: ", "answered: ")])
        places = [result.stdout.index("This is about: " + wish) for wish in wishes]
        self.assertEqual(places, sorted(places))

    def test_nothing_shows_the_user_once_the_wish_to_hide_has_left(self):
        heard = []

        class Slow(http.server.BaseHTTPRequestHandler):
            """Assistant and service in one. The wish to hide takes longer than the earlier card waits before it asks."""

            def do_GET(self):
                body = self.rfile.read(int(self.headers.get("Content-Length") or 0))
                if not self.path.startswith("/assistant"):
                    heard.append((self.path.rsplit("/", 1)[1], json.loads(body).get("prefs")))
                    return self.answer({"serverContext": {"minCallbackIntervalInMS": 300}, "statusCode": 200})
                hides = "hide" in (self.path + body.decode()).lower()
                heard.append("hide" if hides else "share")
                time.sleep(2 if hides else 0)
                context = "minCallbackIntervalInMS=400&callbackTimeoutIntervalInMS=60000&"
                self.answer({"sentence": "Done.", "snippet": {"kind": "VAKtrVisibilityView", "visible": not hides,
                                                              "searchContext": "ktrServerContext://serverContext?" + context}})

            do_POST = do_GET

            def answer(self, said):
                body = json.dumps(said).encode()
                self.send_response(200)
                self.send_header("Content-Type", "application/json")
                self.send_header("Content-Length", str(len(body)))
                self.end_headers()
                self.wfile.write(body)

            def log_message(self, *_):
                pass

        self.serve(track(8, 0.25))
        self.assistant(Slow)
        result = self.live(1.5, "Share my location", "Hide my location")
        self.assertEqual(heard[:2], ["share", "hide"])
        self.assertEqual([command for command in heard[2:] if command[0] != "getlocations"], [])
        self.assertIn("Hidden from friends", result.stdout)
        # The card of before is still there to be read.
        self.assertIn("Friends can see where you are", result.stdout)

    def test_last_of_many_wishes_is_honoured(self):
        self.serve(track(1, 1))
        self.live(0.2, *["Share my location", "Hide my location"] * 4)
        self.assertFalse(self.is_visible())

    def test_sharing_after_hiding(self):
        self.serve(track(1, 1))
        self.live(0.5, "Hide my location")
        self.assertFalse(self.is_visible())
        result = self.live(2, "Share my location")
        self.assertIn("Friends can see where you are, Place: Brinmouth, HB", result.stdout)
        self.assertTrue(self.is_visible())

    def test_answers_that_say_little(self):
        for fault in ("body=empty", "text={}", 'text={"myInfo":{}}', 'text={"myInfo":null}', "text=[]", "status=503"):
            with self.subTest(fault):
                self.serve(track(1, 1), "--fault", fault)
                result = self.live(1.5, "Share my location")
                self.assertIn("Friends can see where you are", result.stdout)
                self.assertIn("Mara Lind", result.stdout)
                self.assertEqual(len(self.commands()), 1)

    def test_fence(self):
        self.serve(track(1, 1))
        result = self.live(1, "Tell me when Ann leaves work")
        self.assertIn("You’ll hear when Ann Marsh leaves: at work.", result.stdout)
        self.assertIn("Ann Marsh, You’ll hear as they leave Work (link)", result.stdout)
        result = self.live(1, "Tell me when Ann arrives")
        self.assertIn("Ann Marsh, You’ll hear when they arrive (link)", result.stdout)
        # The service is asked, and for nobody.
        self.assertEqual({name for name, _ in self.commands()}, {"getlocations"})

    def test_pictures(self):
        self.serve(track(1, 1))
        for question in ("Tell me when Ann leaves work", "Share my location", "Hide my location"):
            for mode in ("--light", "--dark"):
                picture = self.folder / "picture.png"
                self.live(1, question, command="render", more=("-o", str(picture), mode))
                self.assertGreater(picture.stat().st_size, 5000)


if __name__ == "__main__":
    sys.exit(unittest.main(warnings="ignore"))
