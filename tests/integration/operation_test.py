#!/usr/bin/env python3
"""The service of one's own as whoever runs it meets it: readiness, watchdog, sockets of the service manager, its log, its numbers.

  operation_test.py SERVICE [unittest options]
"""
import json
import os
import pathlib
import re
import shutil
import socket
import sqlite3
import subprocess
import sys
import time
import unittest

from service_program import COMMANDS, ServiceProgram

SERVICE = sys.argv.pop(1)


class OperationTest(unittest.TestCase):
    def setUp(self):
        self.service = ServiceProgram(self, SERVICE)

    def manager(self):
        """Where a service manager listens."""
        path = str(self.service.folder / "notify")
        listening = socket.socket(socket.AF_UNIX, socket.SOCK_DGRAM)
        self.addCleanup(listening.close)
        listening.bind(path)
        listening.settimeout(20)
        return path, listening

    def test_manager_hears_of_readiness_then_of_life_and_of_the_end(self):
        path, manager = self.manager()
        self.service.start(environment={"NOTIFY_SOCKET": path})
        heard = [manager.recv(4096).decode()]
        while heard.count("WATCHDOG=1") < 3:
            heard.append(manager.recv(4096).decode())
        self.assertEqual(self.service.request("GET", "/health")[0], 200)
        self.assertEqual(heard.count("READY=1"), 1)
        self.service.stop()
        while heard[-1] != "STOPPING=1":
            heard.append(manager.recv(4096).decode())

    def test_life_is_not_told_while_the_store_stands_still(self):
        path, manager = self.manager()
        self.service.start(environment={"NOTIFY_SOCKET": path})
        while manager.recv(4096) != b"WATCHDOG=1":
            pass
        # A store whose disk does not answer: another process holds it for writing.

        other = sqlite3.connect(self.service.folder / "data" / "service.db", isolation_level=None)
        self.addCleanup(other.close)
        other.execute("BEGIN IMMEDIATE")
        manager.settimeout(3.5)
        heard = 0
        try:
            while heard < 4:
                manager.recv(4096)
                heard += 1
        except TimeoutError:
            pass
        self.assertLess(heard, 4, "it said that it lives while nothing could be written")
        other.execute("ROLLBACK")
        manager.settimeout(20)
        self.assertEqual(manager.recv(4096), b"WATCHDOG=1")

    def test_socket_of_the_service_manager_is_served(self):
        if not shutil.which("systemd-socket-activate"):
            self.skipTest("systemd-socket-activate is not installed")
        service = self.service
        process = subprocess.Popen(["systemd-socket-activate", "-l", service.socket, SERVICE, "--data",
                                    str(service.folder / "data"), "serve"], stdout=subprocess.PIPE,
                                   stderr=subprocess.DEVNULL, text=True)
        self.addCleanup(process.stdout.close)
        self.addCleanup(lambda: process.poll() is not None or (process.kill(), process.wait()))
        deadline = time.monotonic() + 20
        while not pathlib.Path(service.socket).exists() and time.monotonic() < deadline:
            time.sleep(0.02)
        self.assertEqual(service.request("GET", "/health", by_socket=True)[0], 200)
        process.terminate()
        self.assertEqual(process.wait(timeout=30), 0)
        self.assertIn("a socket of the service manager", process.stdout.read())
        self.assertTrue(pathlib.Path(service.socket).exists(), "it is not the service's to remove")

    def test_plain_http_is_not_served_at_an_address(self):
        self.service.start("--address", "127.0.0.1", "--socket", self.service.socket)
        with socket.create_connection(("127.0.0.1", self.service.port), timeout=20) as plain:
            plain.sendall(b"GET /health HTTP/1.1\r\nHost: localhost\r\n\r\n")
            try:
                got = plain.recv(100)
            except ConnectionResetError:
                got = b""
        self.assertFalse(got.startswith(b"HTTP/"), got)
        self.assertEqual(self.service.request("GET", "/health", by_socket=True)[0], 200)

    def test_health_and_numbers_are_for_this_machine_alone(self):
        self.service.start("--socket", self.service.socket)
        for path in ("/health", "/metrics"):
            self.assertEqual(self.service.request("GET", path, by_socket=True)[0], 200)
            for header in ("X-Forwarded-For", "Forwarded"):
                self.assertEqual(self.service.request("GET", path, by_socket=True, **{header: "127.0.0.1"})[0], 404)

    def wait_for_health(self, status):
        deadline = time.monotonic() + 30
        while self.service.request("GET", "/health", by_socket=True)[0] != status:
            self.assertLess(time.monotonic(), deadline)
            time.sleep(0.2)

    def test_full_disk_is_said_by_health_and_log_and_forgotten_when_it_is_mended(self):
        service = self.service
        secret = service.add("Ann")
        service.start("--socket", service.socket)

        other = sqlite3.connect(service.folder / "data" / "service.db", isolation_level=None)
        self.addCleanup(other.close)
        # As long as this lasts no commit is possible.
        other.execute("BEGIN IMMEDIATE")
        status, _ = service.post("Ann", secret, True, _type="location", lat=1, lon=2, tst=int(time.time()))
        self.assertEqual(status, 503)
        self.assertEqual(service.request("GET", "/health", by_socket=True)[0], 503, "at once")
        other.execute("ROLLBACK")
        self.wait_for_health(200)
        log = service.log()
        self.assertIn("level=error event=store-failing", log)
        self.assertIn("event=failed route=phone status=503", log)
        self.assertIn("event=store-mended", log)

    def test_store_that_cannot_be_read_is_not_said_to_know_nobody(self):
        service = self.service
        secret = service.add("Ann")
        reader = service.reader("Ann")
        service.start("--socket", service.socket)
        other = sqlite3.connect(service.folder / "data" / "service.db", isolation_level=None)
        self.addCleanup(other.close)
        for table in ("share", "device", "person", "fix"):
            other.execute(f"ALTER TABLE {table} RENAME TO gone")
            if table != "fix":  # which is read of those alone who are seen
                self.assertEqual(service.ask("Ann", reader, "nobody@x.example", by_socket=True)[0], 503, table)
                self.assertEqual(service.request("GET", "/health", by_socket=True)[0], 503, table)
            status = service.post("Ann", secret, True, _type="location", lat=1, lon=2, tst=int(time.time()))[0]
            self.assertEqual(status, 503, table)
            other.execute(f"ALTER TABLE gone RENAME TO {table}")
        self.wait_for_health(200)
        status, text = service.ask("Ann", reader, "a\0@x.example", "nobody@x.example", by_socket=True)
        self.assertEqual((status, len(json.loads(text)["emails"])), (200, 2), "no text of a handle is a failure")
        self.assertEqual(service.ask("Ann", reader, "nobody@x.example", by_socket=True)[0], 200)
        self.assertEqual(service.post("Ann", secret, True, _type="location", lat=1, lon=2, tst=int(time.time()))[0], 200)

    def test_wrong_secrets_are_delayed_by_the_address_that_the_proxy_names(self):
        service = self.service
        secret = service.add("Ann")
        service.start("--socket", service.socket)

        def seconds(address, password):
            begin = time.monotonic()
            status = service.request("POST", "/pub", "{}", True, ("Ann", password), **{"X-Forwarded-For": address})[0]
            self.assertEqual(status, 200 if password == secret else 401)
            return time.monotonic() - begin

        for _ in range(4):
            guessing = seconds("192.0.2.1", "wrong")
        self.assertGreaterEqual(guessing, 1.9)
        self.assertLess(seconds("192.0.2.2", "wrong"), guessing - 0.5, "another address waits no longer than the first time")
        self.assertLess(seconds("192.0.2.1", secret), guessing - 0.5, "who has the right one never waits")

    def test_nothing_of_anybody_is_written_anywhere(self):
        service = self.service
        secret = service.add("Canaryann")
        service.add("Canarymara")
        reader = service.reader("Canarymara")
        service.command("share", "Canaryann", "Canarymara")
        service.start("--address", "127.0.0.1", "--socket", service.socket)
        now = int(time.time())
        for by_socket in (False, True):
            service.post("Canaryann", secret, by_socket, _type="location", lat=48.123456, lon=11.654321, tst=now,
                         acc=7, SSID="canary-network", topic="canary-topic")
            service.post("Canaryann", "canary-wrong", by_socket, _type="location")
            service.request("GET", f"/?id={secret}&lat=48.123456&lon=11.654321", by_socket=by_socket)
            service.request("GET", "/?id=canary-wrong&lat=48.123456", by_socket=by_socket)
            service.request("POST", "/pub", '{"canary', by_socket, ("Canaryann", secret))
            service.request("GET", "/canary-path?canary-query", by_socket=by_socket,
                            **{"User-Agent": "canary-agent", "X-Limit-U": "canary-user", "Referer": "canary-referer"})
            service.ask("Canarymara", reader, "canaryann@x.example", "canary-unknown@x.example", by_socket=by_socket)
            service.request("POST", COMMANDS + "canary-command", "{}", by_socket, ("Canarymara", reader))
            service.request("POST", COMMANDS + "getlocations", '{"canary": 1', by_socket, ("Canarymara", reader))
            service.request("GET", "/", by_socket=by_socket, Host="canary.example")
        numbers = service.request("GET", "/metrics", by_socket=True)[1]
        service.stop()
        written = service.log() + numbers + service.process.stdout.read()
        self.assertIn("event=refused route=phone status=401", written)
        self.assertIn("event=ready", written)
        for word in ("canary", "48.12", "11.65", "48,12", secret, reader, secret[:8], reader[:8], "x.example",
                     "192.0.2", "127.0.0.1", "id="):
            self.assertNotIn(word.lower(), written.lower())

    @unittest.skipUnless(os.geteuid() == 0, "only an administrator can do what is tested")
    def test_administrator_works_as_the_user_who_serves(self):
        service, nobody = self.service, 65534
        data = service.folder / "data"
        for path in (data, *data.iterdir()):
            os.chown(path, nobody, nobody)
        # As behind systemd's /var/lib/private.
        os.chmod(service.folder, 0o700)
        secret = service.add("Ann")
        service.command("check")
        self.assertEqual({path.stat().st_uid for path in (data, *data.iterdir())}, {nobody}, "no file is another's")
        service.start("--address", "127.0.0.1")
        status = pathlib.Path(f"/proc/{service.process.pid}/status").read_text()
        self.assertRegex(status, rf"Uid:\t{nobody}\t{nobody}\t{nobody}\t{nobody}\n")
        self.assertRegex(status, r"CapEff:\t0+4\n")
        self.assertEqual(service.post("Ann", secret, _type="location", lat=1, lon=2, tst=int(time.time()))[0], 200)
        service.command("add", "Mara")
        # What is the owner's no longer counts as trusted when it is somebody else's.
        os.chown(data / "settings.json", nobody - 1, nobody - 1)
        self.assertIn("belongs to another user", service.command("add", "Zoe", fails=True))

    def test_numbers_are_prometheus(self):
        service = self.service
        secret = service.add("Ann")
        service.start("--socket", service.socket)
        service.post("Ann", secret, True, _type="location", lat=1, lon=2, tst=int(time.time()))
        text = service.request("GET", "/metrics", by_socket=True)[1]
        types = {}
        for line in text.splitlines():
            if line.startswith("#"):
                words = line.split()
                self.assertEqual(words[:2], ["#", "TYPE"])
                self.assertNotIn(words[2], types, "a name is described once")
                types[words[2]] = words[3]
                continue
            match = re.fullmatch(r'([a-z_]+)(\{[a-z]+="[^"]*"(,[a-z]+="[^"]*")*\})? [0-9.]+', line)
            self.assertTrue(match, line)
            name = re.sub("_(bucket|sum|count)$", "", match.group(1))
            self.assertTrue(name in types or match.group(1) in types, line)
        numbers = service.numbers(True)
        self.assertEqual(numbers['ktr_service_requests_total{route="phone",status="2xx"}'], 1)
        self.assertEqual(numbers["ktr_service_store_ok"], 1)
        self.assertGreaterEqual(numbers["ktr_service_connections"], 1)


if __name__ == "__main__":
    unittest.main(warnings="ignore")
