#!/usr/bin/python3
"""Opens the live window on a virtual display with `ktr serve` behind it: types a question, sees the answer and sees it move;
closing the window ends the service. Skipped without Xvfb, xdotool and xwd."""

import json
import os
import pathlib
import re
import shutil
import signal
import struct
import subprocess
import sys
import time
import unittest

from serve import Service
from window_case import WindowCase, wait_for

PROGRAM = os.environ["KTR_PROGRAM"]
SOURCE = pathlib.Path(os.environ["KTR_SOURCE"])

# The field and the rows in a window of 400 x 820 points.
FIELD = (200, 760)
SEND = (364, 760)
FIRST_ROW = (200, 220)
# Where a row says its place, as left, top, right and bottom: nothing else that changes stands there.
FIRST_PLACE = (90, 214, 300, 234)

# One friend's map: beside the pin, the monogram in the pin, and streets and buildings.
ON_MAP = (320, 400)
PIN = (185, 312, 215, 340)
GROUND = (60, 340, 130, 420)


def part_of(picture, part):
    """The bytes of a part of an xwd picture."""
    words = struct.unpack(">25I", picture[:100])
    start, bytes_a_pixel, bytes_a_line, colours = words[0], words[11] // 8, words[12], words[19]
    left, top, right, bottom = part
    data = picture[start + 12 * colours:]
    return b"".join(data[y * bytes_a_line + left * bytes_a_pixel:y * bytes_a_line + right * bytes_a_pixel]
                    for y in range(top, bottom))


