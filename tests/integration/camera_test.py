#!/usr/bin/env python3
"""A camera's program reads the code that `ktr-service add` prints, as somebody's terminal shows it, at several
sizes.

  camera_test.py SERVICE [unittest options]
"""
import base64
import json
import os
import re
import shutil
import subprocess
import sys
import unittest
import urllib.parse

from service_program import ServiceProgram

SERVICE = sys.argv.pop(1)
# The upper and the lower half of each character.
HALVES = {"█": (1, 1), "▀": (1, 0), "▄": (0, 1), " ": (0, 0)}


class CameraTest(unittest.TestCase):
    def setUp(self):
        if not shutil.which("zbarimg"):
            self.assertFalse(os.environ.get("KTR_LONG_TESTS"), "zbarimg is not installed")
            self.skipTest("zbarimg is not installed")
        self.service = ServiceProgram(self, SERVICE)

    def picture(self, text, size):
        """What a terminal shows of the code, `size` points a square, as PGM: blocks are the colour of the writing."""
        rows = []
        for line in text:
            for half in (0, 1):
                values = [255 * HALVES[character][half] for character in line]
                rows += [bytes(value for value in values for _ in range(size))] * size
        file = self.service.folder / "code.pgm"
        file.write_bytes(b"P5\n%d %d\n255\n" % (len(rows[0]), len(rows)) + b"".join(rows))
        return file

    def read(self, file):
        done = subprocess.run(["zbarimg", "--quiet", "--raw", str(file)], capture_output=True, text=True, timeout=60, check=False)
        return done.stdout.strip()

    def test_code_of_a_phone_is_read(self):
        for name in ("Ann", "Z", "Otto with a name of forty letters or so."):
            output = self.service.command("add", name, "--handle", f"p{len(name)}@x.example", "--code")
            code = [line for line in output.splitlines() if re.fullmatch("[█▀▄ ]{20,}", line)]
            self.assertGreater(len(code), 10, output)
            for size in (3, 8):
                link = self.read(self.picture(code, size))
                self.assertTrue(link.startswith("owntracks:///config?inline="), (name, size, link))
                inline = urllib.parse.unquote(link.split("=", 1)[1])
                settings = json.loads(base64.b64decode(inline))
                # Exactly what is printed to be typed.
                self.assertEqual(settings["url"], re.search(r"URL +(\S+)", output).group(1))
                self.assertEqual(settings["username"], re.search(r"User name +(.+)", output).group(1))
                self.assertEqual(settings["password"], re.search(r"Password +(\S+)", output).group(1))


if __name__ == "__main__":
    unittest.main(warnings="ignore")
