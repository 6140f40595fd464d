#!/usr/bin/python3
"""Opens `ktr show` on a virtual display and uses it with a mouse and keys. Skipped without Xvfb,
xdotool and xwd."""

import json
import os
import pathlib
import re
import shutil
import subprocess
import sys
import unittest

import map_file
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

    def test_a_scenario_is_drawn_on_the_configured_map(self):
        scenario = json.loads((SCENARIOS / "single.json").read_text(encoding="utf-8"))
        location = scenario["snippet"]["locations"][0]
        location["latitude"], location["longitude"] = map_file.PLACE
        scenario["contacts"] = str(SCENARIOS / "contacts")
        del scenario["positions"]
        file, config = self.folder / "scenario.json", self.folder / "config.json"
        file.write_text(json.dumps(scenario), encoding="utf-8")
        region = map_file.write_region(self.folder / "region.mbtiles")
        config.write_text(json.dumps({"maps": {"sources": [{"file": str(region)}, {"file": str(self.folder / "gone.mbtiles")}]}}))
        self.environment["KTR_CONFIG"] = str(config)
        self.open(file, "--light")

        def drawn():
            taken = subprocess.run(["xwd", "-silent", "-id", self.window], env=self.environment, capture_output=True, check=False)
            # Four bytes a pixel, of which the last says nothing.
            return re.search(b"(?:\xff\x00\xff.){100}", taken.stdout, re.DOTALL)
        wait_for("the configured map", drawn)
        self.xdotool("key", "ctrl+q")
        self.assertEqual(self.program.wait(timeout=30), 0)
        self.assertIn('gone.mbtiles" is not there', self.program.stderr.read())

    def test_several_scenarios_open(self):
        self.open(*sorted(SCENARIOS.glob("*.json")))
        self.xdotool("key", "ctrl+w")
        self.assertEqual(self.program.wait(timeout=30), 0)


if __name__ == "__main__":
    if not all(shutil.which(tool) for tool in ("Xvfb", "xdotool", "xwd")):
        print("Xvfb, xdotool and xwd are not installed")
        sys.exit(77)
    unittest.main()
