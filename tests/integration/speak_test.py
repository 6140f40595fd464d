#!/usr/bin/python3
"""`ktr ask --speak` with a real speech-dispatcher of the test's own, whose voice writes down what it is to say. Skipped without it."""

import json
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import time
import unicodedata
import unittest

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
DisableAutoSpawn
"""
# No module starts without a sound device.
SOUND = "pcm.!default { type null }\nctl.!default { type null }\n"
LANGUAGES = ("en", "de", "ja", "ar")
MODULE = """GenericExecuteSynth "printf '%s' \\'$LANGUAGE:$DATA\\' >> {folder}/said"
{languages}
AddVoice "en" "MALE1" "en"
DefaultVoice "en"
"""
FRIENDS = [{"fullName": "Ann $(id) O'Marsh", "firstName": "Ann", "lastName": "O'Marsh", "emails": ["ann@mail.example"],
            "track": [{"at": 0, "latitude": 50.21, "longitude": -3.12, "label": "Fish Market"}]},
           {"fullName": "Shirin Rezaei", "firstName": "Shirin", "lastName": "Rezaei", "emails": ["s@mail.example"], "hidden": True,
            "track": [{"at": 0, "latitude": 50.25, "longitude": -3.12}]}]


class SpeakTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory(ignore_cleanup_errors=True)
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        modules = self.folder / "config" / "speech-dispatcher" / "modules"
        modules.mkdir(parents=True)
        (modules.parent / "speechd.conf").write_text(SPEECH.format(folder=self.folder))
        (modules / "writes.conf").write_text(MODULE.format(folder=self.folder, languages="\n".join(
            f'GenericLanguage "{language}" "{language}" "utf-8"' for language in LANGUAGES)))
        (self.folder / ".asoundrc").write_text(SOUND)
        (self.folder / "run").mkdir(mode=0o700)
        (self.folder / "friends.json").write_text(json.dumps({"friends": FRIENDS}))
        self.service = Service(PROGRAM, "--friends", self.folder / "friends.json", "--write-config", self.folder / "config.json")
        self.addCleanup(self.service.__exit__)
        self.environment = {**os.environ, "HOME": str(self.folder), "XDG_CONFIG_HOME": str(self.folder / "config"),
                            "XDG_STATE_HOME": str(self.folder / "state"), "XDG_RUNTIME_DIR": str(self.folder / "run"),
                            "LC_ALL": "C.UTF-8", "KTR_CONFIG": str(self.folder / "config.json")}
        for name in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM", "SPEECHD_ADDRESS"):
            self.environment.pop(name, None)

    def start(self):
        daemon = subprocess.Popen(["speech-dispatcher", "--run-single", "--timeout", "0", "-C",
                                   self.folder / "config" / "speech-dispatcher"], env=self.environment,
                                  stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        self.addCleanup(daemon.wait)
        self.addCleanup(daemon.terminate)
        socket = self.folder / "run" / "speech-dispatcher" / "speechd.sock"
        end = time.monotonic() + 30
        while not socket.exists():
            self.assertLess(time.monotonic(), end, "the speech daemon does not start")
            time.sleep(0.05)

    def speak(self, question, language="en-GB", **environment):
        return subprocess.run([PROGRAM, "ask", question, "--language", language, "--speak"], capture_output=True, timeout=120,
                              env={**self.environment, **environment}, text=True, encoding="utf-8", check=False)

    def said(self):
        """What was said since this was asked last. The voice gets a long sentence in pieces."""
        file = self.folder / "said"
        text = file.read_text() if file.exists() else ""
        file.unlink(missing_ok=True)
        return text

    @staticmethod
    def letters(text):
        """Without blanks; the voice gets wide punctuation as narrow."""
        return "".join(unicodedata.normalize("NFKC", text).split())

    def test_what_is_printed_is_said_once_and_the_status_is_the_outcomes(self):
        self.start()
        for question, language, status in (("Where is Ann?", "en-GB", 0), ("Where is Shirin?", "en-GB", 10),
                                           ("Tell me a joke", "en-GB", 16), ("Wo ist Ann?", "de", 0), ("Annはどこ？", "ja", 0),
                                           ("Where is Ann?", "en-GB", 0)):
            with self.subTest(question):
                result = self.speak(question, language)
                self.assertEqual((result.returncode, result.stderr), (status, ""))
                spoken = self.said()
                code = language.split("-")[0]
                self.assertTrue(spoken.startswith(code + ":"), spoken)
                self.assertEqual(self.letters(spoken.replace(code + ":", "")), self.letters(result.stdout))
        time.sleep(1.0)
        self.assertEqual(self.said(), "", "nothing comes late")

    def assert_not_said(self, result):
        self.assertEqual(result.returncode, 1)
        self.assertEqual(result.stderr, "ktr: the answer cannot be said: speech-dispatcher (spd-say) does not answer\n")
        self.assertIn("Ann", result.stdout, "it is printed all the same")

    def test_without_a_daemon_or_its_client_it_says_so(self):
        self.assert_not_said(self.speak("Where is Ann?"))
        self.assert_not_said(self.speak("Where is Ann?", PATH="/nonexistent"))


if __name__ == "__main__":
    if not all(shutil.which(tool) for tool in ("speech-dispatcher", "spd-say")):
        print("skipped: speech-dispatcher is needed")
        sys.exit(77)
    unittest.main()
