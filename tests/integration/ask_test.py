#!/usr/bin/python3
"""One question from a terminal: the real program against the real `ktr serve`, each outcome with its sentence and status."""

import json
import os
import pathlib
import pty
import shlex
import struct
import subprocess
import tempfile
import unittest
import zlib

from serve import Service

PROGRAM = os.environ["KTR_PROGRAM"]


def friend(first, last, latitude, **more):
    return {"fullName": f"{first} {last}", "firstName": first, "lastName": last,
            "emails": [f"{first}.{last}@mail.example".lower()], "repeats": False,
            "track": [{"at": 0, "latitude": latitude, "longitude": -3.12, "street": "Quay Road", "city": "Brinmouth",
                       "stateCode": "HB", **more.pop("place", {})}], **more}


FRIENDS = [friend("Ann", "Marsh", 50.2104, place={"label": "Fish Market"}), friend("Otto", "Brandt", 50.2204),
           friend("Max", "Weber", 50.2304), friend("Max", "Stone", 50.2404), friend("Shirin", "Rezaei", 50.2504, hidden=True)]


class AskTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        folder = tempfile.TemporaryDirectory()
        cls.addClassCleanup(folder.cleanup)
        cls.folder = pathlib.Path(folder.name)
        (cls.folder / "friends.json").write_text(json.dumps({"friends": FRIENDS, "user": {
            "fullName": "Mara Lind", "firstName": "Mara", "lastName": "Lind", "emails": ["mara.lind@harbour.example"]}}))
        cls.service = Service(PROGRAM, "--friends", cls.folder / "friends.json", "--write-config", cls.folder / "config.json")
        cls.addClassCleanup(cls.service.__exit__)

    def run_ask(self, question, *options, config=None):
        environment = {k: v for k, v in os.environ.items() if k not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM")}
        environment.update(KTR_CONFIG=str(config or self.folder / "config.json"), XDG_STATE_HOME=str(self.folder / "state"))
        return subprocess.run([PROGRAM, "ask", question, "--language", "en-GB", *options], env=environment,
                              capture_output=True, timeout=60, text=True, encoding="utf-8")

    def asked(self, question, *options):
        result = self.run_ask(question, "--json", *options)
        answer = json.loads(result.stdout)
        self.assertEqual(result.stdout.count("\n"), 1)
        return result.returncode, answer

    def test_each_outcome_has_its_status_and_its_sentence(self):
        for question, status, outcome, words in [
                ("Where is Ann?", 0, "found", "Ann Marsh is at Fish Market"),
                ("Where is Shirin?", 10, "notSeen", "I can’t see where Shirin Rezaei is."),
                ("Where is Max?", 11, "ambiguous", "Which Max do you mean?"),
                ("Where is Xyzzy?", 12, "unknownPerson", "I don’t know Xyzzy."),
                ("Tell me a joke", 16, "notUnderstood", "I didn’t understand that."),
                ("Share my location until six", 18, "refused", "Say with whom.")]:
            with self.subTest(question):
                code, answer = self.asked(question)
                self.assertEqual((code, answer["outcome"]), (status, outcome), answer)
                self.assertIn(words, answer["sentence"])
                self.assertEqual("snippet" in answer, outcome == "found")

    def test_a_choice_is_asked_as_it_stands(self):
        _, answer = self.asked("Where is Max?")
        self.assertEqual([choice["name"] for choice in answer["choices"]], ["Max Weber", "Max Stone"])
        code, chosen = self.asked(answer["choices"][1]["question"])
        self.assertEqual(code, 0)
        self.assertIn("Max Stone", chosen["sentence"])

    def told_on_a_terminal(self, question):
        """What somebody reads beside the answer, which goes to a file."""
        ours, theirs = pty.openpty()
        environment = dict(os.environ, KTR_CONFIG=str(self.folder / "config.json"), XDG_STATE_HOME=str(self.folder / "state"))
        subprocess.run([PROGRAM, "ask", question, "--language", "en-GB"], env=environment, stdout=subprocess.DEVNULL,
                       stderr=theirs, timeout=60, check=False)
        os.close(theirs)
        told = b""
        try:
            while block := os.read(ours, 65536):
                told += block
        except OSError:
            pass
        os.close(ours)
        return told.decode().replace("\r\n", "\n")

    def test_a_terminal_is_told_what_to_ask_and_it_can_be_pasted(self):
        self.assertEqual(self.told_on_a_terminal("Where is Max?"),
                         "ktr: ktr ask 'Where is max.weber@mail.example?'   # Max Weber\n"
                         "ktr: ktr ask 'Where is max.stone@mail.example?'   # Max Stone\n")
        line = self.told_on_a_terminal("Where is Shirin?").removeprefix("ktr: ").strip()
        self.assertEqual(shlex.split(line)[:2], ["ktr", "ask"])
        self.assertIn("Shirin", shlex.split(line)[2])
        self.assertEqual(self.told_on_a_terminal("Where is Ann?"), "")

    def test_one_sentence_is_printed(self):
        result = self.run_ask("Where is Otto?")
        self.assertEqual(result.stdout, "Otto Brandt is on Quay Road.\n")
        self.assertEqual(result.returncode, 0)

    def test_a_wish_holds_and_is_told_when_asked(self):
        self.assertEqual(self.asked("Hide my location")[0], 0)
        self.assertEqual(self.asked("Who can see me?")[0], 13)
        self.assertTrue(self.service.hides())
        self.assertEqual(self.asked("Share my location")[1]["snippet"]["visible"], True)
        self.assertFalse(self.service.hides())
        code, answer = self.asked("Share my location with Ann until 18:30")
        self.assertEqual(code, 0, answer)
        self.assertIn("Ann Marsh", answer["sentence"])
        self.assertNotEqual(self.asked("Who can see me?")[1]["sentence"], "Nobody can see where you are.")

    def test_it_draws_what_it_answers(self):
        picture = self.folder / "ann.png"
        self.assertEqual(self.run_ask("Where is Ann?", "-o", picture).returncode, 0)
        self.assertEqual(picture.read_bytes()[:8], b"\x89PNG\r\n\x1a\n")

    @staticmethod
    def share_of_bright_pixels(picture):
        """Of a PNG as the program writes it: eight bits a channel, rows without filters."""
        data, at, packed, header = picture.read_bytes(), 8, b"", None
        while at < len(data):
            length, kind = struct.unpack(">I4s", data[at:at + 8])
            content = data[at + 8:at + 8 + length]
            header = struct.unpack(">IIBB", content[:10]) if kind == b"IHDR" else header
            packed += content if kind == b"IDAT" else b""
            at += 12 + length
        width, height, depth, colour = header
        channels = {2: 3, 6: 4}[colour]
        assert depth == 8
        pixels, row = zlib.decompress(packed), 1 + width * channels
        assert all(pixels[line * row] == 0 for line in range(height))
        bright = sum(sum(value > 200 for value in pixels[line * row + 2:(line + 1) * row:channels]) for line in range(height))
        return bright / (width * height)

    def test_what_is_drawn_in_the_dark_is_dark_with_its_map(self):
        picture = self.folder / "dark.png"
        self.assertEqual(self.run_ask("Where is Ann?", "-o", picture, "--dark").returncode, 0)
        self.assertLess(self.share_of_bright_pixels(picture), 0.1)
        self.assertEqual(self.run_ask("Where is Ann?", "-o", picture, "--light").returncode, 0)
        self.assertGreater(self.share_of_bright_pixels(picture), 0.7)
        environment = dict(os.environ, KTR_CONFIG=str(self.folder / "config.json"), XDG_STATE_HOME=str(self.folder / "state"))
        subprocess.run([PROGRAM, "render", "--live", "2s", "--ask", "Where is Ann?", "--dark", "-o", picture], env=environment,
                       check=True, capture_output=True, timeout=120)
        self.assertLess(self.share_of_bright_pixels(picture), 0.1)

    def test_in_another_language(self):
        environment = dict(os.environ, KTR_CONFIG=str(self.folder / "config.json"), XDG_STATE_HOME=str(self.folder / "state"))
        environment.pop("QT_QPA_PLATFORM", None)
        result = subprocess.run([PROGRAM, "ask", "Ann はどこ？", "--language", "ja"], env=environment, capture_output=True,
                                timeout=60, text=True, encoding="utf-8")
        self.assertEqual(result.returncode, 0, result.stderr)
        self.assertIn("Fish Market", result.stdout)
        self.assertTrue(result.stdout.startswith("Ann Marsh："), result.stdout)

    def test_nothing_in_an_answer_steers_the_terminal(self):
        evil = "\x1b[31m\u009b5m\u202egnp"
        (self.folder / "evil.vcf").write_text(
            f"BEGIN:VCARD\nVERSION:3.0\nFN:Ann {evil}\nN:{evil};Ann;;;\nEMAIL:ann.marsh@mail.example\nEND:VCARD\n")
        config = json.loads((self.folder / "config.json").read_text())
        config["contacts"] = ["evil.vcf"]
        (self.folder / "evil.json").write_text(json.dumps(config))
        said = self.run_ask("Where is Ann?", config=self.folder / "evil.json")
        told = self.run_ask("Where is Ann?", "--json", config=self.folder / "evil.json")
        for text in (said.stdout, said.stderr, told.stdout, told.stderr):
            self.assertEqual([c for c in text if c in "\x1b\x7f\u009b\u202e"], [], text)
        self.assertIn("Fish Market", said.stdout)
        self.assertIn(evil, json.loads(told.stdout)["sentence"])

    def test_settings_that_cannot_be_read_are_the_answer(self):
        (self.folder / "broken.json").write_text("{")
        result = self.run_ask("Where is Ann?", config=self.folder / "broken.json")
        self.assertEqual((result.returncode, result.stdout), (15, "Your settings cannot be read.\n"))
        self.assertIn("broken.json:1:", result.stderr)

    def test_nobody_signed_in_and_nobody_there(self):
        self.assertEqual(self.run_ask("Where is Ann?", config=self.folder / "none.json").returncode, 12)
        config = json.loads((self.folder / "config.json").read_text())
        without = {name: value for name, value in config.items() if name != "account"}
        (self.folder / "signed-out.json").write_text(json.dumps(without))
        result = self.run_ask("Where is Ann?", config=self.folder / "signed-out.json")
        self.assertEqual((result.returncode, result.stdout), (15, "Sign in, then I’ll tell you.\n"))
        config["account"]["host"] = "localhost:1"
        (self.folder / "elsewhere.json").write_text(json.dumps(config))
        result = self.run_ask("Where is Ann?", config=self.folder / "elsewhere.json")
        self.assertEqual((result.returncode, result.stdout), (14, "Your service didn’t answer.\n"))


if __name__ == "__main__":
    unittest.main()
