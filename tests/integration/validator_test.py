#!/usr/bin/python3
"""Accerciser's own validator over whole windows: scenarios, large text, and the field of a window that asks. Its schema is
read as it is installed; only its report is written down here instead of in its window. Skipped without it."""

import importlib.util
import json
import os
import pathlib
import subprocess
import sys
import tempfile
import time
import types
import unittest

import accessibility_test as accessibility
import screen_session
from serve import Service

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
    before = None

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

    def live(self, *words):
        """A window beside a service that knows two friends; its whole tree, when it is asked for."""
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        track = [{"at": 0, "latitude": 50.2114, "longitude": -3.115, "label": "Home"}]
        friends = [{"fullName": name, "firstName": name.split()[0], "emails": [address], "track": track}
                   for name, address in (("Ann Marsh", "ann@harbour.example"), ("Otto Brandt", "otto@mail.example"))]
        file, config = pathlib.Path(folder.name) / "friends.json", pathlib.Path(folder.name) / "config.json"
        file.write_text(json.dumps({"friends": friends}), encoding="utf-8")
        service = Service(accessibility.PROGRAM, "--friends", file, "--write-config", config)
        self.addCleanup(service.__exit__)
        environment = {**os.environ, "QT_LINUX_ACCESSIBILITY_ALWAYS_ON": "1", "QT_QPA_PLATFORM": "xcb", "KTR_CONFIG": str(config),
                       "XDG_STATE_HOME": folder.name, "XDG_DATA_HOME": folder.name}
        if self.before is not None:
            # A link would lead there.
            self.before.kill()
            self.before.wait()
        self.before = program = subprocess.Popen([accessibility.PROGRAM, *words], env={**environment, "LANG": "C.UTF-8"})
        self.addCleanup(program.wait)
        self.addCleanup(program.kill)
        return lambda: screen_session.tree(program.pid)

    def shown(self, tree, name, *roles):
        """What bears this name on the screen, or begins with it."""
        import pyatspi
        from gi.repository import GLib

        def found():
            for node in tree():
                try:
                    if (node.name or "").startswith(name) and (not roles or node.getRoleName() in roles) and node.getState(
                            ).contains(pyatspi.STATE_SHOWING):
                        return node
                except (AttributeError, GLib.Error):
                    continue
            return None
        return accessibility.wait_for(repr(name), found)

    def press(self, node):
        action = node.queryAction()
        action.doAction([action.getName(i) for i in range(action.nActions)].index("Press"))

    def check_page(self, tree):
        """Once nothing comes or goes any more."""
        time.sleep(1.5)
        self.check(tree())
        nameless = [node.getRoleName() for node in tree() if node.getRoleName() in ("push button", "check box", "link", "entry")
                    and not any(letter.isalpha() for letter in node.name or "")]
        self.assertEqual(nameless, [], "a name is words")

    def test_settings_and_what_they_lead_to(self):
        tree = self.live("show")
        self.press(self.shown(tree, "Settings", "push button"))
        self.shown(tree, "Notifications", "check box")
        self.check_page(tree)
        self.press(self.shown(tree, "Colours", "push button"))
        self.shown(tree, "Dark", "radio button")
        self.check_page(tree)
        self.press(self.shown(tree, "Back", "push button"))
        self.press(self.shown(tree, "Check-up", "push button"))
        self.shown(tree, "Check again", "push button")
        self.check_page(tree)

    def test_friends_and_own_page(self):
        tree = self.live("show", "--ask", "where are my friends")
        self.press(self.shown(tree, "Ann Marsh", "link"))
        self.shown(tree, "Copy place", "push button")
        self.check_page(tree)
        for link, name in (("wayloc://friends/", "Nobody was asked about yet."), ("wayloc://friend/", "Friends can see me")):
            tree = self.live("open", link)
            self.shown(tree, name)
            self.check_page(tree)

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
        sys.exit(screen_session.outside(__file__, seconds=300))
    unittest.main()
