#!/usr/bin/python3
"""Describes every demo scenario in the pseudo-languages, whose letters have accents: what comes without them, and is not
the scenario's own, was not looked up."""

import json
import os
import pathlib
import re
import subprocess
import unittest

PROGRAM = os.environ["KTR_PROGRAM"]
SCENARIOS = pathlib.Path(os.environ["KTR_SOURCE"]) / "resources" / "scenarios"
# Every text of the pseudo-languages has accents on all of these letters.
PLAIN = re.compile("[AaCcDdEeGgIiLlNnOoRrSsTtUuWwYyZz]+")
# The names of units are the locale data's, which know no pseudo-language.
UNITS = re.compile("[0-9.,]+[ \u00a0](kilo)?met(re|er)s?")
MARKS = re.compile("[\u200f\u202e\u202c]")


def texts_in(value):
    if isinstance(value, str):
        yield value
    for part in value.values() if isinstance(value, dict) else value if isinstance(value, list) else ():
        yield from texts_in(part)


def contacts():
    for card in (SCENARIOS / "contacts").glob("*.vcf"):
        for line in card.read_text(encoding="utf-8").splitlines():
            name, _, value = line.partition(":")
            if name.split(";")[0] in ("FN", "N", "EMAIL", "TEL", "NICKNAME"):
                yield value
                yield from value.split(";")


class PseudoLanguageTest(unittest.TestCase):
    def described(self, scenario, language):
        result = subprocess.run([PROGRAM, "describe", "--language", language, scenario], capture_output=True, timeout=120,
                                text=True, encoding="utf-8")
        self.assertEqual((result.returncode, result.stderr), (0, ""), scenario.name)
        return result.stdout

    def check(self, scenario, language):
        own = {text for text in texts_in(json.loads(scenario.read_text(encoding="utf-8"))) if text}
        own.update(text for text in contacts() if text)
        for line in self.described(scenario, language).splitlines():
            if line in own:
                continue
            left = UNITS.sub("", line)
            for text in sorted(own, key=len, reverse=True):
                left = left.replace(text, "")
            with self.subTest(scenario=scenario.name, line=line):
                self.assertIsNone(PLAIN.search(left), f"not looked up: {PLAIN.findall(left)}")
                self.assertEqual(line.count("["), line.count("]"))
            yield line

    def test_every_text_of_every_scenario_is_looked_up(self):
        scenarios = sorted(SCENARIOS.glob("*.json"))
        self.assertGreater(len(scenarios), 25)
        lines = [line for scenario in scenarios for line in self.check(scenario, "qps")]
        self.assertGreater(sum("[" in line for line in lines), 2 * len(scenarios))

    def test_the_mirrored_one_runs_from_right_to_left(self):
        lines = list(self.check(SCENARIOS / "dinner.json", "qps-plocm"))
        self.assertTrue(any(MARKS.search(line) for line in lines), lines)


if __name__ == "__main__":
    unittest.main()
