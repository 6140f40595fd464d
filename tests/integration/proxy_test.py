#!/usr/bin/env python3
"""The service of one's own behind the proxies whose configurations come with it, started for real on loopback.

  proxy_test.py SERVICE [unittest options]

A proxy that is not installed is skipped, and so said; KTR_LONG_TESTS=1 (./test --all) demands both.
"""
import concurrent.futures
import http.client
import json
import os
import pathlib
import re
import shutil
import socket
import ssl
import subprocess
import sys
import time
import unittest

import postgres
from service_program import COMMANDS, ServiceProgram, basic, free_port

SERVICE = sys.argv.pop(1)
API = {"Content-Type": "application/json", "X-Orcha-Seek-API-Ver": "4.0", "X-Orcha-AuthScheme": "Forever"}
PACKAGING = pathlib.Path(os.environ["KTR_SOURCE"]) / "packaging"
NGINX = """
daemon off; master_process off; pid {folder}/nginx.pid; error_log {folder}/proxy-log;
events {{}}
http {{
    access_log {folder}/proxy-access-log;
    client_body_temp_path {folder}/n1; proxy_temp_path {folder}/n2; fastcgi_temp_path {folder}/n3;
    uwsgi_temp_path {folder}/n4; scgi_temp_path {folder}/n5;
    include {folder}/ktr-service.conf;
}}
"""


class Bound(http.client.HTTPSConnection):
    """From one of this machine's own addresses, to another name than the certificate's if need be."""

    def __init__(self, port, context, source="127.0.0.1", timeout=20):
        super().__init__("localhost", port, context=context, timeout=timeout, source_address=(source, 0))

    def connect(self):
        raw = socket.create_connection(("127.0.0.1", self.port), self.timeout, self.source_address)
        self.sock = self._context.wrap_socket(raw, server_hostname="localhost")


class Proxied:
    """A service behind either proxy, and what is asked through it."""
    program = ""

    def setUp(self):
        if not shutil.which(self.program):
            self.assertFalse(os.environ.get("KTR_LONG_TESTS"), f"{self.program} is not installed")
            self.skipTest(f"{self.program} is not installed")
        self.time = 0
        self.service = ServiceProgram(self, SERVICE, store=self.store())
        self.folder = self.service.folder
        self.secret = self.service.add("Ann")
        self.service.add("Mara")
        self.reader = self.service.reader("Mara")
        self.service.command("share", "Ann", "Mara")
        self.services = self.processes()
        for service in self.services:
            service.start("--socket", service.socket)
        self.certificate = self.folder / "proxy.pem"
        subprocess.run(["openssl", "req", "-x509", "-newkey", "ec", "-pkeyopt", "ec_paramgen_curve:prime256v1", "-nodes",
                        "-days", "2", "-subj", "/CN=localhost", "-addext", "subjectAltName=DNS:localhost", "-keyout",
                        str(self.folder / "proxy-key.pem"), "-out", str(self.certificate)], check=True,
                       capture_output=True)
        self.context = ssl.create_default_context(cafile=str(self.certificate))
        for _ in range(3):
            # A port that was free a moment ago may be somebody else's by now.
            if self.started():
                return
        self.fail(self.proxy_log())

    def store(self):
        """None: a file."""

    def processes(self):
        return [self.service]

    def started(self):
        self.port = free_port()
        with open(self.folder / "proxy-log", "ab") as log:
            process = subprocess.Popen(self.line(), stdout=log, stderr=log, cwd=self.folder, env={
                **os.environ, "HOME": str(self.folder), "XDG_DATA_HOME": str(self.folder), "XDG_CONFIG_HOME": str(self.folder)})
        self.addCleanup(lambda: (process.kill(), process.wait()))
        deadline = time.monotonic() + 30
        while process.poll() is None and time.monotonic() < deadline:
            try:
                self.request("GET", "/")
                return process.poll() is None
            except OSError:
                time.sleep(0.05)
        return False

    def proxy_log(self):
        return "".join(file.read_text(errors="replace") for file in sorted(self.folder.glob("proxy-*log")))

    def replaced(self, name, *changes):
        """The configuration as it comes, with the places of this test."""
        text = (PACKAGING / name).read_text()
        for pattern, replacement in changes:
            text, count = re.subn(pattern, replacement, text, flags=re.MULTILINE)
            self.assertGreater(count, 0, pattern)
        return text

    def request(self, method, path, body=b"", source="127.0.0.1", credentials=None, **headers):
        connection = Bound(self.port, self.context, source)
        if credentials:
            headers["Authorization"] = basic(*credentials)
        connection.request(method, path, body, headers)
        answer = connection.getresponse()
        text = answer.read()
        connection.close()
        return answer.status, text

    def next_time(self):
        """Each later than the one before: a fix of the same second counts once. None is from before a grant."""
        self.time = max(self.time + 1, int(time.time()))
        return self.time

    def post(self, latitude, **more):
        body = json.dumps({"_type": "location", "lat": latitude, "lon": -3, "tst": self.next_time(), "acc": 9})
        return self.request("POST", "/pub", body, credentials=("Ann", self.secret), **more)

    def ask(self):
        body = json.dumps({"clientContext": {}, "handles": ["ann@x.example"]})
        status, text = self.request("POST", COMMANDS + "getlocations", body, credentials=("Mara", self.reader), **API)
        self.assertEqual(status, 200, text)
        return json.loads(text)["locations"]["ann@x.example"]["location"]["latitude"]


