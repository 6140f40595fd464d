#!/usr/bin/env python3
"""Every fault of the development service as a client sees it, its certificates, its end.

  serve_test.py PROGRAM [unittest options]
"""
import base64
import concurrent.futures
import gzip
import http.client
import json
import os
import pathlib
import signal
import socket
import ssl
import stat
import subprocess
import sys
import tempfile
import time
import unittest

from serve import Service

PROGRAM = sys.argv.pop(1)
PATH = "/qloxservice/friends/va/getlocations"
BODY = json.dumps({"clientContext": {}, "handles": ["ann@harbour.example", "otto@mail.example"]})


def connect(service, host="localhost", authority=None):
    context = ssl.create_default_context(cafile=authority or service.authority)
    return http.client.HTTPSConnection(host, service.port, context=context, timeout=20)


def headers(service, **changes):
    all_headers = {"Authorization": service.credentials, "X-Orcha-Seek-API-Ver": "4.0",
                   "X-Orcha-AuthScheme": "Forever", "Content-Type": "application/json"}
    all_headers.update(changes)
    return {name: value for name, value in all_headers.items() if value is not None}


def post(service, body=BODY, connection=None, path=PATH, **changes):
    connection = connection or connect(service)
    connection.request("POST", path, body, headers(service, **changes))
    answer = connection.getresponse()
    return answer, answer.read()


class FaultTest(unittest.TestCase):
    def fault(self, words):
        service = Service(PROGRAM, "--fault", words)
        self.addCleanup(service.__exit__)
        return service

    def test_without_a_fault_it_answers(self):
        with Service(PROGRAM) as service:
            answer, body = post(service)
            self.assertEqual(answer.status, 200)
            self.assertEqual(json.loads(body)["emails"], ["ann@harbour.example", "otto@mail.example"])

    def test_status_meets_the_requests_it_is_for(self):
        service = self.fault("status=503,at=2,count=1")
        self.assertEqual([post(service)[0].status for _ in range(3)], [200, 503, 200])
        _, lines = service.end()
        self.assertEqual(lines, [f"request {n}: getlocations, {s}" for n, s in ((1, 200), (2, 503), (3, 200))])

    def test_cut_before_the_answer(self):
        with self.assertRaises((ConnectionError, http.client.RemoteDisconnected, ssl.SSLError)):
            post(self.fault("cut=before"))

    def test_cut_after_headers_and_in_the_body(self):
        for words in ("cut=headers", "cut=body"):
            with self.assertRaises((http.client.IncompleteRead, ConnectionError, ssl.SSLError), msg=words):
                post(self.fault(words))

    def test_delay(self):
        begin = time.monotonic()
        self.assertEqual(post(self.fault("delay=0.7"))[0].status, 200)
        self.assertGreaterEqual(time.monotonic() - begin, 0.7)

    def test_redirect(self):
        service = self.fault("redirect=https://127.0.0.1:{port}{path},redirectStatus=308")
        answer, _ = post(service, Authorization=None)
        self.assertEqual(answer.status, 308)
        self.assertEqual(answer.headers["Location"], f"https://127.0.0.1:{service.port}{PATH}")

    def test_bodies(self):
        self.assertEqual(post(self.fault("body=empty"))[1], b"")
        self.assertEqual(post(self.fault("text=null"))[1], b"null")
        self.assertTrue(post(self.fault("body=not-json"))[1].startswith(b"<!doctype"))
        self.assertIsInstance(json.loads(post(self.fault("body=array"))[1]), list)
        self.assertEqual(post(self.fault("body=deep"))[1], b"[" * 1000000)
        with self.assertRaises(ValueError):
            json.loads(post(self.fault("body=truncated"))[1])

    def test_endless_body(self):
        service = self.fault("body=endless")
        connection = connect(service)
        connection.request("POST", PATH, BODY, headers(service))
        self.assertEqual(len(connection.getresponse().read(9 << 20)), 9 << 20)
        connection.close()

    def test_slow_body(self):
        service = self.fault("bytesPerSecond=100")
        connection = connect(service)
        begin = time.monotonic()
        connection.request("POST", PATH, BODY, headers(service))
        self.assertEqual(len(connection.getresponse().read(40)), 40)
        self.assertGreaterEqual(time.monotonic() - begin, 0.35)
        connection.close()

    def test_members(self):
        partial = json.loads(post(self.fault("statusCode=416"))[1])
        self.assertEqual((partial["statusCode"], partial["emails"]), (416, ["ann@harbour.example"]))
        dropped = json.loads(post(self.fault("entryStatus=411,entry=otto@mail.example"))[1])["locations"]
        self.assertEqual((dropped["otto@mail.example"]["status"], dropped["ann@harbour.example"]["status"]), (411, 200))
        context = json.loads(post(self.fault("interval=1.5"))[1])["serverContext"]
        self.assertEqual(context["minCallbackIntervalInMS"], 1500)

    def test_script_file(self):
        with Service(PROGRAM) as other:
            script = other.folder / "faults.json"
            script.write_text('{"faults": [{"status": 500, "count": 1}, {"interval": 0}]}')
            with Service(PROGRAM, "--fault-script", str(script)) as service:
                self.assertEqual(post(service)[0].status, 500)
                self.assertEqual(json.loads(post(service)[1])["serverContext"]["minCallbackIntervalInMS"], 0)


class RequestTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.service = Service(PROGRAM)

    @classmethod
    def tearDownClass(cls):
        cls.service.__exit__()

    def test_credentials_and_headers_are_checked(self):
        wrong = "Basic " + base64.b64encode(b"1000:wrong").decode()
        for changes, status in (({"Authorization": None}, 401), ({"Authorization": wrong}, 401),
                                ({"X-Orcha-Seek-API-Ver": "3.0"}, 400), ({"X-Orcha-AuthScheme": None}, 400),
                                ({"Content-Type": "text/plain"}, 415), ({"Host": "evil.example"}, 421)):
            self.assertEqual(post(self.service, **changes)[0].status, status, changes)

    def test_bodies_are_checked(self):
        for body, status in (("", 400), ("[]", 400), ("{", 400), ("[" * 100000, 400), ("{}", 400),
                             ('{"clientContext":{}}', 200), ("x" * (2 << 20), 413)):
            try:
                self.assertEqual(post(self.service, body)[0].status, status, body[:20])
            except (ConnectionError, ssl.SSLError):
                # A server may hang up on a body that it will not read.
                self.assertEqual(status, 413)

    def test_friends_move(self):
        def latitude():
            return json.loads(post(self.service)[1])["locations"]["ann@harbour.example"]["location"]["latitude"]

        first = latitude()
        deadline = time.monotonic() + 10
        while latitude() == first and time.monotonic() < deadline:
            pass
        self.assertNotEqual(latitude(), first)

    def test_one_connection_serves_many_requests(self):
        connection = connect(self.service)
        for _ in range(50):
            self.assertEqual(post(self.service, connection=connection)[0].status, 200)

    def test_old_protocol_versions_are_refused(self):
        context = ssl.create_default_context(cafile=self.service.authority)
        context.minimum_version = ssl.TLSVersion.TLSv1
        context.maximum_version = ssl.TLSVersion.TLSv1_1
        context.set_ciphers("ALL:@SECLEVEL=0")
        with self.assertRaises((ssl.SSLError, ConnectionError)):
            with socket.create_connection(("127.0.0.1", self.service.port)) as plain:
                context.wrap_socket(plain, server_hostname="localhost").close()

    def test_it_listens_on_loopback_alone(self):
        with open("/proc/net/tcp", encoding="ascii") as table:
            bound = [line.split()[1] for line in table if line.split()[1].endswith(f":{self.service.port:04X}")
                     and line.split()[3] == "0A"]
        self.assertEqual(bound, [f"0100007F:{self.service.port:04X}"])


