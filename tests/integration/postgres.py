"""A PostgreSQL server of a test's own: in a folder, on a Unix socket alone, under a user without rights for root."""
import os
import pathlib
import pwd
import shutil
import signal
import subprocess
import tempfile
import time


def programs():
    """Where Debian puts what only a server's owner runs; none: it is not installed."""
    found = sorted(pathlib.Path("/usr/lib/postgresql").glob("*/bin/initdb"))
    return found[-1].parent if found else None


class Postgres:
    def __init__(self, case, environment=None):
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="ktr-postgres-"))
        case.addCleanup(lambda: shutil.rmtree(self.folder, ignore_errors=True))
        self.environment = {**os.environ, **(environment or {})}
        self.user = "nobody" if os.geteuid() == 0 else None
        if self.user:
            os.chown(self.folder, pwd.getpwnam(self.user).pw_uid, -1)
        self.log = open(self.folder.with_suffix(".log"), "ab")
        case.addCleanup(lambda: (self.log.close(), os.unlink(self.log.name)))
        self.process = self.run("initdb", "-D", "data", "-A", "trust", "-U", "ktr", "-E", "UTF8", "--locale=C.UTF-8")
        assert self.process.wait(timeout=120) == 0, pathlib.Path(self.log.name).read_text()
        self.start()
        case.addCleanup(self.stop)

    @property
    def address(self):
        return f"postgresql://ktr@/postgres?host={self.folder}"

    def run(self, program, *words):
        return subprocess.Popen([programs() / program, *words], cwd=self.folder, user=self.user, stdout=self.log,
                                stderr=self.log, stdin=subprocess.DEVNULL, env=self.environment)

    def start(self):
        self.process = self.run("postgres", "-D", "data", "-k", str(self.folder), "-c", "listen_addresses=")
        deadline = time.monotonic() + 60
        while subprocess.run([programs() / "pg_isready", "-q", "-h", str(self.folder)], check=False).returncode != 0:
            assert self.process.poll() is None and time.monotonic() < deadline
            time.sleep(0.05)

    def stop(self, how=signal.SIGQUIT):
        """At once, as a crash would."""
        self.process.send_signal(how)
        self.process.wait(timeout=60)

    def rows(self, question):
        done = subprocess.run([programs() / "psql", "-h", str(self.folder), "-U", "ktr", "-At", "-c", question,
                               "postgres"], capture_output=True, text=True, check=True)
        return done.stdout.split()
