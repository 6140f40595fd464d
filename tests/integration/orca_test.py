#!/usr/bin/python3
"""What a screen reader really says of a live window: each announcement is spoken once. Speech goes through speech-dispatcher to
a module that writes it down. Long, and skipped without Xvfb, a session bus, the reader and speech-dispatcher."""

import json
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import time
import unittest

from screen_session import outside
from serve import Service

PROGRAM = os.environ["KTR_PROGRAM"]

SPEECH = """LogLevel 1
LogDir "{folder}"
CommunicationMethod "unix_socket"
SocketPath "default"
AudioOutputMethod "alsa"
AudioALSADevice "default"
AddModule "writes" "sd_generic" "writes.conf"
DefaultModule writes
"""
# No module starts without a sound device.
SOUND = "pcm.!default { type null }\nctl.!default { type null }\n"
MODULE = """GenericExecuteSynth "printf '%s\\\\n' \\'$DATA\\' >> {folder}/said"
GenericLanguage "en" "en" "utf-8"
AddVoice "en" "MALE1" "en"
DefaultVoice "en"
"""


class OrcaTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory(ignore_cleanup_errors=True)
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        config = self.folder / "config" / "speech-dispatcher"
        (config / "modules").mkdir(parents=True)
        (config / "speechd.conf").write_text(SPEECH.format(folder=self.folder))
        (self.folder / ".asoundrc").write_text(SOUND)
        (config / "modules" / "writes.conf").write_text(MODULE.format(folder=self.folder))
        self.environment = {**os.environ, "HOME": str(self.folder), "XDG_CONFIG_HOME": str(self.folder / "config"),
                            "XDG_STATE_HOME": str(self.folder / "state"), "XDG_DATA_HOME": str(self.folder / "data"),
                            "QT_LINUX_ACCESSIBILITY_ALWAYS_ON": "1", "QT_QPA_PLATFORM": "xcb", "LC_ALL": "C.UTF-8",
                            "KTR_CONFIG": str(self.folder / "config.json")}

    def start(self, *command):
        process = subprocess.Popen([*map(str, command)], env=self.environment, stdout=subprocess.DEVNULL,
                                   stderr=subprocess.DEVNULL)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        return process

    def said(self):
        """What was spoken; of an answer without the time that it says it was true at."""
        written = self.folder / "said"
        return re.sub(r"At \d+:\d+ ", "", written.read_text()) if written.exists() else ""

    def wait_for(self, what, condition, seconds=60):
        deadline = time.monotonic() + seconds
        while time.monotonic() < deadline:
            result = condition()
            if result:
                return result
            time.sleep(0.2)
        raise AssertionError(f"{what} did not come; said: {self.said()}")

    def open_window(self):
        """A window on the service that has the keyboard, and a question in it."""
        program = self.start(PROGRAM, "show", "--print-urls", "--language", "en-GB", "--ask", "where are my friends")
        window = self.wait_for("the window", lambda: subprocess.run(
            ["xdotool", "search", "--onlyvisible", "--pid", str(program.pid), "--name", "^ktr$"], env=self.environment,
            capture_output=True, text=True, check=False).stdout.split()[:1])[0]
        subprocess.run(["xdotool", "windowfocus", "--sync", window], env=self.environment, check=True)

    def ask(self, question):
        for arguments in (["type", "--delay", "5", question], ["key", "Return"]):
            subprocess.run(["xdotool", *arguments], env=self.environment, check=True)

    def test_each_sentence_is_spoken_once(self):
        def point(at, label, **more):
            return {"at": at, "label": label, "latitude": 50.2114, "longitude": -3.115, **more}

        speech = self.start("speech-dispatcher", "--run-single", "--timeout", "0", "-C",
                            self.folder / "config" / "speech-dispatcher")
        self.start("orca", "--replace", "--disable=braille", "--enable=speech")
        self.wait_for("the reader's first words", self.said)
        self.assertIsNone(speech.poll())
        ann = {"fullName": "Ann Marsh", "firstName": "Ann", "emails": ["ann@harbour.example"], "repeats": False,
               "track": [point(0, "Home"), point(25, "Ferry Pier"), point(45, "Ferry Pier", hidden=True),
                         point(65, "Ferry Pier")]}
        (self.folder / "friends.json").write_text(json.dumps({"friends": [ann]}))
        # Each state lasts longer than the quiet between two announcements. Requests are counted, one every 0.6 seconds, since
        # each takes its time; when one fails, nobody asks any more until the next question.
        service = Service(PROGRAM, "--friends", self.folder / "friends.json", "--write-config",
                          self.folder / "config.json", "--interval", "0.5",
                          "--fault", "status=503,at=150,count=1", "--fault", "delay=0.1")
        self.addCleanup(service.__exit__)
        self.open_window()
        sentences = ["notification Ann Marsh was at home", "notification Ann Marsh: Ferry Pier",
                     "notification Ann Marsh is no longer visible", "notification Ann Marsh is visible again: Ferry Pier",
                     "notification Your friends are out of reach"]
        for sentence in sentences:
            self.wait_for(sentence, lambda: sentence in self.said(), 120)
        self.ask("where are my friends")
        sentences += ["notification Ann Marsh was at Ferry Pier", "Your friends are within reach again"]
        self.wait_for("the service's return", lambda: sentences[-1] in self.said())
        time.sleep(12)
        for sentence in sentences:
            self.assertEqual(self.said().count(sentence), 1, (sentence, self.said()))
        self.assertEqual(self.said().count("notification "), 6, self.said())
        self.assertEqual(self.said().count("People: 1"), 2, self.said())


def main():
    if os.environ.get("KTR_LONG_TESTS") != "1":
        print("only with KTR_LONG_TESTS=1")
        return 77
    return outside(__file__, "xdotool", "orca", "speech-dispatcher", seconds=560)


if __name__ == "__main__":
    if "KTR_INSIDE" not in os.environ:
        sys.exit(main())
    unittest.main()