class CrowdTest(unittest.TestCase):
    """Clients that mean no good, or nothing."""

    def test_silent_and_dripping_clients_starve_nobody(self):
        with Service(PROGRAM) as service:
            crowd = [socket.create_connection(("127.0.0.1", service.port)) for _ in range(200)]
            try:
                for number, client in enumerate(crowd):
                    client.send(b"\x16\x03\x01"[:number % 4])
                begin = time.monotonic()
                for _ in range(20):
                    self.assertEqual(post(service)[0].status, 200)
                self.assertLess(time.monotonic() - begin, 5)
            finally:
                for client in crowd:
                    client.close()

    def test_many_who_come_at_once_are_all_answered(self):
        with Service(PROGRAM) as service:
            with concurrent.futures.ThreadPoolExecutor(100) as pool:
                begin = time.monotonic()
                statuses = list(pool.map(lambda _: post(service)[0].status, range(200)))
                self.assertEqual(set(statuses), {200})
                self.assertLess(time.monotonic() - begin, 20)

    def test_packed_bodies_are_not_unpacked(self):
        with Service(PROGRAM) as service:
            packed = gzip.compress(b" " * (64 << 20))
            self.assertEqual(post(service, packed, **{"Content-Encoding": "gzip"})[0].status, 415)
            with open(f"/proc/{service.process.pid}/status", encoding="ascii") as status:
                peak = next(int(line.split()[1]) for line in status if line.startswith("VmHWM:"))
            self.assertLess(peak, 200 << 10, "kB")

    def test_length_beside_chunks_is_refused(self):
        with Service(PROGRAM) as service:
            connection = connect(service)
            connection.putrequest("POST", PATH)
            for name, value in headers(service).items():
                connection.putheader(name, value)
            connection.putheader("Content-Length", "20")
            connection.putheader("Transfer-Encoding", "chunked")
            connection.endheaders(b"14\r\n" + b'{"clientContext":{}}' + b"\r\n0\r\n\r\n")
            self.assertEqual(connection.getresponse().status, 400)


class StartTest(unittest.TestCase):
    """What cannot be started says so and does not claim to be ready."""

    def refused(self, *options):
        ended = subprocess.run([PROGRAM, "serve", "--until-stdin-closes", *options], stdin=subprocess.DEVNULL,
                               capture_output=True, text=True, timeout=60, check=False)
        self.assertNotEqual(ended.returncode, 0, ended.stdout)
        self.assertNotIn("ready", ended.stdout)
        return ended.stderr

    def test_a_port_has_one_service(self):
        with Service(PROGRAM) as service:
            self.assertIn("in use", self.refused("--ca-dir", str(service.folder / "other"), "--port",
                                                 str(service.port)))
            self.assertEqual(post(service)[0].status, 200)

    def test_an_interval_is_a_number(self):
        for text in ("nan", "-nan", "inf", "-1", "soon"):
            self.assertIn("--interval", self.refused("--interval", text), text)

    def test_contacts_are_there(self):
        self.assertIn("/not/there.vcf", self.refused("--contacts", "/not/there.vcf"))

    def test_what_the_configuration_names_can_be_read(self):
        self.assertIn("/not/there.gpx", self.refused("--positions", "/not/there.gpx"))
        with tempfile.TemporaryDirectory() as folder:
            pipe = os.path.join(folder, "pipe")
            os.mkfifo(pipe)
            self.assertIn("pipe", self.refused("--contacts", pipe))
            self.assertIn("pipe", self.refused("--positions", pipe))
            self.assertIn("not a file", self.refused("--positions", folder))

    def test_a_configuration_never_replaces_a_pipe(self):
        with tempfile.TemporaryDirectory() as folder:
            pipe = os.path.join(folder, "pipe")
            os.mkfifo(pipe)
            self.assertIn("this is a pipe", self.refused("--write-config", pipe))
            self.assertTrue(stat.S_ISFIFO(os.stat(pipe).st_mode))
            self.assertEqual(os.listdir(folder), ["pipe"])


