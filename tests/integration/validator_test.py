#!/usr/bin/python3
"""Accerciser's own validator over whole windows: scenarios, large text, and the field of a window that asks. Its schema is
read as it is installed; only its report is written down here instead of in its window. Skipped without it."""

import importlib.util
import os
import pathlib
import pathlib
import sys
import tempfile
import types
import unittest

import accessibility_test as accessibility

SCHEMA = pathlib.Path("/usr/share/accerciser/plugindata/validate/basic.py")


class Validator:
    """What the schema's rules inherit from."""

    def condition(self, acc):
        return True

    def before(self, acc, state, view):
        pass

    def after(self, acc, state, view):
        pass


class Report:
    """What the rules say it to."""

    def __init__(self):
        self.said = []

    def note(self, text, acc, url=""):
        self.said.append(f"{acc.getRoleName()} {acc.name!r}: {text}")

    error = warn = note

    def info(self, text, acc, url=""):
        pass

    debug = info


def rules():
    module = types.ModuleType("validate")
    module.Validator = Validator
    sys.modules["validate"] = module
    specification = importlib.util.spec_from_file_location("basic", SCHEMA)
    specification.loader.exec_module(importlib.util.module_from_spec(specification))
    return [rule() for rule in Validator.__subclasses__()]


def apply(rule, step, acc, state, report):
    try:
        concerned = rule.condition(acc)
    except Exception:  # as the validator itself takes it: the rule is not for this element
        return
    if concerned:
        try:
            getattr(rule, step)(acc, state, report)
        except TypeError:
            # The rule about names breaks down over what it is there to find.
            report.note(f"{type(rule).__name__} breaks down", acc)


def validate(acc, checks, state, report):
    import pyatspi

    for rule in checks:
        apply(rule, "before", acc, state, report)
    if not acc.getState().contains(pyatspi.STATE_MANAGES_DESCENDANTS):
        for i in range(acc.childCount):
            validate(acc.getChildAtIndex(i), checks, state, report)
    for rule in checks:
        apply(rule, "after", acc, state, report)


class ValidatorTest(accessibility.WindowTest):
    maxDiff = None

    def check(self, tree):
        checks, report = rules(), Report()
        self.assertGreater(len(checks), 10)
        validate(tree[0], checks, {}, report)
        self.assertEqual(report.said, [])

    def test_lists_fences_and_sharing(self):
        tree, _ = self.open(11, "dinner.json", "fence-leaving.json", "sharing-visible.json", "sharing-hidden.json")
        self.check(tree)

    def test_very_large_text(self):
        tree, _ = self.open(6, "dinner.json", "--text-size", "AX3")
        self.check(tree)

    def test_window_with_a_field(self):
        with tempfile.TemporaryDirectory() as folder:
            configuration = pathlib.Path(folder) / "ktr" / "config.json"
            configuration.parent.mkdir()
            configuration.write_text('{"account": {"personId": "1000", "host": "localhost:9"}}', encoding="utf-8")
            configuration.chmod(0o600)
            (configuration.parent / "token").write_text("secret\n", encoding="utf-8")
            (configuration.parent / "token").chmod(0o600)
            tree, _ = self.open(0, environment={"XDG_CONFIG_HOME": folder})
            self.assertIn("text", [node.getRoleName() for node in tree])
            self.check(tree)

    def test_page_for_signing_in(self):
        with tempfile.TemporaryDirectory() as folder:
            tree, _ = self.open(0, environment={"XDG_CONFIG_HOME": folder})
            self.assertIn("Where are your friends?", [node.name for node in tree])
            self.check(tree)

    def test_a_fault_is_found(self):
        """The rules do speak: of a button without an action there would be a line."""
        import pyatspi

        class Silent:
            name = "Send"

            def getRole(self):
                return pyatspi.ROLE_PUSH_BUTTON

            def getRoleName(self):
                return "push button"

            getLocalizedRoleName = getRoleName

            def queryAction(self):
                raise NotImplementedError

        report = Report()
        for rule in rules():
            apply(rule, "before", Silent(), {}, report) if type(rule).__name__ == "WidgetHasAction" else None
        self.assertEqual(len(report.said), 1)


if __name__ == "__main__":
    if not SCHEMA.exists():
        print("accerciser is not installed")
        sys.exit(77)
    if "KTR_INSIDE" not in os.environ:
        sys.exit(accessibility.outside(__file__))
    unittest.main()
