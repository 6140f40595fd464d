#!/usr/bin/env python3
"""The check of the texts finds what it is there for, and says where."""
import pathlib
import subprocess
import tempfile
import unittest

CHECK = pathlib.Path(__file__).resolve().parents[2] / "resources" / "localization" / "check-texts"
HEAD = '<?xml version="1.0" encoding="utf-8"?>\n<!DOCTYPE TS>\n<TS version="2.1" language="de"><context>\n<name>Localizable</name>\n'
ENGLISH = (("MINUTES", "%@ minutes ago"), ("PLACE", "%1$@, %2$@"), ("NAME", "Friends"))
GERMAN = {"MINUTES": "vor %@ Minuten", "PLACE": "%2$@ %1$@", "NAME": "Freunde"}


def document(texts):
    """One message a line: the first is on line 5."""
    return HEAD + "\n".join(
        f"<message><source>{key}</source><translation>{text}</translation></message>" for key, text in texts
    ) + "\n</context></TS>\n"


class CheckTextsTest(unittest.TestCase):
    def check(self, **changed):
        return self.checkDocument(document({**GERMAN, **changed}.items()))

    def checkDocument(self, german):
        with tempfile.TemporaryDirectory() as folder:
            english = pathlib.Path(folder) / "texts_en.ts"
            english.write_text(document(ENGLISH), encoding="utf-8")
            self.file = pathlib.Path(folder) / "texts_de.ts"
            self.file.write_text(german, encoding="utf-8")
            return subprocess.run([CHECK, english, self.file], capture_output=True, text=True, check=False)

    def assertFault(self, result, line, words):
        self.assertEqual(result.returncode, 1, result.stderr)
        self.assertTrue(result.stderr.startswith(f"{self.file}:{line}: "), result.stderr)
        self.assertIn(words, result.stderr)
        self.assertEqual(len(result.stderr.splitlines()), 1, result.stderr)

    def assertFine(self, result):
        self.assertEqual((result.returncode, result.stderr), (0, ""))

    def test_right_texts_pass(self):
        self.assertFine(self.check())
        self.assertFine(self.check(MINUTES="{0, plural, one{vor einer Minute} other{vor %@ Minuten}}"))
        self.assertFine(self.check(PLACE="{0, plural, two{%2$@} other{%2$@ %1$@}}"))

    def test_a_malformed_plural_text_is_found_with_its_line(self):
        for text, words in (
            ("{0, plural, one{a} other{vor %@}", "malformed"),
            ("{0, plural, one{a} other{vor %@}} Minuten", "malformed"),
            ("{0, plural, one{a}}", '"other" is missing'),
            ("{0, plural, one{a} one{b} other{%@}}", "comes twice"),
            ("{0, plural, some{a} other{%@}}", "no plural category"),
            ("{0, plural, =1{a} other{%@}}", "no plural category"),
            ("{0, plural, one{{0, plural, other{a}}} other{%@}}", "do not nest"),
            ("{0, plural, offset:1 one{a} other{%@}}", "offset"),
            ("{0, select, one{a} other{%@}}", "select"),
            ("vor {0, plural, other{%@}}", "brace"),
            ("{1, plural, other{%@}}", "brace"),
        ):
            with self.subTest(text):
                self.assertFault(self.check(MINUTES=text), 5, words)

    def test_another_number_of_arguments_is_found(self):
        self.assertFault(self.check(MINUTES="vor Minuten"), 5, "takes the arguments")
        self.assertFault(self.check(PLACE="%1$@"), 6, "takes the arguments")
        self.assertFault(self.check(NAME="%@"), 7, "takes the arguments")
        self.assertFault(self.check(NAME="100 %"), 7, "percent sign")

    def test_only_numbers_that_can_be_spelt_out_may_be_left_out(self):
        self.assertFault(self.check(MINUTES="{0, plural, few{a} other{%@}}"), 5, "takes the arguments")
        self.assertFault(self.check(MINUTES="{0, plural, one{a} other{b}}"), 5, "takes the arguments")
        self.assertFault(self.check(PLACE="{0, plural, one{%1$@} other{%2$@ %1$@}}"), 6, "takes the arguments")

    def test_keys_are_those_of_english(self):
        self.assertFault(self.check(OTHER="a"), 8, "not among the English")
        self.assertFault(self.checkDocument(document([*GERMAN.items(), ("NAME", "a")])), 8, "comes twice")
        self.assertFault(self.check(NAME=" "), 7, "no finished text")
        unfinished = document(GERMAN.items()).replace("<translation>Fr", '<translation type="unfinished">Fr')
        self.assertFault(self.checkDocument(unfinished), 7, "no finished text")

    def test_what_is_no_xml_is_found_with_its_line(self):
        self.assertFault(self.checkDocument(HEAD + "<message><source>\n</message>"), 6, "mismatched tag")


if __name__ == "__main__":
    unittest.main()