class SharingTest(unittest.TestCase):
    """The user's own sharing: commands and questions see and change one state."""

    def command(self, service, hide, **location):
        body = {"clientContext": {"location": location} if location else {}, "prefs": {"hideLocation": hide}}
        connection = connect(service)
        connection.request("POST", "/qloxservice/friends/va/showHideLocation", json.dumps(body), headers(service))
        return json.loads(connection.getresponse().read())["myInfo"]

    def test_state_is_kept_while_it_runs(self):
        with Service(PROGRAM) as service:
            self.assertFalse(service.hides())
            self.assertEqual(self.command(service, "No", latitude=50.2104, longitude=-3.12)["location"]["latitude"],
                             50.2104)
            self.assertTrue(service.hides("hide"))
            self.assertTrue(service.hides())
            self.assertTrue(self.command(service, "No")["hidden"], "an older answer repeats itself")
            self.assertTrue(service.hides())
            self.assertFalse(service.hides("share"))
            self.assertIsNone(self.command(service, "Yes")["location"])
            self.assertTrue(service.hides())
            self.assertEqual(self.command(service, "No")["location"]["latitude"], 50.2104)
            self.assertFalse(service.hides())
            _, lines = service.end()
            self.assertEqual(lines, [f"request {n}: showHideLocation, 200" for n in (1, 2, 3, 4)])

    def test_only_a_wish_with_the_token_changes_anything(self):
        path = "/qloxservice/friends/va/sharing"
        with Service(PROGRAM) as service:
            wish = json.dumps({"clientContext": {}, "wish": "hide"})
            good = headers(service)
            for method, body, fields, status in (
                    ("GET", None, {}, 404),
                    ("GET", None, good, 404),
                    ("PUT", wish, good, 404),
                    ("POST", wish, {**good, "Authorization": "Basic MTAwMDp4"}, 401),
                    ("POST", wish, {"Content-Type": "application/json"}, 401),
                    # What a page of another site can send without being asked whether it may.
                    ("POST", wish, {**good, "Content-Type": "text/plain"}, 415),
                    ("POST", "wish=hide", {**good, "Content-Type": "application/x-www-form-urlencoded"}, 415),
                    ("POST", "{}", good, 400)):
                connection = connect(service)
                connection.request(method, path, body, fields)
                self.assertEqual(connection.getresponse().status, status, (method, fields))
            self.assertFalse(service.hides())
            self.assertTrue(service.hides("hide"))

    def test_there_is_no_server_for_questions(self):
        with Service(PROGRAM) as service:
            connection = connect(service)
            connection.request("POST", "/assistant", json.dumps({"question": "Hide my location"}), headers(service))
            self.assertEqual(connection.getresponse().status, 404)
            self.assertFalse(service.hides())

    def test_state_ends_with_it(self):
        with Service(PROGRAM) as service:
            self.command(service, "Yes")
        with Service(PROGRAM) as service:
            self.assertFalse(service.hides())

    def test_many_at_once(self):
        with Service(PROGRAM) as service:
            with concurrent.futures.ThreadPoolExecutor(8) as pool:
                answers = list(pool.map(lambda n: self.command(service, "Yes" if n % 2 else "No", latitude=50.2,
                                                               longitude=-3.1), range(64)))
            for answer in answers:
                self.assertEqual(answer["hidden"], answer["location"] is None)

    def test_faults_meet_it_too(self):
        with Service(PROGRAM, "--fault", "status=503,count=1") as service:
            connection = connect(service)
            body = json.dumps({"clientContext": {}, "prefs": {"hideLocation": "Yes"}})
            connection.request("POST", "/qloxservice/friends/va/showHideLocation", body, headers(service))
            self.assertEqual(connection.getresponse().status, 503)
            self.assertFalse(service.hides(), "a command that failed changed nothing")


