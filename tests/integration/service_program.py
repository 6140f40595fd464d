"""The service of one's own as tests run it: a folder, its commands, a process, requests."""
import base64
import copy
import http.client
import json
import os
import pathlib
import re
import shutil
import signal
import socket
import ssl
import subprocess
import tempfile

COMMANDS = "/qloxservice/friends/va/"


def free_port():
    with socket.socket() as probe:
        probe.bind(("127.0.0.1", 0))
        return probe.getsockname()[1]


class UnixConnection(http.client.HTTPConnection):
    """HTTP over a socket in the file system."""

    def __init__(self, path, timeout=20):
        super().__init__("localhost", timeout=timeout)
        self.path = path

    def connect(self):
        self.sock = socket.socket(socket.AF_UNIX)
        self.sock.settimeout(self.timeout)
        self.sock.connect(self.path)


def basic(user, secret):
    return "Basic " + base64.b64encode(f"{user}:{secret}".encode()).decode()


class ServiceProgram:
    """One service in a folder of its own; `case` is the test that ends it."""

    def __init__(self, case, program, host="localhost", store=None):
        self.case, self.program, self.host = case, program, host
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="ktr-service-"))
        case.addCleanup(lambda: subprocess.run(["rm", "-rf", os.fspath(self.folder)], check=True))
        self.port = free_port()
        self.socket = str(self.folder / "http.sock")
        self.process = None
        self.command("init", "--host", host, "--port", str(self.port), *(("--store", store) if store else ()))

    def on_another_machine(self):
        """The same service, with a copy of its folder and a socket of its own."""
        other = copy.copy(self)
        other.folder = pathlib.Path(tempfile.mkdtemp(prefix="ktr-service-"))
        self.case.addCleanup(lambda: subprocess.run(["rm", "-rf", os.fspath(other.folder)], check=True))
        shutil.copytree(self.folder / "data", other.folder / "data")
        other.port, other.socket, other.process = free_port(), str(other.folder / "http.sock"), None
        return other

    def command(self, *words, fails=False):
        done = subprocess.run([self.program, "--data", str(self.folder / "data"), *words], capture_output=True,
                              text=True, timeout=60, check=False)
        self.case.assertEqual(done.returncode != 0, fails, (words, done.stdout, done.stderr))
        return done.stderr if fails else done.stdout

    def start(self, *options, environment=None, **more):
        """Serves; the log goes to the file `log`."""
        with open(self.folder / "log", "ab") as log:
            process = subprocess.Popen([self.program, "--data", str(self.folder / "data"), "serve", *options],
                                       stdout=subprocess.PIPE, stderr=log, text=True,
                                       env={**os.environ, **(environment or {})}, **more)
        self.process = process
        self.case.addCleanup(process.stdout.close)
        self.case.addCleanup(lambda: process.poll() is not None or (process.kill(), process.wait()))
        line = process.stdout.readline()
        self.case.assertTrue(line.startswith("ready "), (line, self.log()))
        return line

    def stop(self):
        self.process.send_signal(signal.SIGTERM)
        self.case.assertEqual(self.process.wait(timeout=30), 0)

    def log(self):
        return (self.folder / "log").read_text()

    def add(self, name):
        return re.search(r"Password  (\S+)", self.command("add", name, "--handle", f"{name.lower()}@x.example")).group(1)

    def reader(self, name):
        token = self.folder / f"{name}-token"
        self.command("reader", name, "--token-file", str(token))
        return token.read_text().strip()

    def connection(self, by_socket=False):
        if by_socket:
            return UnixConnection(self.socket)
        context = ssl.create_default_context(cafile=str(self.folder / "data" / "ca.pem"))
        return http.client.HTTPSConnection("localhost", self.port, context=context, timeout=20)

    def request(self, method, path, body=b"", by_socket=False, credentials=None, **headers):
        connection = self.connection(by_socket)
        if credentials:
            headers["Authorization"] = basic(*credentials)
        connection.request(method, path, body, {"Host": self.host, **headers})
        answer = connection.getresponse()
        text = answer.read()
        connection.close()
        return answer.status, text.decode("utf-8", "replace")

    def post(self, user, secret, by_socket=False, **message):
        return self.request("POST", "/pub", json.dumps(message), by_socket, (user, secret),
                            **{"Content-Type": "application/json"})

    def ask(self, user, secret, *handles, by_socket=False, **context):
        body = json.dumps({"clientContext": context, "handles": list(handles)})
        return self.request("POST", COMMANDS + "getlocations", body, by_socket, (user, secret), **{
            "Content-Type": "application/json", "X-Orcha-Seek-API-Ver": "4.0", "X-Orcha-AuthScheme": "Forever"})

    def numbers(self, by_socket=False):
        """Name with labels to number, of /metrics."""
        status, text = self.request("GET", "/metrics", by_socket=by_socket)
        self.case.assertEqual(status, 200)
        return {line.rsplit(" ", 1)[0]: float(line.rsplit(" ", 1)[1]) for line in text.splitlines()
                if line and not line.startswith("#")}
