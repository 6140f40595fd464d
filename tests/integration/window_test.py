#!/usr/bin/python3
"""Opens `ktr show` on a virtual display and uses it with a mouse and keys. Skipped without Xvfb and xdotool."""

import os
import pathlib
import shutil
import subprocess
import sys
import unittest

from window_case import WindowCase, wait_for

PROGRAM = os.environ["KTR_PROGRAM"]
SCENARIOS = pathlib.Path(os.environ["KTR_SOURCE"]) / "resources" / "scenarios"


class WindowTest(WindowCase):
    def setUp(self):
        super().setUp()
        self.output = self.folder / "output"

    def open(self, *arguments):
        with self.output.open("w") as output:
            self.program = subprocess.Popen([PROGRAM, "show", *map(str, arguments), "--print-urls"], env=self.environment,
                                            stdout=output, stderr=subprocess.PIPE, text=True)
        self.addCleanup(self.kill)
        self.find_window()
        # Without a window manager the focus follows the pointer.
        self.xdotool("mousemove", "--window", self.window, 200, 120)

    def kill(self):
        if self.program.poll() is None:
            self.program.kill()
        self.program.wait()
        self.program.stderr.close()

    def urls(self):
        return self.output.read_text().split()

    def wait_for_urls(self, *expected):
        wait_for(f"{expected}", lambda: self.urls() == list(expected) or None)

    def test_click_prints_the_url_and_closing_exits_with_zero(self):
        self.open(SCENARIOS / "dinner.json")
        self.xdotool("mousemove", "--window", self.window, 200, 250, "click", 1)
        self.wait_for_urls("wayloc://friend/ann@harbour.example")
        self.xdotool("key", "ctrl+q")
        self.assertEqual(self.program.wait(timeout=30), 0)
        self.assertEqual(self.program.stderr.read(), "")

    def test_keys_walk_and_open(self):
        self.open(SCENARIOS / "dinner.json")
        for key in ("Tab", "Tab", "Tab", "Return"):
            self.xdotool("key", key)
        self.wait_for_urls("wayloc://friend/n.barak@harbour.example")

    def test_wide_window_answers_beside_the_question(self):
        self.open(SCENARIOS / "dinner.json", "--width", "1100")
        self.xdotool("mousemove", "--window", self.window, 200, 110, "click", 1)
        self.xdotool("mousemove", "--window", self.window, 700, 110, "click", 1)
        self.wait_for_urls("wayloc://friend/ann@harbour.example")

    def test_resized_and_scrolled_window_still_knows_its_rows(self):
        self.open(SCENARIOS / "dinner.json")
        self.xdotool("windowsize", "--sync", self.window, 380, 400)
        self.xdotool("key", "End")
        # The last row, show all, ends 24 above the content's end.
        self.xdotool("mousemove", "--window", self.window, 190, 350, "click", 1)
        self.wait_for_urls("wayloc://friends/")

    def test_several_scenarios_open(self):
        self.open(*sorted(SCENARIOS.glob("*.json")))
        self.xdotool("key", "ctrl+w")
        self.assertEqual(self.program.wait(timeout=30), 0)


if __name__ == "__main__":
    if not shutil.which("Xvfb") or not shutil.which("xdotool"):
        print("Xvfb and xdotool are not installed")
        sys.exit(77)
    unittest.main()