class FenceTest(unittest.TestCase):
    """Being told when a made-up friend arrives, with nobody asking where they are."""

    def test_phones_post_by_themselves_while_somebody_is_watched(self):
        with tempfile.TemporaryDirectory() as folder:
            friends = pathlib.Path(folder) / "friends.json"
            track = [{"at": at, "latitude": latitude, "longitude": -3.12, "accuracy": 10}
                     for at, latitude in ((0, 50.2104), (12, 50.2104), (40, 50.2154))]
            friends.write_text(json.dumps({"friends": [{"fullName": "Ann Marsh", "emails": ["ann@harbour.example"],
                                                        "repeats": False, "track": track}]}))
            with Service(PROGRAM, "--friends", str(friends)) as service:
                # Where she is now is known from the first question on.
                self.assertEqual(post(service)[0].status, 200)
                answer, text = post(service, json.dumps({
                    "clientContext": {}, "handle": "ann@harbour.example", "trigger": "OnArrival",
                    "place": {"latitude": 50.2154, "longitude": -3.12, "radius": 100}}), path=PATH.replace("getlocations", "setFence"))
                self.assertEqual(answer.status, 200, text)
                connection = connect(service)
                connection.request("GET", "/qloxservice/friends/va/events", headers={"Authorization": service.credentials})
                stream = connection.getresponse()
                lines = []
                while not lines or not lines[-1].startswith(b"data: "):
                    lines.append(stream.readline())
                    self.assertNotEqual(lines[-1], b"", lines)
                self.assertIn(b"event: crossing\n", lines)
                self.assertEqual(json.loads(lines[-1][6:])["trigger"], "OnArrival")
                connection.close()


class CertificateTest(unittest.TestCase):
    def test_good_for_all_names_of_this_machine(self):
        with Service(PROGRAM) as service:
            for host in ("localhost", "127.0.0.1"):
                self.assertEqual(post(service, connection=connect(service, host))[0].status, 200)
            with self.assertRaises(ssl.SSLCertVerificationError):
                post(service, connection=connect(service, authority="/etc/ssl/certs/ca-certificates.crt"))

    def test_bad_ones_are_bad(self):
        for kind in ("expired", "wrong-host", "foreign"):
            with Service(PROGRAM, "--certificate", kind) as service:
                with self.assertRaises(ssl.SSLCertVerificationError, msg=kind):
                    post(service)

    def test_authority_and_token_are_kept_and_private(self):
        with Service(PROGRAM) as service:
            folder = service.folder / "ca"
            authority = pathlib.Path(service.authority).read_bytes()
            with Service(PROGRAM, "--ca-dir", str(folder)) as again:
                self.assertEqual(pathlib.Path(again.authority).read_bytes(), authority)
            for name in ("ca-key.pem", "token"):
                self.assertEqual(os.stat(folder / name).st_mode & 0o777, 0o600)


class EndTest(unittest.TestCase):
    def test_signals_and_the_end_of_the_input_end_it(self):
        for how in (signal.SIGTERM, signal.SIGINT, None):
            with Service(PROGRAM) as service:
                self.assertEqual(service.end(how)[0], 0, how)

    def test_answers_under_way_do_not_hold_it_up(self):
        with Service(PROGRAM, "--fault", "delay=600") as service:
            connection = connect(service)
            connection.request("POST", PATH, BODY, headers(service))
            begin = time.monotonic()
            self.assertEqual(service.end()[0], 0)
            self.assertLess(time.monotonic() - begin, 15)
            connection.close()

    def test_configuration_is_printed_and_written(self):
        with Service(PROGRAM) as other:
            file = other.folder / "config.json"
            with Service(PROGRAM, "--print-config", "--write-config", str(file)) as service:
                printed = json.loads(service.process.stdout.readline())
                self.assertEqual(printed, json.loads(file.read_text()))
                self.assertEqual(os.stat(file).st_mode & 0o777, 0o600)
                self.assertEqual(printed["account"]["userName"], "mara.lind@harbour.example")
                self.assertEqual(printed["account"]["host"], f"localhost:{service.port}")
                self.assertEqual(printed["certificates"], [service.authority])
                self.assertNotIn(service.token, file.read_text())


if __name__ == "__main__":
    unittest.main(warnings="ignore")