class OneProcess(Proxied):
    """What holds behind either proxy."""

    def test_phone_posts_and_reader_asks(self):
        self.assertEqual(self.post(50.25)[0], 200)
        self.assertEqual(self.ask(), 50.25)
        self.assertEqual(self.request("POST", "/pub", "{}", credentials=("Ann", "wrong"))[0], 401)
        self.assertEqual(self.request("GET", f"/?id={self.secret}&lat=50.5&lon=-3&timestamp={self.next_time()}"),
                         (200, b""))
        self.assertEqual(self.ask(), 50.5)

    def test_other_name_is_never_delivered(self):
        for host in ("other.example", "127.0.0.1", "localhost.other.example"):
            status, _ = self.request("POST", "/pub", "{}", credentials=("Ann", self.secret), Host=host)
            self.assertEqual(status, 421, host)

    def test_health_and_numbers_are_not_forwarded(self):
        for path in ("/health", "/metrics", "//metrics", "/%6detrics", "/./metrics", "/x/../metrics", "/metrics/",
                     "/metrics?x", "/metrics%3f", "/METRICS"):
            status, text = self.request("GET", path)
            self.assertNotEqual(status, 200, path)
            self.assertNotIn(b"ktr_service", text)

    def test_client_cannot_choose_its_address(self):
        def seconds(source, **headers):
            begin = time.monotonic()
            self.assertEqual(self.request("POST", "/pub", "{}", source, ("Ann", "wrong"), **headers)[0], 401)
            return time.monotonic() - begin

        for number in range(4):
            last = seconds("127.0.0.5", **{"X-Forwarded-For": f"192.0.2.{number}", "Forwarded": f"for=192.0.2.{number}"})
        self.assertGreaterEqual(last, 1.9)
        self.assertLess(seconds("127.0.0.6"), last - 0.5)

    def test_no_secret_is_written_not_even_when_the_service_is_gone(self):
        def everything():
            statuses = [self.request("GET", f"/?id={self.secret}&lat=50.5&lon=-3")[0], self.post(50.75)[0]]
            self.request("GET", "/canary-path?canary-query", **{"User-Agent": "canary-agent"})
            return statuses

        self.assertEqual(everything(), [200, 200])
        self.service.stop()
        self.assertEqual(everything(), [502, 502])
        self.service.start("--socket", self.service.socket)
        # A phone tries again.
        deadline = time.monotonic() + 20
        while self.post(50.875)[0] != 200:
            self.assertLess(time.monotonic(), deadline)
            time.sleep(0.2)
        self.assertEqual(self.ask(), 50.875)
        written = self.proxy_log() + self.service.log()
        for word in (self.secret, self.reader, "canary", "lat=", "50.75", basic("Ann", self.secret)[6:]):
            self.assertNotIn(word, written)

    def raw(self, *pieces):
        """What comes back for these bytes on one connection."""
        with socket.create_connection(("127.0.0.1", self.port), 20) as plain:
            with self.context.wrap_socket(plain, server_hostname="localhost") as connection:
                for piece in pieces:
                    connection.sendall(piece)
                    time.sleep(0.05)
                connection.settimeout(1)
                got = b""
                try:
                    while block := connection.recv(65536):
                        got += block
                except (TimeoutError, OSError):
                    pass
                return got

    def test_nothing_is_smuggled(self):
        """A request hidden in another's body is never taken for one, whatever lengths are claimed."""
        body = json.dumps({"clientContext": {}, "handles": ["ann@x.example"]}).encode()
        hidden = (b"POST " + COMMANDS.encode() + b"getlocations HTTP/1.1\r\nHost: localhost\r\nAuthorization: "
                  + basic("Mara", self.reader).encode() + b"\r\nX-Orcha-Seek-API-Ver: 4.0\r\nContent-Length: "
                  + str(len(body)).encode() + b"\r\n\r\n" + body)
        head = (b"POST /pub HTTP/1.1\r\nHost: localhost\r\nAuthorization: " + basic("Ann", self.secret).encode() + b"\r\n")
        chunked = b"0\r\n\r\n" + hidden
        size = str(len(chunked)).encode()
        lengths = [
            b"Content-Length: " + size + b"\r\nTransfer-Encoding: chunked\r\n",
            b"Transfer-Encoding: chunked\r\nContent-Length: " + size + b"\r\n",
            b"Content-Length: " + size + b"\r\nTransfer-Encoding : chunked\r\n",
            b"Content-Length: " + size + b"\r\nTransfer-Encoding:\tchunked\r\n",
            b"Content-Length: " + size + b"\r\nTransfer-Encoding: xchunked\r\n",
            b"Content-Length: " + size + b"\r\nTransfer-Encoding: chunked, identity\r\n",
            b"Content-Length: " + size + b"\r\nTransfer-Encoding: identity, chunked\r\n",
            b"Content-Length: " + size + b"\r\nX: x\n Transfer-Encoding: chunked\r\n",
            b"Content-Length: " + size + b"\r\nX: x\nTransfer-Encoding: chunked\r\n",
            b"Content-Length: " + size + b"\r\nTransfer-Encoding: chunked\r\nTransfer-Encoding: identity\r\n",
            b"Content-Length: 5\r\nContent-Length: " + size + b"\r\n",
            b"Content-Length: " + size + b"\r\nContent-Length: 5\r\n",
            b"Content-Length: 5, " + size + b"\r\n",
            b"Content-Length: +" + size + b"\r\n",
            b"Content-Length: 0x" + b"%x" % len(chunked) + b"\r\n",
            b"Content_Length: 5\r\nContent-Length: " + size + b"\r\n",
        ]
        before = self.service.numbers(True)
        for length in lengths:
            self.raw(head + length + b"\r\n" + chunked)
            # Whoever comes next on the proxy's connections gets his own answer.
            self.assertEqual(self.request("GET", "/nowhere")[0], 404, length)
        after = self.service.numbers(True)
        hidden_seen = [name for name in after if "getlocations" in name and after[name] != before.get(name, 0)]
        # Where a proxy ends the body at the last chunk, what follows is a request that the client sent openly, for all to
        # see: then it is answered to that client. Never is it somebody else's.
        answered = after.get('ktr_service_requests_total{route="getlocations",status="2xx"}', 0)
        self.assertLessEqual(answered, len(lengths), hidden_seen)
        self.assertEqual(after.get("ktr_service_requests_refused_at_the_edge_total", 0),
                         before.get("ktr_service_requests_refused_at_the_edge_total", 0),
                         "the proxy passed on what two readers could understand differently")

    def test_answers_are_never_swapped(self):
        """Bodies that end too early and clients that leave, beside others on the proxy's kept connections."""
        for number in range(12):
            got = self.raw(b"POST /pub HTTP/1.1\r\nHost: localhost\r\n"
                           + (b"Transfer-Encoding: chunked\r\n\r\n3\r\nab" if number % 2 else b"Content-Length: 9\r\n\r\nab"))
            self.assertNotIn(b" 200 ", got)
            self.assertEqual(self.post(50 + number / 100)[0], 200)
            self.assertEqual(self.ask(), 50 + number / 100)
            self.assertEqual(self.request("GET", f"/nowhere{number}")[0], 404)

    def test_oversized_requests_are_refused(self):
        for method, path, body in (("POST", "/pub", b"x" * 9000000), ("GET", "/" + "x" * 40000, b"")):
            try:
                status = self.request(method, path, body, credentials=("Ann", self.secret))[0]
            except OSError:
                status = 0  # it did not even read it
            self.assertIn(status, (0, 400, 413, 414, 431), path[:10])
        # A phone would drop what is refused, or send it for ever: the service counts it and takes the next.
        self.assertEqual(self.request("POST", "/pub", b"x" * 1500000, credentials=("Ann", self.secret))[0], 200)
        self.assertEqual(self.post(50.5)[0], 200)