class LiveWindowTest(WindowCase):
    def setUp(self):
        super().setUp()
        self.output = self.folder / "output"

    def serve(self, *options, step=0.0, start=(50.2114, -3.115)):
        """Ann goes so many degrees to the north from label to label, in the demo town or from another start."""
        track = [{"at": at, "latitude": start[0] + step * at, "longitude": start[1], "label": label}
                 for at, label in ((0, "Home"), (4, "Fish Market"), (5, "Work"), (6, "Ferry Pier"), (7, "Harbour Steps"))]
        ann = {"fullName": "Ann Marsh", "firstName": "Ann", "emails": ["ann@harbour.example"], "track": track}
        otto = {"fullName": "Otto Brandt", "firstName": "Otto", "emails": ["otto@mail.example"], "track": track[:1]}
        friends, config = self.folder / "friends.json", self.folder / "config.json"
        friends.write_text(json.dumps({"friends": [ann, otto]}))
        service = Service(PROGRAM, "--friends", friends, "--write-config", config, "--interval", "0.3", *options)
        self.addCleanup(service.__exit__)
        self.environment["KTR_CONFIG"] = str(config)
        return service

    def find_window(self):
        super().find_window()
        self.xdotool("windowfocus", "--sync", self.window)

    def start(self, *command):
        with self.output.open("w") as output:
            program = subprocess.Popen([*map(str, command)], env=self.environment, stdout=output, stderr=subprocess.PIPE,
                                       text=True, start_new_session=True)
        self.addCleanup(self.kill, program)
        self.find_window()
        return program

    def kill(self, program):
        if program.poll() is None:
            os.killpg(program.pid, signal.SIGKILL)
        program.wait()
        program.stderr.close()

    def open(self, *options):
        return self.start(PROGRAM, "show", "--print-urls", "--language", "en-GB", "--light", *options)

    def picture(self, part):
        taken = subprocess.run(["xwd", "-silent", "-id", self.window], env=self.environment, capture_output=True, check=False)
        return part_of(taken.stdout, part) if taken.returncode == 0 else None

    def click(self, at):
        self.xdotool("mousemove", "--window", self.window, *at, "click", 1)

    def url_of(self, at):
        """The URL of what stands there once it can be pressed."""
        before = len(self.output.read_text().split())

        def pressed():
            self.click(at)
            time.sleep(0.2)
            return self.output.read_text().split()[before:]
        urls = wait_for(f"a link at {at}", pressed)
        # What several clicks gave comes at its own time.
        written = None
        while written != (written := self.output.read_text()):
            time.sleep(0.3)
        self.xdotool("mousemove", "--window", self.window, 200, 700)
        return urls[-1]

    def wait_for_change(self, what, part):
        first = self.picture(part)
        wait_for(what, lambda: self.picture(part) not in (first, None))

    def test_typed_question_is_answered_and_the_answer_moves(self):
        self.serve()
        program = self.open()
        self.xdotool("type", "--delay", 5, "where are my friends")
        self.xdotool("key", "Return")
        self.assertEqual(self.url_of(FIRST_ROW), "wayloc://friend/ann@harbour.example")
        self.wait_for_change("another place of Ann's", FIRST_PLACE)
        self.click(FIELD)
        self.xdotool("key", "ctrl+q")
        self.assertEqual(program.wait(timeout=20), 0)
        self.assertEqual(program.stderr.read(), "")

    def test_one_friend_stands_on_a_map_that_moves(self):
        self.serve(step=0.0003)
        program = self.open()
        self.xdotool("type", "--delay", 5, "where is ann")
        self.xdotool("key", "Return")
        self.assertEqual(self.url_of(ON_MAP), "wayloc://friend/ann@harbour.example")
        pin = wait_for("the pin", lambda: self.picture(PIN))
        self.wait_for_change("another part of the town", GROUND)
        # She stays in the middle.
        wait_for("the pin at rest", lambda: self.picture(PIN) == pin)
        self.click(FIELD)
        self.xdotool("key", "ctrl+q")
        self.assertEqual(program.wait(timeout=20), 0)
        self.assertEqual(program.stderr.read(), "")

    def test_keys_alone_reach_the_newest_answer_and_come_back_to_what_was_typed(self):
        self.serve()
        program = self.open("--reduced-motion", "--ask", "where are my friends")
        self.assertEqual(self.url_of(FIRST_ROW), "wayloc://friend/ann@harbour.example")
        self.click(FIELD)
        already = len(self.output.read_text().split())
        self.xdotool("type", "--delay", 5, "where is ")
        self.xdotool("key", "Tab", "Return", "Down", "Return", "Up", "Return")

        def pressed():
            return self.output.read_text().split()[already:]

        ann, otto = "wayloc://friend/ann@harbour.example", "wayloc://friend/otto@mail.example"
        wait_for("three rows opened", lambda: len(pressed()) >= 3)
        self.assertEqual(pressed(), [ann, otto, ann])
        # Back, on with the sentence, and sent: nothing of it was lost.
        self.xdotool("key", "Escape")
        self.xdotool("type", "--delay", 5, "otto")
        self.xdotool("key", "Return")
        wait_for("the second answer", lambda: self.url_of(ON_MAP) == otto)
        # Beyond the newest answer's row and map stands the button, beyond that the settings', and beyond that the field.
        self.click(FIELD)
        self.xdotool("type", "--delay", 5, "where is ")
        self.xdotool("key", "Tab", "Tab", "Tab", "Tab", "Tab")
        self.xdotool("type", "--delay", 5, "ann")
        self.xdotool("key", "Tab", "Tab", "Tab", "space")
        wait_for("the third answer", lambda: self.url_of(ON_MAP) == ann)
        self.xdotool("key", "ctrl+q")
        self.assertEqual(program.wait(timeout=20), 0)
        self.assertEqual(program.stderr.read(), "")

    def test_text_grows_and_shrinks_by_keys(self):
        self.serve()
        program = self.open("--reduced-motion", "--ask", "where are my friends")
        self.assertEqual(self.url_of(FIRST_ROW), "wayloc://friend/ann@harbour.example")
        self.click(FIELD)
        everything = (0, 60, 390, 640)
        # What changes by itself stands still for the comparison.
        time.sleep(9)
        usual = self.picture(everything)
        self.xdotool("key", "ctrl+plus")
        larger = wait_for("larger text", lambda: (now := self.picture(everything)) != usual and now)
        self.xdotool("key", "ctrl+plus", "ctrl+minus", "ctrl+minus")
        wait_for("the usual size again", lambda: self.picture(everything) == usual)
        self.xdotool("key", "ctrl+minus")
        wait_for("smaller text", lambda: self.picture(everything) not in (usual, larger))
        self.xdotool("key", "ctrl+0")
        wait_for("what it was at first", lambda: self.picture(everything) == usual)
        # The window goes on: rows can be pressed, and questions asked.
        self.assertEqual(self.url_of(FIRST_ROW), "wayloc://friend/ann@harbour.example")
        self.xdotool("key", "ctrl+q")
        self.assertEqual(program.wait(timeout=20), 0)
        self.assertEqual(program.stderr.read(), "")

    def test_send_button_asks_and_a_second_question_comes_to_the_top(self):
        self.serve()
        self.open("--reduced-motion")
        self.click(FIELD)
        self.xdotool("type", "--delay", 5, "where are my friends")
        self.click(SEND)
        self.assertEqual(self.url_of(FIRST_ROW), "wayloc://friend/ann@harbour.example")
        answered = self.picture((0, 0, 380, 700))
        self.click(FIELD)
        self.xdotool("type", "--delay", 5, "share my location until six")
        self.xdotool("key", "Return")
        # Below its question stands a sentence and nothing else.
        below = (0, 300, 380, 600)
        paper = self.picture((100, 701, 101, 702))
        wait_for("the second answer at the top",
                 lambda: self.picture((0, 0, 380, 700)) != answered and self.picture(below) == paper * (380 * 300))
        self.xdotool("key", "ctrl+w")

    def test_typed_wishes_are_honoured(self):
        service = self.serve()
        self.open("--reduced-motion")

        def is_visible():
            return not service.hides()

        self.xdotool("type", "--delay", 5, "tell me when ann leaves work")
        self.xdotool("key", "Return")
        self.assertEqual(self.url_of(FIRST_ROW), "wayloc://friend/ann@harbour.example")
        self.assertTrue(is_visible())
        for question, visible in (("hide my location", False), ("share my location", True)):
            self.click(FIELD)
            self.xdotool("type", "--delay", 5, question)
            self.xdotool("key", "Return")
            wait_for(question, lambda wanted=visible: is_visible() == wanted)
        self.xdotool("key", "ctrl+w")

    def test_faults_do_not_hold_the_window_up(self):
        self.serve("--fault", "delay=30,at=2")
        program = self.open("--ask", "where are my friends")
        self.assertEqual(self.url_of(FIRST_ROW), "wayloc://friend/ann@harbour.example")
        begin = time.monotonic()
        self.click(FIELD)
        self.xdotool("key", "ctrl+q")
        self.assertEqual(program.wait(timeout=20), 0)
        self.assertLess(time.monotonic() - begin, 5.0)

    def service_of_run(self):
        port = wait_for("the service's port", lambda: re.search(r"localhost:(\d+)", self.output.read_text())).group(1)
        pattern = rf"0100007F:{int(port):04X} 00000000:0000 0A"
        return lambda: re.search(pattern, pathlib.Path("/proc/net/tcp").read_text()) is not None

    def test_closing_the_window_ends_the_service(self):
        program = self.start(SOURCE / "scripts" / "show", PROGRAM)
        is_served = self.service_of_run()
        self.assertTrue(is_served())
        self.xdotool("key", "ctrl+q")
        self.assertEqual(program.wait(timeout=20), 0)
        self.assertFalse(is_served())

    def test_interrupt_ends_window_and_service(self):
        program = self.start(SOURCE / "scripts" / "show", PROGRAM)
        is_served = self.service_of_run()
        program.send_signal(signal.SIGINT)
        self.assertEqual(program.wait(timeout=20), 130)
        self.assertFalse(is_served())
        wait_for("the window's end", lambda: not self.xdotool("search", "--onlyvisible", "--name", "^ktr$", check=False))

    def test_kill_of_the_script_ends_window_and_service(self):
        program = self.start(SOURCE / "scripts" / "show", PROGRAM)
        is_served = self.service_of_run()
        program.kill()
        program.wait()
        wait_for("the service's end", lambda: not is_served())
        wait_for("the window's end", lambda: not self.xdotool("search", "--onlyvisible", "--name", "^ktr$", check=False))


if __name__ == "__main__":
    if not all(map(shutil.which, ("Xvfb", "xdotool", "xwd"))):
        print("Xvfb, xdotool and xwd are not installed")
        sys.exit(77)
    unittest.main()
