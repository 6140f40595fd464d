#!/usr/bin/python3
"""`ktr config`, its schema and its manual pages: each setting with what is good for it and what is not, tried on the program and
on the schema alike."""

import json
import os
import pathlib
import re
import subprocess
import tempfile
import unittest

import jsonschema

PROGRAM = os.environ["KTR_PROGRAM"]
SOURCE = pathlib.Path(os.environ["KTR_SOURCE"])
SCHEMA = json.loads((SOURCE / "resources/schemas/config.schema.json").read_text(encoding="utf-8"))

# By setting: values that are taken, and values that are not, as JSON has them.
VALUES = {
    "account.personId": (["1000", "mara"], ["a:b", "", 5, ["x"]]),
    "account.userName": (["ann@harbour.example"], ["", 5]),
    "account.host": (["friends.example", "localhost:8443", "[::1]:8443"], ["https://friends.example/", "a b", "x:99999999", 5]),
    "account.domains": ([[], ["friends.example"]], ["friends.example", [5], [""]]),
    "account.tokenFile": (["token2"], [True, ""]),
    "account.assistant": (["assistant.example:8443"], ["no host", True]),
    "certificates": ([["ca.pem"]], [{}, [1]]),
    "contacts": ([["a.vcf", "b.vcf"]], [[None], "a.vcf"]),
    "language": (["de-AT"], [7, ""]),
    "addressBooks": ([True, False], ["yes", 1]),
    "colors": (["system", "light", "dark", "high-contrast"], ["Dark", "pink", True]),
    "distances": (["system", "kilometres", "miles"], ["km", "furlongs", 3]),
    "textSize": (["XS", "S", "m", "L", "xl", "XXXL", "AX5"], ["Huge", "AX6", "XXXXL", "XXS", 3]),
    "geographicCountry": (["DE"], ["de", "DEU", 4]),
    "restrictions.friendLocationRestricted": ([True, False], ["yes", 0]),
    "restrictions.friendLocationAllowed": ([True, False], ["no", 1]),
    "positions.source": (["geoclue", "gpsd", "none"], ["stars", 1]),
    "positions.file": (["walk.gpx"], [[], ""]),
    "positions.host": (["127.0.0.1"], [5]),
    "positions.port": ([1, 2948, 65535], [0, 70000, "2948", 1.5]),
    "maps.sources": ([[], [{"file": "town.mbtiles"}],
                      [{"url": "https://t.example/{z}/{x}/{y}.png", "attribution": "Us", "coarsest": 2, "finest": 9}]],
                     [[{"file": 5}], [{}], [{"url": "http://t.example/{z}/{x}/{y}", "attribution": "Us"}],
                      [{"url": "https://t.example/{z}/{x}/{y}"}], [{"file": "a", "coarsest": 99}]]),
    "maps.datum": (["wgs84", "gcj02"], ["mars"]),
    "maps.cacheMegabytes": ([1, 100000], [0, 100001, "50"]),
}


def members(schema, before=""):
    for name, inner in schema["properties"].items():
        if "properties" in inner:
            yield from members(inner, before + name + ".")
        else:
            yield before + name


def document(name, value):
    """A configuration with this member, and what it needs beside it."""
    made = {"account": {"personId": "1000"}} if name.startswith("account.") else {}
    inside = made
    *folders, last = name.split(".")
    for folder in folders:
        inside = inside.setdefault(folder, {})
    inside[last] = value
    return made


class ConfigTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.file = pathlib.Path(folder.name) / "ktr" / "config.json"

    def run_config(self, *arguments):
        environment = {**os.environ, "KTR_CONFIG": str(self.file)}
        return subprocess.run([PROGRAM, "config", *arguments], env=environment, capture_output=True, text=True, timeout=120)

    def read(self, made):
        """Whether the program takes a whole file: what it says is wrong with it."""
        self.file.parent.mkdir(mode=0o700, exist_ok=True)
        self.file.write_text(json.dumps(made))
        self.file.chmod(0o600)
        # A change reads what the result would say, all of it.
        return self.run_config("set", "geographicCountry", "NL") if "geographicCountry" not in made else self.run_config(
            "set", "language", "nl")

    def test_every_setting_is_in_schema_manual_and_document(self):
        manual = (SOURCE / "resources/man/ktr.json.5").read_text(encoding="utf-8")
        written = (SOURCE / "docs/configuration.md").read_text(encoding="utf-8")
        self.assertEqual(set(members(SCHEMA)), set(VALUES))
        for name in VALUES:
            self.assertIn(name, manual)
            self.assertIn(name.split(".")[-1], written)

    def test_schema_and_program_agree_about_each_value(self):
        for name, (good, bad) in VALUES.items():
            for value, isGood in [*((one, True) for one in good), *((one, False) for one in bad)]:
                with self.subTest(name=name, value=value):
                    made = document(name, value)
                    self.assertEqual(jsonschema.Draft7Validator(SCHEMA).is_valid(made), isGood, "the schema")
                    result = self.read(made)
                    self.assertEqual(result.returncode, 0 if isGood else 1, result.stderr)
                    if not isGood:
                        self.assertEqual(len(result.stderr.splitlines()), 1, result.stderr)
                        self.assertEqual(json.loads(self.file.read_text()), made, "it is as it was")

    def test_what_is_set_is_told_and_gone_again(self):
        self.assertEqual(self.run_config("set", "textSize", "XL").returncode, 0)
        self.assertEqual(self.run_config("get", "textSize").stdout, "XL\n")
        self.assertEqual(self.run_config("set", "positions.port", "2948").returncode, 0)
        self.assertEqual(self.run_config("list").stdout, "textSize = XL\npositions.port = 2948\n")
        self.assertEqual(json.loads(self.run_config("list", "--json").stdout), {"textSize": "XL", "positions.port": 2948})
        self.assertEqual(self.run_config("unset", "textSize").returncode, 0)
        self.assertEqual(self.run_config("get", "textSize").stdout, "")
        self.assertEqual(oct(self.file.stat().st_mode & 0o777), "0o600")

    def test_unknown_names_are_told_with_the_nearest(self):
        wrong = self.run_config("get", "textsize")
        self.assertEqual((wrong.returncode, wrong.stdout), (1, ""))
        self.assertIn("textSize", wrong.stderr)
        self.read({"acount": {}})
        listed = self.run_config("list")
        self.assertEqual(listed.returncode, 0)
        self.assertRegex(listed.stderr, r"warning: .*acount.*account")

    def test_full_and_broken_places_are_said(self):
        self.file.parent.mkdir()
        os.mkfifo(self.file)
        self.assertEqual(self.run_config("set", "language", "de").returncode, 1)
        self.file.unlink()
        self.file.symlink_to("/dev/full")
        self.assertEqual(self.run_config("set", "language", "de").returncode, 1)
        with open("/dev/full", "w") as full:
            self.file.unlink()
            self.file.write_text('{"language": "de"}')
            environment = {**os.environ, "KTR_CONFIG": str(self.file)}
            result = subprocess.run([PROGRAM, "config", "list"], env=environment, stdout=full, stderr=subprocess.PIPE, timeout=120)
            self.assertEqual(result.returncode, 1)

    def test_manual_pages_are_well_formed(self):
        for page in sorted((SOURCE / "resources/man").iterdir()):
            result = subprocess.run(["man", "--warnings", "-E", "UTF-8", "-l", "-Tutf8", "-Z", str(page)],
                                    env={**os.environ, "LC_ALL": "C.UTF-8", "MANROFFSEQ": "", "MANWIDTH": "80"},
                                    stdout=subprocess.DEVNULL, stderr=subprocess.PIPE, text=True, timeout=60)
            self.assertEqual(result.stderr, "", page.name)

    def test_manual_names_each_command(self):
        manual = (SOURCE / "resources/man/ktr.1").read_text(encoding="utf-8")
        listed = subprocess.run([PROGRAM, "--help"], capture_output=True, text=True, timeout=60).stdout
        commands = re.findall(r"^  ([a-z]+)  ", listed.split("Subcommands:")[1].split("Exit status")[0], re.M)
        self.assertIn("doctor", commands)
        for command in commands:
            self.assertRegex(manual, rf'\.(B|BI|BR) "?{command}\b')


if __name__ == "__main__":
    unittest.main()