@unittest.skipUnless(os.environ.get("KTR_LONG_TESTS"), "starts a database server: KTR_LONG_TESTS=1 does")
class TwoProcesses(Proxied):
    """Two processes with one PostgreSQL server: it does not matter which of them one meets."""

    def store(self):
        return postgres.Postgres(self).address

    def processes(self):
        return [self.service, self.service.on_another_machine()]

    def post_at(self, service, latitude):
        status, text = service.post("Ann", self.secret, True, _type="location", lat=latitude, lon=-3, tst=self.next_time(), acc=9)
        self.assertEqual(status, 200, text)

    def seen_at(self, service):
        """None: nothing is."""
        status, text = service.ask("Mara", self.reader, "ann@x.example", by_socket=True)
        self.assertEqual(status, 200, text)
        entry = json.loads(text)["locations"].get("ann@x.example")
        return entry and entry["location"]["latitude"]

    def test_fix_that_one_took_is_told_by_the_other_and_the_proxy_asks_both(self):
        first, second = self.services
        for number in range(10):
            self.post_at(first, 50 + number / 100)
            self.assertEqual(self.seen_at(second), 50 + number / 100)
            self.post_at(second, 51 + number / 100)
            self.assertEqual(self.seen_at(first), 51 + number / 100)

        def requests(service):
            numbers = service.numbers(True)
            return numbers["ktr_service_posts_total"] + numbers["ktr_service_commands_total"]

        before = [requests(service) for service in self.services]
        for number in range(30):
            self.assertEqual(self.post(52 + number / 100)[0], 200)
            self.assertEqual(self.ask(), 52 + number / 100)
        for service, count in zip(self.services, before):
            self.assertGreater(requests(service), count, "it met no request")

    def test_what_is_taken_back_at_one_is_gone_at_both_at_once(self):
        first, second = self.services
        for number, (take, give) in enumerate(((("revoke", "Ann", "Mara"), ("share", "Ann", "Mara")),
                                               (("hide", "Ann"), ("show", "Ann")))):
            time.sleep(2)  # what was before a showing is not seen again
            self.post_at(first, 50 + number)
            self.assertEqual([self.seen_at(service) for service in self.services], [50 + number] * 2)
            first.command(*take)
            self.assertEqual([self.seen_at(service) for service in (second, first)], [None, None], take)
            second.command(*give)
        # By a command of a program's, in its owner's words.
        owner = first.reader("Ann")
        time.sleep(2)
        self.post_at(second, 53)
        self.assertEqual(self.seen_at(first), 53)
        self.assertEqual(first.request("POST", COMMANDS + "sharing", json.dumps({"clientContext": {}, "wish": "hide"}), True,
                                       ("Ann", owner), **API)[0], 200)
        self.assertIsNone(self.seen_at(second))
        # A secret that ended.
        first.command("revoke", "Mara")
        for service in (second, first):
            self.assertEqual(service.ask("Mara", self.reader, "ann@x.example", by_socket=True)[0], 401)

    def test_answer_that_waits_at_one_ends_with_what_is_taken_back_at_the_other(self):
        first, second = self.services
        self.post_at(first, 50)
        self.assertEqual(self.seen_at(second), 50)
        with concurrent.futures.ThreadPoolExecutor(1) as pool:
            deadline = time.monotonic() + 20
            while True:  # until one waits: the first ones are answered at once
                waits = pool.submit(self.seen_at, second)
                time.sleep(1.2)
                if not waits.done():
                    break
                self.assertEqual(waits.result(), 50)
                self.assertLess(time.monotonic(), deadline, "none was held")
            begin = time.monotonic()
            first.command("revoke", "Ann", "Mara")
            self.assertIsNone(waits.result())
            self.assertLess(time.monotonic() - begin, 5, "it ended by itself")

    def test_one_that_ends_is_not_missed(self):
        for gone, stays in (self.services, self.services[::-1]):
            gone.stop()
            for number in range(6):
                deadline = time.monotonic() + 20
                while self.post(50 + number / 10)[0] != 200:  # a phone tries again
                    self.assertLess(time.monotonic(), deadline)
                self.assertEqual(self.seen_at(stays), 50 + number / 10)
            gone.start("--socket", gone.socket)


