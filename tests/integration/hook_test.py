#!/usr/bin/env python3
"""What `ktr watch` tells others of who comes and goes: a webhook of one's own over HTTPS, and the desktop's notifications.

  hook_test.py SERVICE PROGRAM [unittest options]
"""
import contextlib
import hashlib
import hmac
import json
import os
import pathlib
import random
import re
import shutil
import signal
import socket
import sqlite3
import ssl
import subprocess
import sys
import threading
import time
import unittest

from service_program import COMMANDS, ServiceProgram

SERVICE, PROGRAM = sys.argv.pop(1), sys.argv.pop(1)
KEY = "a key that only the two know"
DEGREE = 111230.0
WORK = (50.2171, -3.1118)
NOTIFICATIONS, PATH = "org.freedesktop.Notifications", "/org/freedesktop/Notifications"
LOGIND, MANAGER, SESSION = "org.freedesktop.login1", "/org/freedesktop/login1", "/org/freedesktop/login1/session/own"


class Receiver:
    """An HTTPS server that keeps what it gets and answers as it is told: a status, "silent", "drip", "reset"."""

    def __init__(self, folder, certificate):
        self.context = ssl.SSLContext(ssl.PROTOCOL_TLS_SERVER)
        self.context.load_cert_chain(certificate, folder / "hook.key")
        self.socket = socket.create_server(("127.0.0.1", 0))
        self.port = self.socket.getsockname()[1]
        self.posts, self.answers, self.redirected = [], [], []
        self.ended = threading.Event()
        threading.Thread(target=self.listen, daemon=True).start()

    def listen(self):
        while not self.ended.is_set():
            try:
                connection, _ = self.socket.accept()
            except OSError:
                return
            threading.Thread(target=self.serve, args=(connection,), daemon=True).start()

    def serve(self, plain):
        with contextlib.suppress(OSError, ValueError), plain, self.context.wrap_socket(plain, server_side=True) as stream:
            stream.settimeout(60)
            head = b""
            while b"\r\n\r\n" not in head:
                piece = stream.recv(4096)
                if not piece:
                    return
                head += piece
            head, body = head.split(b"\r\n\r\n", 1)
            lines = head.decode().split("\r\n")
            fields = {name.lower(): value for name, value in (line.split(": ", 1) for line in lines[1:])}
            while len(body) < int(fields["content-length"]):
                body += stream.recv(4096)
            if lines[0].split()[1] != "/hook?of=mine":
                self.redirected.append(lines[0])
            self.posts.append((time.monotonic(), lines[0], fields, body))
            answer = self.answers.pop(0) if self.answers else 204
            if answer == "silent":
                self.ended.wait(60)
            elif answer == "drip":
                for letter in b"HTTP/1.1 200 OK\r\nX-Slow: " + b"a" * 1000:
                    stream.sendall(bytes([letter]))
                    if self.ended.wait(0.5):
                        return
            elif answer != "reset":
                there = f"Location: https://localhost:{self.port}/elsewhere\r\n" if 300 <= answer < 400 else ""
                stream.sendall(f"HTTP/1.1 {answer} Answer\r\n{there}Content-Length: 0\r\nConnection: close\r\n\r\n".encode())

    def wait_for(self, count, seconds=60):
        end = time.monotonic() + seconds
        while time.monotonic() < end and len(self.posts) < count:
            time.sleep(0.05)
        return len(self.posts) >= count

    def close(self):
        self.ended.set()
        self.socket.close()


def eventually(what, seconds=60):
    end = time.monotonic() + seconds
    while time.monotonic() < end:
        if what():
            return True
        time.sleep(0.05)
    return False


