#!/usr/bin/python3
"""What assistive technology sees of the window, over the accessibility bus of a session of its own: names, roles, places
and presses. Skipped without a virtual display, a session bus and pyatspi."""

import os
import pathlib
import subprocess
import sys
import tempfile
import unittest

from screen_session import nodes, outside
from window_case import wait_for

PROGRAM = os.environ["KTR_PROGRAM"]
SCENARIOS = pathlib.Path(os.environ["KTR_SOURCE"]) / "resources" / "scenarios"


class WindowTest(unittest.TestCase):
    def open(self, count, *words, environment=None):
        """A window on scenarios and options: its tree once it has that many links, and where it prints URLs."""
        import pyatspi
        from gi.repository import GLib

        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        output = pathlib.Path(folder.name) / "output"
        environment = {**os.environ, "QT_LINUX_ACCESSIBILITY_ALWAYS_ON": "1", "QT_QPA_PLATFORM": "xcb", **(environment or {})}
        words = [SCENARIOS / word if word.endswith(".json") else word for word in words]
        with output.open("w") as stream:
            program = subprocess.Popen([PROGRAM, "show", *words, "--print-urls"], env=environment, stdout=stream)
        self.addCleanup(program.wait)
        self.addCleanup(program.kill)
        desktop = pyatspi.Registry.getDesktop(0)

        def application():
            found = [desktop.getChildAtIndex(i) for i in range(desktop.childCount)]
            return next((one for one in found if one and one.name == "ktr" and one.childCount
                         and one.get_process_id() == program.pid), None)

        def whole_tree():
            """None while the window is still being filled: a node may go between two questions about it."""
            try:
                tree = list(nodes(application()))
                links = [node for node in tree if node.getRoleName() == "link"]
                return tree if len(tree) > 1 and len(links) == count and all(link.name for link in links) else None
            except (AttributeError, RuntimeError, LookupError, GLib.Error):
                return None

        return wait_for(f"the window's {count} links on the bus", whole_tree), output


class AccessibilityTest(WindowTest):
    def test_rows_are_named_links_that_can_be_pressed(self):
        import pyatspi

        tree, output = self.open(6, "dinner.json")
        texts = [node.name for node in tree if node.getRoleName() == "label"]
        self.assertEqual(texts[1:3], ["Where are my friends near the harbour?", "Here are the five nearest."])
        groups = [node.name for node in tree if node.getRoleName() == "panel" and node.name]
        self.assertEqual(groups, ["Where are my friends near the harbour?", "Question", "Answer", "Friends"])
        links = [node for node in tree if node.getRoleName() == "link"]
        self.assertEqual(len(links), 6)
        self.assertEqual(links[0].name.replace("\u00a0", " "), "Ann Marsh, Place: Fish Market, 310 m away, Located now")
        self.assertEqual([link.childCount for link in links], [0] * 6, "a row is one element")
        self.assertEqual(links[-1].name, "Show all friends")
        places = [link.queryComponent().getExtents(pyatspi.DESKTOP_COORDS) for link in links]
        self.assertTrue(all(place.width == 376 for place in places))
        self.assertEqual([place.y for place in places], sorted(place.y for place in places))
        links[1].queryAction().doAction(0)
        wait_for("the URL", lambda: output.read_text() == "wayloc://friend/l.haddad@mail.example\n")

    def test_fences_and_sharing_make_sense_without_seeing(self):
        tree, output = self.open(5, "fence-leaving.json", "sharing-visible.json", "sharing-hidden.json")
        links = [node for node in tree if node.getRoleName() == "link"]
        names = [link.name.replace("\u00a0", " ") for link in links]
        self.assertEqual(names[0], "נועם ברק, You’ll hear as they leave Work")
        self.assertIn("Map: the area around Work", names[1])
        self.assertTrue(names[2].startswith("Mara Lind, Friends can see where you are"), names[2])
        self.assertIn("Map: you are here", names[3])
        self.assertEqual(names[4], "Mara Lind, Hidden from friends")
        links[0].queryAction().doAction(0)
        wait_for("the URL", lambda: output.read_text() == "wayloc://friend/n.barak@harbour.example\n")


    def test_tree_breaks_none_of_a_validators_rules(self):
        """Those that a checker of accessible interfaces has for the roles that are here."""
        import pyatspi

        tree, _ = self.open(5, "fence-leaving.json", "sharing-visible.json",
                            "sharing-hidden.json")
        complaints = []
        focused = 0
        for node in tree:
            role, name, states = node.getRoleName(), node.name, node.getState()
            who = f"{role} {name!r}"
            try:
                action = node.queryAction()
                actions = [action.getName(i) for i in range(action.nActions)]
            except NotImplementedError:
                actions = []
            focusable = states.contains(pyatspi.STATE_FOCUSABLE)
            focused += states.contains(pyatspi.STATE_FOCUSED)
            if role in ("link", "push button"):
                complaints += [f"{who}: no action"] * (not actions)
                complaints += [f"{who}: not focusable"] * (not focusable)
            if actions and not focusable and role not in ("scroll bar", "frame"):
                complaints.append(f"{who}: {actions}, and not focusable")
            if focusable and not name and role not in ("document frame", "frame", "filler"):
                complaints.append(f"{who}: focusable without a name")
            if role in ("label", "link") and not name:
                complaints.append(f"{who}: says nothing")
            parent = node.parent
            if parent is not None and parent.getRoleName() != "desktop frame":
                index = node.getIndexInParent()
                if not 0 <= index < parent.childCount or parent.getChildAtIndex(index) != node:
                    complaints.append(f"{who}: is not child {index} of its parent")
            for relation in node.getRelationSet():
                complaints += [f"{who}: a relation to nothing" for i in range(relation.getNTargets())
                               if relation.getTarget(i) is None]
        self.assertEqual(complaints, [])
        self.assertLessEqual(focused, 1)


if __name__ == "__main__":
    if "KTR_INSIDE" not in os.environ:
        sys.exit(outside(__file__))
    unittest.main()
