"""Runs the program with one kind of call that fails, at one place after the other."""

import concurrent.futures
import os
import pathlib
import subprocess
import sys
import tempfile
import unittest

PROGRAM = os.environ["KTR_PROGRAM"]
SHIM = os.environ["KTR_FAULTS"]
SCENARIOS = pathlib.Path(os.environ["KTR_SOURCE"]) / "resources" / "scenarios"
# More calls than this are tried at so many places, evenly spread; the first and the last are among them.
MOST_PLACES = int(os.environ.get("KTR_FAULT_PLACES", "40"))
# Runs that wait for something may do so side by side.
SIDE_BY_SIDE = 6

KINDS = {
    "open": ("EIO", "EMFILE", "EINTR"),
    "read": ("EIO", "EINTR", "short"),
    "write": ("ENOSPC", "EIO", "EINTR", "short"),
    "fsync": ("EIO", "ENOSPC", "EINTR"),
    "rename": ("EIO", "ENOSPC"),
    "close": ("EIO", "EINTR"),
    "mkdir": ("EIO", "ENOSPC"),
    "flock": ("EIO", "EINTR"),
    "watch": ("EMFILE", "ENOSPC"),
    "socket": ("EMFILE", "EACCES"),
    "connect": ("EIO", "EINTR"),
    "recv": ("ECONNRESET", "EINTR", "short"),
    "send": ("ECONNRESET", "EINTR", "short"),
}
OLD = b"the good old one"


def places(count):
    if count <= MOST_PLACES:
        return range(1, count + 1)
    return sorted({1 + round(i * (count - 1) / (MOST_PLACES - 1)) for i in range(MOST_PLACES)})


def each_fault(count, call):
    """The kind of each fault that is tried at a call which is made so often, its place, and how many in a row."""
    for kind in KINDS[call]:
        for times in (1, 1_000_000):
            # A signal that comes for ever, or a byte at a time, is no fault but a standstill.
            if times > 1 and kind in ("EINTR", "short"):
                continue
            for place in places(count):
                yield kind, place, times


class Faults(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.environment = {k: v for k, v in os.environ.items()
                            if k not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM", "DBUS_SESSION_BUS_ADDRESS")}
        self.environment.update(XDG_STATE_HOME=str(self.folder / "state"), XDG_CACHE_HOME=str(self.folder / "cache"))

    def run_with(self, arguments, call, kind="", first=0, times=1, more=None):
        """`more` is for the program's environment. Gives what became of it, and how often the call was made."""
        with tempfile.NamedTemporaryFile(dir=self.folder) as count:
            environment = dict(self.environment, LD_PRELOAD=SHIM, KTR_FAULT_CALL=call, KTR_FAULT_KIND=kind,
                               KTR_FAULT_FROM=str(first), KTR_FAULT_TIMES=str(times), KTR_FAULT_COUNT=count.name,
                               **(more or {}))
            result = subprocess.run([PROGRAM, *map(str, arguments)], env=environment, capture_output=True, text=True,
                                    errors="replace", stdin=subprocess.DEVNULL, timeout=60)
            return result, int.from_bytes(pathlib.Path(count.name).read_bytes(), sys.byteorder)

    def assert_honest(self, result):
        """It ends by itself, and a failure says why."""
        self.assertIn(result.returncode, (0, 1, 3, 4, 5), result.stderr)
        if result.returncode != 0:
            self.assertRegex(result.stderr, r"(?m)^(ktr: |error org\.ktr\.)")

    def check_each(self, name, run, whole, calls=KINDS):
        """`run(call, kind, place, times)` is one run in a folder of its own; several are under way at once. `whole`
        looks at what it gave, on the main thread."""
        tried = 0
        with concurrent.futures.ThreadPoolExecutor(SIDE_BY_SIDE) as pool:
            for call in calls:
                good, count = run(call, "", 0, 1)
                whole(good)
                faults = list(each_fault(count, call))
                for fault, outcome in zip(faults, pool.map(lambda fault: run(call, *fault), faults)):
                    with self.subTest(call=call, fault=fault, of=count):
                        tried += 1
                        self.assert_honest(outcome[0])
                        whole(outcome[0])
        print(f"{name}: {tried} faults", file=sys.stderr)

    @staticmethod
    def main():
        if not os.environ.get("KTR_LONG_TESTS"):
            print("a long test: KTR_LONG_TESTS=1 runs it")
            sys.exit(77)
        unittest.main()