class WatchCase(unittest.TestCase):
    """Otto wants to hear each time when Ann arrives at work."""

    def setUp(self):
        self.service = ServiceProgram(self, SERVICE)
        self.folder = self.service.folder
        self.phone = self.service.add("Ann")
        self.service.add("Otto")
        self.service.command("place", "Ann", "--name", "Office", "--said", "--at", f"{WORK[0]},{WORK[1]}")
        self.service.command("share", "Ann", "Otto", "--fences")
        configuration = self.service.command("reader", "Otto", "--token-file", str(self.folder / "token"))
        self.configuration = json.loads(configuration[configuration.index("{"):configuration.rindex("}") + 1])
        with contextlib.closing(sqlite3.connect(self.folder / "data" / "service.db")) as database:
            database.execute("UPDATE share SET since = since - 40000")
            database.commit()
        self.clock = int(time.time()) - 18000
        self.service.start()
        self.watch = None
        self.environment = {**os.environ, "KTR_CONFIG": str(self.folder / "config.json"),
                            "XDG_STATE_HOME": str(self.folder / "state"), "QT_QPA_PLATFORM": "offscreen",
                            "DBUS_SESSION_BUS_ADDRESS": "unix:path=/nonexistent",
                            "DBUS_SYSTEM_BUS_ADDRESS": "unix:path=/nonexistent"}
        self.addCleanup(self.kill)
        self.is_at(0)
        self.is_at(500)
        status, answer = self.service.request(
            "POST", COMMANDS + "setFence", json.dumps({"clientContext": {}, "handle": "ann@x.example", "trigger": "OnArrival",
                                                       "once": False, "place": {"name": "Office"}}), False,
            ("Otto", (self.folder / "token").read_text().strip()),
            **{"Content-Type": "application/json", "X-Orcha-Seek-API-Ver": "4.0", "X-Orcha-AuthScheme": "Forever"})
        self.assertEqual(status, 200, answer)

    def configure(self, **members):
        (self.folder / "config.json").write_text(json.dumps({**self.configuration, **members}))
        (self.folder / "config.json").chmod(0o600)

    def is_at(self, north, seconds=31):
        self.clock += seconds
        def posted():
            with contextlib.suppress(OSError):
                return self.service.post("Ann", self.phone, _type="location", lat=WORK[0] + north / DEGREE, lon=WORK[1],
                                         tst=self.clock, acc=10, tid="an")[0] == 200
        self.assertTrue(eventually(posted, 30))

    def arrive(self):
        self.is_at(500)
        self.is_at(500)
        self.is_at(0)

    def start(self, *options, language=("--language", "en")):
        with open(self.folder / "watched", "ab") as out:
            self.watch = subprocess.Popen([PROGRAM, "watch", *language, *options], env=self.environment, stdout=out, stderr=out)

    def kill(self):
        if self.watch is not None:
            if self.watch.poll() is None:
                self.watch.send_signal(signal.SIGKILL)
            self.watch.wait()

    def said(self):
        return (self.folder / "watched").read_text()


