"""Runs `ktr-service` for a test."""
import os
import pathlib
import re
import socket
import sqlite3
import subprocess
import tempfile


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