class Caddy:
    program = "caddy"

    def line(self):
        text = self.replaced("Caddyfile", (r"^\{$", "{\n\tadmin off\n\tauto_https disable_redirects\n\tskip_install_trust"),
                             (r"^home\.example \{", f"localhost:{self.port} {{\n\ttls {self.certificate} "
                              f"{self.folder}/proxy-key.pem"),
                             (r"^https:// \{", f"https://:{self.port} {{"),
                             ("unix//run/ktr-service/http.sock", " ".join("unix/" + one.socket for one in self.services)))
        (self.folder / "Caddyfile").write_text(text)
        return ["caddy", "run", "--config", str(self.folder / "Caddyfile"), "--adapter", "caddyfile"]


class Nginx:
    program = "nginx"

    def line(self):
        text = self.replaced("nginx.conf", (r"listen 443 ssl", f"listen 127.0.0.1:{self.port} ssl"),
                             (r"server_name home\.example", "server_name localhost"),
                             ("server unix:/run/ktr-service/http.sock;",
                              " ".join(f"server unix:{one.socket};" for one in self.services)),
                             ("/etc/ssl/home.example/fullchain.pem", str(self.certificate)),
                             ("/etc/ssl/home.example/privkey.pem", f"{self.folder}/proxy-key.pem"))
        (self.folder / "ktr-service.conf").write_text(text)
        (self.folder / "nginx-main.conf").write_text(NGINX.format(folder=self.folder))
        return ["nginx", "-p", str(self.folder), "-c", str(self.folder / "nginx-main.conf"), "-e",
                str(self.folder / "proxy-log")]


class CaddyTest(Caddy, OneProcess, unittest.TestCase):
    pass


class NginxTest(Nginx, OneProcess, unittest.TestCase):
    pass


class CaddyToTwoTest(Caddy, TwoProcesses, unittest.TestCase):
    pass


class NginxToTwoTest(Nginx, TwoProcesses, unittest.TestCase):
    pass


if __name__ == "__main__":
    unittest.main(warnings="ignore")