class HookTest(WatchCase):
    def setUp(self):
        super().setUp()
        self.configure()
        self.make_certificates()
        self.receiver = Receiver(self.folder, self.folder / "hook.pem")
        self.addCleanup(self.receiver.close)
        (self.folder / "key").write_text(KEY + "\n")
        (self.folder / "key").chmod(0o600)
        self.configure(certificates=[*self.configuration["certificates"], str(self.folder / "authority.pem")])

    def make_certificates(self):
        """An authority of the receiver's own, which nobody but the configuration knows."""
        def openssl(*words):
            subprocess.run(["openssl", *words], cwd=self.folder, check=True, capture_output=True)
        openssl("req", "-x509", "-newkey", "rsa:2048", "-nodes", "-keyout", "authority.key", "-out", "authority.pem", "-days",
                "2", "-subj", "/CN=The hook's authority")
        openssl("req", "-newkey", "rsa:2048", "-nodes", "-keyout", "hook.key", "-out", "hook.csr", "-subj", "/CN=hook")
        (self.folder / "names").write_text("subjectAltName=DNS:localhost")
        openssl("x509", "-req", "-in", "hook.csr", "-CA", "authority.pem", "-CAkey", "authority.key", "-CAcreateserial", "-out",
                "hook.pem", "-days", "2", "-extfile", "names")

    def start_hook(self, *options):
        self.start("--print", "--hook", f"https://localhost:{self.receiver.port}/hook?of=mine", "--hook-key",
                   str(self.folder / "key"), *options)

    def lines(self):
        return [line for line in self.said().splitlines() if re.match(r"\d+  ", line)]

    def queue(self):
        return json.loads((self.folder / "state" / "ktr" / "watch-hook").read_text())

    def test_each_is_posted_once_and_signed(self):
        self.start_hook()
        for _ in range(3):
            self.arrive()
        self.assertTrue(self.receiver.wait_for(3), self.said())
        time.sleep(1)
        self.assertEqual(len(self.receiver.posts), 3)
        for number, (_, line, fields, body) in enumerate(self.receiver.posts, 1):
            self.assertEqual(line, "POST /hook?of=mine HTTP/1.1")
            seconds, mac = re.fullmatch(r"t=(\d+),v1=([0-9a-f]{64})", fields["ktr-signature"]).groups()
            self.assertLess(abs(time.time() - int(seconds)), 60)
            expected = hmac.new(KEY.encode(), f"{seconds}.".encode() + body, hashlib.sha256).hexdigest()
            self.assertTrue(hmac.compare_digest(mac, expected))
            self.assertEqual(fields["ktr-event"], str(number))
            self.assertEqual(fields["content-type"], "application/json")
            self.assertNotIn("authorization", fields, "the service's secret is not the hook's")
            said = json.loads(body)
            self.assertEqual({name: said[name] for name in ("id", "name", "trigger", "place")},
                             {"id": str(number), "name": "Ann", "trigger": "OnArrival", "place": "Office"})
        self.assertTrue(eventually(lambda: self.queue() == {"last": 3, "waiting": []}))

    def test_what_is_refused_is_tried_again_and_redirects_are_not_followed(self):
        self.receiver.answers = [500, 307, 200]
        self.start_hook()
        self.arrive()
        self.assertTrue(self.receiver.wait_for(3), self.said())
        self.assertEqual(self.receiver.redirected, [])
        self.assertEqual(len({fields["ktr-event"] for _, _, fields, _ in self.receiver.posts}), 1)
        gaps = [after[0] - before[0] for before, after in zip(self.receiver.posts, self.receiver.posts[1:])]
        self.assertGreater(gaps[0], 4.5)
        self.assertGreater(gaps[1], 9.5)
        self.receiver.answers = ["reset", 404, 302]
        self.arrive()
        self.assertTrue(self.receiver.wait_for(6), self.said())
        self.assertTrue(eventually(lambda: "it is not tried again" in self.said()))
        self.assertEqual(self.receiver.redirected, [])
        self.arrive()
        self.assertTrue(self.receiver.wait_for(7), "the next one is posted")

    def test_receiver_that_says_nothing_holds_up_nobody(self):
        self.receiver.answers = ["silent", "drip", 200]
        self.start_hook()
        for _ in range(3):
            self.arrive()
        self.assertTrue(eventually(lambda: len(self.lines()) == 3, 15), self.said())
        self.assertEqual(len(self.receiver.posts), 1, "one at a time, and the lines do not wait for it")
        self.assertEqual(len(self.queue()["waiting"]), 3)
        self.assertTrue(self.receiver.wait_for(2, 40), "given up after its time")
        self.assertGreater(self.receiver.posts[1][0] - self.receiver.posts[0][0], 14)
        self.assertTrue(self.receiver.wait_for(5, 90), "and so is one that drips")
        self.assertEqual([fields["ktr-event"] for _, _, fields, _ in self.receiver.posts], ["1", "1", "1", "2", "3"])

    def test_what_waits_survives_the_end_of_the_program(self):
        self.receiver.answers = ["silent"]
        self.start_hook()
        self.arrive()
        self.arrive()
        self.assertTrue(eventually(lambda: len(self.lines()) == 2), self.said())
        self.kill()
        self.assertEqual(pathlib.Path(self.folder / "state" / "ktr" / "watch-hook").stat().st_mode & 0o777, 0o600)
        self.start_hook()
        self.assertTrue(self.receiver.wait_for(3), self.said())
        time.sleep(1)
        self.assertEqual([fields["ktr-event"] for _, _, fields, _ in self.receiver.posts], ["1", "1", "2"])
        self.assertEqual(len(self.lines()), 2, "nothing is told twice")

    def test_receiver_whose_authority_nobody_knows_gets_nothing(self):
        self.configure()
        self.start_hook()
        self.arrive()
        self.assertTrue(eventually(lambda: len(self.lines()) == 1), self.said())
        time.sleep(7)
        self.assertEqual(self.receiver.posts, [])


@unittest.skipUnless(shutil.which("dbus-daemon") and subprocess.run(
    ["/usr/bin/python3", "-c", "import dbusmock"], capture_output=True, check=False).returncode == 0, "no dbusmock")
