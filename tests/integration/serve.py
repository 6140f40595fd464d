"""Runs `ktr serve` for a test."""
import base64
import http.client
import json
import os
import pathlib
import re
import signal
import ssl
import subprocess
import tempfile


class Service:
    """The development service, with a folder of its own; a context manager."""

    def __init__(self, program, *options):
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="ktr-serve-"))
        own = [] if "--ca-dir" in options else ["--ca-dir", str(self.folder / "ca")]
        self.process = subprocess.Popen(
            [program, "serve", *own, "--until-stdin-closes", *options],
            stdin=subprocess.PIPE, stdout=subprocess.PIPE, text=True)
        self.ready = self.process.stdout.readline()
        found = re.match(r"ready https://localhost:(\d+) (.*)$", self.ready)
        assert found, f"not ready: {self.ready!r}"
        self.port = int(found.group(1))
        self.authority = found.group(2)

    @property
    def token(self):
        return (self.folder / "ca" / "token").read_text().strip()

    @property
    def credentials(self):
        return "Basic " + base64.b64encode(f"1000:{self.token}".encode()).decode()

    def hides(self, wish="read"):
        """Whether friends cannot see the user, after a wish: "read" changes nothing."""
        context = ssl.create_default_context(cafile=self.authority)
        connection = http.client.HTTPSConnection("localhost", self.port, context=context, timeout=20)
        connection.request("POST", "/qloxservice/friends/va/sharing", json.dumps({"clientContext": {}, "wish": wish}),
                           {"Authorization": self.credentials, "Content-Type": "application/json",
                            "X-Orcha-Seek-API-Ver": "4.0", "X-Orcha-AuthScheme": "Forever"})
        return json.loads(connection.getresponse().read())["hidden"]

    def end(self, how=signal.SIGTERM):
        """Ends the service; gives its exit status and the lines that it wrote."""
        if self.process.poll() is None:
            if how is None:
                self.process.stdin.close()
            else:
                self.process.send_signal(how)
        lines = self.process.stdout.read().splitlines()
        return self.process.wait(timeout=20), lines

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.end()
        self.process.stdout.close()
        if self.process.stdin:
            self.process.stdin.close()
        subprocess.run(["rm", "-rf", os.fspath(self.folder)], check=True)
