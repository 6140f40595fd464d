#!/usr/bin/env python3
"""The commands of ktr-service as a person types them: help, examples, slips.

  command_line_test.py SERVICE [unittest options]
"""
import os
import pty
import re
import shlex
import subprocess
import sys
import unittest

from service_program import ServiceProgram

SERVICE = sys.argv.pop(1)


class CommandLineTest(unittest.TestCase):
    def run_it(self, *words):
        return subprocess.run([SERVICE, *words], capture_output=True, text=True, timeout=60, check=False)

    def commands(self):
        listed = self.run_it("--help").stdout.split("Subcommands:")[1]
        return re.findall(r"^  ([a-z-]+) ", listed, re.MULTILINE)

    def test_help_of_each_command_has_an_example_that_is_understood(self):
        service = ServiceProgram(self, SERVICE)
        for name in ("Mara", "Zoe"):
            service.add(name)
        self.assertGreater(len(self.commands()), 10)
        for command in self.commands():
            text = self.run_it(command, "--help").stdout
            with self.subTest(command):
                match = re.search(r"Example: ktr-service (.*)", text)
                self.assertTrue(match, f"server/admin/Help.cpp has no example for it: {text}")
                words = shlex.split(match.group(1).split(" > ")[0].replace("~", str(service.folder)))
                self.assertEqual(words[0], command)
                if command in ("init", "serve"):
                    continue
                done = self.run_it("--data", str(service.folder / "data"), *words)
                self.assertNotIn("--help", done.stderr, "it is not understood")

    def test_slips_get_the_word_that_was_meant(self):
        service = ServiceProgram(self, SERVICE)
        service.add("Annabel")
        data = ("--data", str(service.folder / "data"))
        for words, part in (((*data, "peple"), 'did you mean "people"?'), ((*data, "hide", "Anabel"), 'did you mean "Annabel"?'),
                            ((*data, "share", "Annabel"), "ktr-service share --help"), (data, "ktr-service --help"),
                            ((*data, "xyzxyz"), "there is no command")):
            done = self.run_it(*words)
            self.assertEqual((done.returncode, done.stdout), (1, ""), words)
            self.assertIn(part, done.stderr)
            self.assertEqual(done.stderr.count("\n"), 1, "one sentence")
        self.assertNotIn("did you mean", self.run_it(*data, "xyzxyz").stderr)

    def test_code_is_for_terminals_and_those_who_ask(self):
        service = ServiceProgram(self, SERVICE)
        self.assertNotIn("█", service.command("add", "Ann"))
        asked = service.command("add", "Mara", "--code")
        self.assertIn("██████", asked)
        self.assertNotIn("\x1b", asked)
        secret = re.search(r"Password  (\S+)", asked).group(1)
        self.assertEqual(asked.count(secret), 2, "in the fields and in the address, and nowhere else")
        ours, theirs = pty.openpty()
        done = subprocess.run([SERVICE, "--data", str(service.folder / "data"), "add", "Zoe"], stdout=theirs, timeout=60,
                              check=True)
        os.close(theirs)
        shown = b""
        try:
            while block := os.read(ours, 65536):
                shown += block
        except OSError:
            pass
        os.close(ours)
        self.assertEqual(done.returncode, 0)
        self.assertIn("\x1b[97;40m█", shown.decode())


if __name__ == "__main__":
    unittest.main(warnings="ignore")
