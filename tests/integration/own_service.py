"""Runs `ktr-service` for a test."""
import base64
import http.client
import json
import os
import pathlib
import re
import socket
import sqlite3
import ssl
import subprocess
import tempfile
import time


def free_port():
    with socket.socket() as probe:
        probe.bind(("127.0.0.1", 0))
        return probe.getsockname()[1]


class OwnService:
    """A service of one's own in a folder of its own; a context manager."""

    def __init__(self, program):
        self.program = program
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="ktr-own-"))
        self.port = free_port()
        self.process = None
        self.command("init", "--host", "localhost", "--port", str(self.port))

    @property
    def authority(self):
        return str(self.folder / "data" / "ca.pem")

    @property
    def url(self):
        return f"https://localhost:{self.port}/pub"

    def command(self, *words):
        done = subprocess.run([self.program, "--data", str(self.folder / "data"), *words], capture_output=True, text=True,
                              timeout=60, check=False)
        assert done.returncode == 0, (words, done.stdout, done.stderr)
        return done.stdout

    def add(self, name, *options):
        """A person, and the password of their phone."""
        text = self.command("add", name, "--handle", f"{name.lower()}@x.example", *options)
        return re.search(r"Password\s+(\S+)", text).group(1)

    def earlier(self):
        """As if all grants had been made two hours ago."""
        database = sqlite3.connect(self.folder / "data" / "service.db")
        database.execute("UPDATE share SET since = since - 7200")
        database.commit()
        database.close()

    def start(self):
        self.process = subprocess.Popen([self.program, "--data", str(self.folder / "data"), "serve"],
                                        stdout=subprocess.PIPE, text=True)
        ready = self.process.stdout.readline()
        assert ready.startswith(f"ready https://localhost:{self.port} "), ready

    def post(self, name, password, latitude, longitude):
        """What somebody's phone sends."""
        context = ssl.create_default_context(cafile=self.authority)
        connection = http.client.HTTPSConnection("localhost", self.port, context=context, timeout=20)
        credentials = base64.b64encode(f"{name}:{password}".encode()).decode()
        connection.request("POST", "/pub", json.dumps({"_type": "location", "lat": latitude, "lon": longitude, "acc": 12,
                                                       "tst": int(time.time()) - 60, "tid": "an"}),
                           {"Authorization": f"Basic {credentials}", "Content-Type": "application/json"})
        status = connection.getresponse().status
        connection.close()
        assert status == 200, status

    def ends_of_shares(self, name):
        """When each grant of a person's ends, seconds since 1970; none for one that does not."""
        database = sqlite3.connect(self.folder / "data" / "service.db")
        try:
            return [end for end, in database.execute(
                "SELECT until FROM share WHERE owner = (SELECT id FROM person WHERE name = ?)", (name,))]
        finally:
            database.close()

    def stop(self):
        if self.process is not None:
            self.process.terminate()
            self.process.wait(timeout=30)
            self.process.stdout.close()
            self.process = None

    def bytes(self):
        """All that is on the disk."""
        return b"".join(file.read_bytes() for file in (self.folder / "data").iterdir())

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.stop()
        subprocess.run(["rm", "-rf", os.fspath(self.folder)], check=True)
