#!/usr/bin/python3
"""Lets every file and socket call of the program fail, one after the other: it may fail with a line that says why, but never
crash, hang or leave a broken file. Long: it runs with KTR_LONG_TESTS=1 alone."""

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

KINDS = {
    "open": ("EIO", "EMFILE", "EINTR"),
    "read": ("EIO", "EINTR", "short"),
    "write": ("ENOSPC", "EIO", "EINTR", "short"),
    "fsync": ("EIO", "ENOSPC", "EINTR"),
    "rename": ("EIO", "ENOSPC"),
    "close": ("EIO", "EINTR"),
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


class FaultsTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.environment = {k: v for k, v in os.environ.items()
                            if k not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM", "DBUS_SESSION_BUS_ADDRESS")}
        self.environment.update(XDG_STATE_HOME=str(self.folder / "state"), XDG_CACHE_HOME=str(self.folder / "cache"))

    def run_with(self, arguments, call, kind="", first=0, times=1):
        count = self.folder / "count"
        count.unlink(missing_ok=True)
        environment = dict(self.environment, LD_PRELOAD=SHIM, KTR_FAULT_CALL=call, KTR_FAULT_KIND=kind,
                           KTR_FAULT_FROM=str(first), KTR_FAULT_TIMES=str(times), KTR_FAULT_COUNT=str(count))
        result = subprocess.run([PROGRAM, *map(str, arguments)], env=environment, capture_output=True, text=True,
                                errors="replace", stdin=subprocess.DEVNULL, timeout=60)
        return result, int.from_bytes(count.read_bytes(), sys.byteorder)

    def check(self, arguments, whole, prepare=lambda: None, calls=KINDS):
        """`whole` looks at what was left behind, given the exit code."""
        tried = 0
        for call in calls:
            prepare()
            result, count = self.run_with(arguments, call)
            self.assertEqual(result.returncode, 0, result.stderr)
            for kind in KINDS[call]:
                for times in (1, 1_000_000):
                    # A signal that comes for ever, or a byte at a time, is no fault but a standstill.
                    if times > 1 and kind in ("EINTR", "short"):
                        continue
                    for place in places(count):
                        with self.subTest(call=call, kind=kind, place=place, times=times):
                            prepare()
                            result, _ = self.run_with(arguments, call, kind, place, times)
                            tried += 1
                            self.assertIn(result.returncode, (0, 1, 3, 4, 5), result.stderr)
                            if result.returncode != 0:
                                self.assertIn("ktr: ", result.stderr)
                            whole(result)
        print(f"{arguments[0]}: {tried} faults", file=sys.stderr)

    def test_render(self):
        for name, end in (("a.png", b"IEND\xaeB`\x82"), ("a.svg", b"</svg>\n"), ("a.pdf", b"%%EOF\n")):
            picture = self.folder / "out" / name
            picture.parent.mkdir(exist_ok=True)

            def prepare():
                picture.write_bytes(OLD)

            def whole(result):
                data = picture.read_bytes()
                self.assertTrue(data == OLD or data.endswith(end), data[-20:])
                if result.returncode == 0:
                    self.assertTrue(data.endswith(end), "success is said of a picture that is not there")
                self.assertEqual([entry.name for entry in picture.parent.iterdir()], [name])

            calls = KINDS if name == "a.png" else ("write", "fsync", "rename", "close")
            self.check(("render", SCENARIOS / "single.json", "-o", picture), whole, prepare, calls)
            picture.unlink()

    def test_describe(self):
        good, _ = self.run_with(("describe", SCENARIOS / "single.json"), "none")

        def whole(result):
            if result.returncode == 0:
                self.assertGreater(len(result.stdout), len(good.stdout) // 2)

        self.check(("describe", SCENARIOS / "single.json"), whole, calls=("open", "read", "close"))

    def test_serve_starts_or_says_why(self):
        config = self.folder / "config.json"

        def prepare():
            config.write_bytes(OLD)

        def whole(result):
            data = config.read_bytes()
            self.assertTrue(data == OLD or data.endswith(b"}\n"), data)
            if result.returncode == 0:
                self.assertIn("ready https://", result.stdout)

        self.check(("serve", "--ca-dir", self.folder / "ca", "--write-config", config, "--until-stdin-closes"), whole,
                   prepare)

    def test_serve_makes_its_folder_whole(self):
        number = 0

        def whole(result):
            nonlocal number
            folder = self.folder / "fresh"
            # Whatever was left there, the next start makes do with it or says what is wrong.
            again, _ = self.run_with(("serve", "--ca-dir", folder, "--until-stdin-closes"), "none")
            self.assertEqual(again.returncode, 0, again.stderr)
            number += 1

        def prepare():
            subprocess.run(["rm", "-rf", self.folder / "fresh"], check=True)

        self.check(("serve", "--ca-dir", self.folder / "fresh", "--until-stdin-closes"), whole, prepare,
                   ("write", "fsync", "rename", "close"))
        self.assertGreater(number, 0)


if __name__ == "__main__":
    if not os.environ.get("KTR_LONG_TESTS"):
        print("a long test: KTR_LONG_TESTS=1 runs it")
        sys.exit(77)
    unittest.main()
