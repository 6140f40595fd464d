#!/usr/bin/python3
"""Lets every file and socket call of the program fail, one after the other: it may fail with a line that says why, but never
crash, hang or leave a broken file. Long: it runs with KTR_LONG_TESTS=1 alone."""

import subprocess
import sys

from shim import KINDS, OLD, SCENARIOS, Faults, each_fault


class FaultsTest(Faults):
    def check(self, arguments, whole, prepare=lambda: None, calls=KINDS):
        """`whole` looks at what was left behind, given the exit code."""
        tried = 0
        for call in calls:
            prepare()
            result, count = self.run_with(arguments, call)
            self.assertEqual(result.returncode, 0, result.stderr)
            for kind, place, times in each_fault(count, call):
                with self.subTest(call=call, kind=kind, place=place, times=times):
                    prepare()
                    result, _ = self.run_with(arguments, call, kind, place, times)
                    tried += 1
                    self.assert_honest(result)
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
    Faults.main()