class NotificationTest(WatchCase):
    def setUp(self):
        super().setUp()
        self.configure()
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = self.bus("session")
        self.environment["DBUS_SYSTEM_BUS_ADDRESS"] = self.bus("system")
        self.shown = self.folder / "shown"
        # As desktops agreed: what replaces one has its number.
        with self.shown.open("w") as out:
            self.mock("--session", NOTIFICATIONS, PATH, NOTIFICATIONS, stdout=out)
        self.tell("session", NOTIFICATIONS, PATH, "AddMethod", NOTIFICATIONS, "Notify", "susssasa{sv}i", "u",
                  "ret = args[1] or 1")
        self.mock("--system", LOGIND, MANAGER, f"{LOGIND}.Manager", stdout=subprocess.DEVNULL)
        self.tell("system", LOGIND, MANAGER, "AddMethod", f"{LOGIND}.Manager", "GetSessionByPID", "u", "o",
                  f"ret = dbus.ObjectPath('{SESSION}')")
        self.tell("system", LOGIND, MANAGER, "AddObject", SESSION, f"{LOGIND}.Session", "{'LockedHint': <false>}",
                  "@a(ssss) []")

    def bus(self, kind):
        configuration = self.folder / f"{kind}.conf"
        configuration.write_text(f"""<busconfig><type>{kind}</type><listen>unix:tmpdir=/tmp</listen>
            <policy context="default"><allow send_destination="*" eavesdrop="true"/><allow receive_sender="*"/>
            <allow own="*"/></policy></busconfig>""")
        daemon = subprocess.Popen(["dbus-daemon", f"--config-file={configuration}", "--nofork", "--print-address=1"],
                                  stdout=subprocess.PIPE, text=True)
        self.addCleanup(daemon.stdout.close)
        self.addCleanup(daemon.wait)
        self.addCleanup(daemon.terminate)
        return daemon.stdout.readline().strip()

    def mock(self, *words, stdout):
        mock = subprocess.Popen(["/usr/bin/python3", "-u", "-m", "dbusmock", *words], env=self.environment, stdout=stdout)
        self.addCleanup(mock.wait)
        self.addCleanup(mock.terminate)

    def tell(self, bus, name, path, method, *arguments):
        self.assertTrue(eventually(lambda: subprocess.run(
            ["gdbus", "call", f"--{bus}", "-d", name, "-o", path, "-m", f"org.freedesktop.DBus.Mock.{method}", *arguments],
            env=self.environment, capture_output=True, check=False).returncode == 0, 30), (name, method))

    def notifications(self):
        """Number, title and body, in the order in which they were told."""
        return re.findall(r' Notify "ktr" (\d+) "" "([^"]*)" "([^"]*)"', self.shown.read_text())

    def test_each_is_shown_once_whenever_the_program_is_killed(self):
        kills = 200 if os.environ.get("KTR_LONG_TESTS") else 12
        chance = random.Random(14)
        self.start()
        for number in range(kills):
            self.arrive()
            time.sleep(chance.random() * 2.5)
            self.kill()
            if number % 5 == 4:
                self.service.process.kill()
                self.service.process.wait()
                self.service.start()
            self.start()
        self.assertTrue(eventually(lambda: len({one[0] for one in self.notifications()}) == kills), self.said())
        time.sleep(3)
        told = self.notifications()
        numbers = [int(number) for number, _, _ in told]
        self.assertEqual({(title, body) for _, title, body in told}, {("Ann", "Arrived: Office")})
        # On the screen there is one of a number, however often it is told.
        self.assertEqual(sorted(set(numbers)), list(range(min(numbers), min(numbers) + kills)))
        self.assertEqual(numbers, sorted(numbers), "in order")
        self.assertGreater(min(numbers), 1 << 30, "far from those that a server gives out")
        print(f"{kills} kills: {len(numbers) - kills} told again under their number", file=sys.stderr)

    def test_while_locked_nobody_is_named(self):
        self.tell("system", LOGIND, SESSION, "UpdateProperties", f"{LOGIND}.Session", "{'LockedHint': <true>}")
        self.start()
        self.arrive()
        self.assertTrue(eventually(lambda: len(self.notifications()) == 1), self.said())
        self.tell("system", LOGIND, SESSION, "UpdateProperties", f"{LOGIND}.Session", "{'LockedHint': <false>}")
        time.sleep(0.5)
        self.arrive()
        self.assertTrue(eventually(lambda: len(self.notifications()) == 2), self.said())
        self.assertEqual([one[1:] for one in self.notifications()], [("Somebody arrived", ""), ("Ann", "Arrived: Office")])
        self.assertNotIn("Ann", self.shown.read_text().split("Somebody arrived")[0])

    def windows(self):
        """The arguments of each window on this test's configuration, by its process."""
        found = {}
        own = f"KTR_CONFIG={self.folder / 'config.json'}".encode()
        for place in pathlib.Path("/proc").glob("[0-9]*"):
            with contextlib.suppress(OSError):
                words = (place / "cmdline").read_bytes().decode().split("\0")[:-1]
                if own in (place / "environ").read_bytes().split(b"\0") and "show" in words:
                    found[int(place.name)] = words[words.index("show"):]
        return found

    def end_windows(self):
        for process in self.windows():
            os.kill(process, signal.SIGKILL)

    def test_click_asks_in_the_language_of_the_configuration(self):
        self.addCleanup(self.end_windows)
        self.configure(language="de")
        self.start(language=())
        self.arrive()
        self.assertTrue(eventually(lambda: len(self.notifications()) == 1), self.said())
        number, _, body = self.notifications()[0]
        self.assertEqual(body, "Angekommen: Office")
        self.tell("session", NOTIFICATIONS, PATH, "EmitSignal", NOTIFICATIONS, "ActionInvoked", "us",
                  f"[<uint32 {number}>, <'default'>]")
        self.assertTrue(eventually(lambda: self.windows(), 20), self.said())
        self.assertEqual(list(self.windows().values()), [["show", "--ask", "Wo ist Ann?"]])


if __name__ == "__main__":
    unittest.main()
