#!/usr/bin/python3
"""Runs `ktr render` and `ktr describe` as a user does, without a display: what they print, write and exit with."""

import json
import os
import pathlib
import struct
import subprocess
import tempfile
import unittest

PROGRAM = os.environ["KTR_PROGRAM"]
SOURCE = pathlib.Path(os.environ["KTR_SOURCE"])
SCENARIOS = SOURCE / "resources" / "scenarios"
PLUGINS = os.environ["KTR_TEST_PLUGINS"]


def run(*arguments, **more):
    environment = {k: v for k, v in os.environ.items() if k not in ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM")}
    environment.update(more)
    result = subprocess.run([PROGRAM, *map(str, arguments)], env=environment, capture_output=True, timeout=120,
                            text=True, encoding="utf-8", errors="replace")
    # Numbers and their units are held together by no-break spaces.
    result.stdout = result.stdout.replace("\u00a0", " ")
    return result


def png_size(path):
    data = path.read_bytes()
    assert data[:8] == b"\x89PNG\r\n\x1a\n", path
    return struct.unpack(">II", data[16:24])


def person(name):
    return {"object": {"fullName": name, "emails": [{"emailAddress": "somebody@harbour.example"}]}}


class ProgramTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def scenario(self, locations, **more):
        path = self.folder / "scenario.json"
        snippet = {"kind": "VAKtrLocationSnippet", "proximity": "", "locations": locations}
        path.write_text(json.dumps({"clock": "2026-05-16T17:42:00+01:00", "language": "en-IE", "snippet": snippet, **more}),
                        encoding="utf-8")
        return path

    def test_numbers_of_a_conversation_have_digits_of_one_kind(self):
        # Four minutes ago.
        friend = {"friend": person("آن"), "latitude": 53.0005, "longitude": -6.0, "locationDate": 800642280,
                  "city": "دبي"}
        for region, language, digits in (("ar-AE", "ar", "0123456789"), ("ar-AE", "ar-AE", "0123456789"),
                                         ("ar-EG", "ar", "٠١٢٣٤٥٦٧٨٩"), ("fa-IR", "fa", "۰۱۲۳۴۵۶۷۸۹")):
            with self.subTest(region=region, language=language):
                path = self.scenario([friend], language=language, region=region,
                                     positions=[{"latitude": 53.0, "longitude": -6.0}])
                result = run("describe", path)
                self.assert_done(result)
                found = {c for c in result.stdout if c.isdigit()}
                self.assertGreater(len(found), 3, result.stdout)
                self.assertLessEqual(found, set(digits), result.stdout)

    def assert_done(self, result):
        self.assertEqual(result.stderr, "")
        self.assertEqual(result.returncode, 0)

    def assert_refused(self, result, code, *words):
        self.assertEqual(result.returncode, code, result.stderr)
        self.assertEqual(result.stdout, "")
        self.assertEqual(result.stderr.count("\n"), 1, result.stderr[:500])
        self.assertLess(len(result.stderr), 1000)
        for word in words:
            self.assertIn(word, result.stderr)

    def test_every_demo_scenario_is_drawn_and_described(self):
        scenarios = sorted(SCENARIOS.glob("*.json"))
        self.assertGreaterEqual(len(scenarios), 8)
        for scenario in scenarios:
            with self.subTest(scenario.name):
                picture = self.folder / (scenario.stem + ".png")
                self.assert_done(run("render", scenario, "-o", picture))
                width, height = png_size(picture)
                on_tablet = json.loads(scenario.read_text(encoding="utf-8")).get("idiom") == "tablet"
                self.assertEqual(width, 1100 if on_tablet else 400)
                self.assertGreater(height, 200)
                described = run("describe", scenario)
                self.assert_done(described)
                self.assertGreater(described.stdout.count("\n"), 3)

    def test_demo_scenarios_fit_their_schema(self):
        try:
            import jsonschema
        except ImportError:
            self.skipTest("python3-jsonschema is not installed")
        schema = json.loads((SOURCE / "docs" / "scenario.schema.json").read_text(encoding="utf-8"))
        jsonschema.Draft202012Validator.check_schema(schema)
        validator = jsonschema.Draft202012Validator(schema)
        for scenario in sorted(SCENARIOS.glob("*.json")):
            with self.subTest(scenario.name):
                errors = list(validator.iter_errors(json.loads(scenario.read_text(encoding="utf-8"))))
                self.assertEqual(errors, [])
        self.assertFalse(validator.is_valid({"snippet": {"kind": "VAKtrLocationSnippet", "locations": [{"latitude": "x"}]}}))
        self.assertFalse(validator.is_valid({}))

    def test_description_reads_in_order(self):
        result = run("describe", SCENARIOS / "dinner.json")
        lines = result.stdout.splitlines()
        self.assertEqual(lines[:4], ["Today, 17:42", "Where are my friends near the harbour?",
                                     "Here are the five nearest.", "Friends"])
        self.assertIn("Ann Marsh", lines[4])
        self.assertTrue(all(line.endswith(" (link)") for line in lines[4:]), lines)
        self.assertEqual(len(lines), 10)

    def test_description_follows_language_and_moment(self):
        self.assertIn("Wo sind meine Freunde am Hafen?", run("describe", SCENARIOS / "dinner.json", "--language", "de").stdout)
        now = run("describe", SCENARIOS / "dinner.json").stdout
        later = run("describe", SCENARIOS / "dinner.json", "--at", "+600").stdout
        self.assertIn("Located 4 minutes ago", now)
        self.assertIn("Located 14 minutes ago", later)
        self.assertEqual(later, run("describe", SCENARIOS / "dinner.json", "--at", "2026-05-16T17:52:00+01:00").stdout)

    def test_distances_follow_the_walk(self):
        place = {"latitude": 50.0, "longitude": -3.0, "ageSeconds": 1, "friend": person("Ann")}
        walk = [{"latitude": 50.01, "longitude": -3.0}, {"at": 60, "latitude": 50.1, "longitude": -3.0}]
        scenario = self.scenario([place], positions=walk, region="en-IE")
        self.assertIn("1.1 km", run("describe", scenario).stdout)
        self.assertIn("11 km", run("describe", scenario, "--at", "+61").stdout)
        unknown = run("describe", self.scenario([place], region="en-IE"))
        self.assert_done(unknown)
        self.assertNotIn("km", unknown.stdout)

    def test_pictures_are_the_same_every_time_in_every_format(self):
        for end in ("png", "svg", "pdf"):
            with self.subTest(end):
                first, second = self.folder / f"1.{end}", self.folder / f"2.{end}"
                for picture in (first, second):
                    self.assert_done(run("render", SCENARIOS / "dinner.json", "-o", picture))
                self.assertGreater(first.stat().st_size, 1000)
                self.assertEqual(first.read_bytes(), second.read_bytes())

    def test_options_change_the_picture(self):
        def drawn(*options):
            picture = self.folder / "a.png"
            self.assert_done(run("render", SCENARIOS / "dinner.json", "-o", picture, *options))
            return png_size(picture), picture.read_bytes()

        plain, plain_bytes = drawn()
        double = drawn("--scale", "2")[0]
        self.assertEqual(double[0], 800)
        # A separator is one pixel thick, so that rows are a little lower in points.
        self.assertAlmostEqual(double[1] / 2, plain[1], delta=5)
        self.assertEqual(drawn("--width", "1100")[0][0], 1100)
        self.assertEqual(drawn("--idiom", "tablet")[0][0], 1100)
        self.assertGreater(drawn("--text-size", "XXXL")[0][1], plain[1])
        for option in ("--dark", "--high-contrast"):
            size, data = drawn(option)
            self.assertEqual(size, plain)
            self.assertNotEqual(data, plain_bytes)
        self.assertEqual(drawn("--light")[1], plain_bytes)
        self.assertNotEqual(drawn("--language", "ar")[1], plain_bytes)

    def test_pictures_beyond_the_limit_are_split_or_refused(self):
        many = [{"latitude": 50.0, "longitude": -3.0, "friend":
                 {"object": {"fullName": f"Friend {i}", "emails": [{"emailAddress": f"f{i}@harbour.example"}]}}}
                for i in range(420)]
        scenario = self.scenario(many)
        picture = self.folder / "many.png"
        self.assert_done(run("render", scenario, "-o", picture))
        self.assertFalse(picture.exists())
        first, second = png_size(self.folder / "many-1.png"), png_size(self.folder / "many-2.png")
        self.assertEqual(first, (400, 32000))
        self.assertLess(second[1], 32000)
        self.assertFalse((self.folder / "many-3.png").exists())
        self.assert_refused(run("render", scenario, "-o", self.folder / "many.pdf"), 4, "32000")
        wide = run("render", SCENARIOS / "dinner.json", "-o", picture, "--width", "8000", "--scale", "8")
        self.assert_refused(wide, 4, "32000")

    def test_kinds_that_are_not_drawn_are_told(self):
        unknown = self.folder / "fence.json"
        unknown.write_text('{"snippet": {"kind": "VAWeatherSnippet"}}')
        self.assert_refused(run("describe", unknown), 4, "VAWeatherSnippet")

    def test_every_text_size_is_drawn(self):
        said = run("describe", SCENARIOS / "dinner.json").stdout
        for size in ["AX1", "AX2", "AX3", "AX4", "AX5"]:
            large = run("describe", SCENARIOS / "dinner.json", "--text-size", size)
            self.assertEqual((large.returncode, large.stderr), (0, ""), size)
            for word in ["Ann", "min"]:
                self.assertEqual(large.stdout.count(word), said.count(word), size)

    def test_broken_scenarios_are_one_line(self):
        bad = {
            "empty": b"", "blank": b" \n", "list": b"[]", "brackets": b"[" * 1_000_000, "objects": b'{"a":' * 1_000_000,
            "truncated": (SCENARIOS / "dinner.json").read_bytes()[:900], "bytes": b'{"snippet": "\xff\xfe"}',
            "type": b'{"snippet": {"kind": "VAKtrLocationSnippet", "locations": [{"latitude": []}]}}', "nul": b"\0" * 100,
            "binary": bytes(range(256)) * 40,
        }
        for name, data in bad.items():
            with self.subTest(name):
                path = self.folder / f"{name}.json"
                path.write_bytes(data)
                self.assert_refused(run("describe", path), 3, f"{name}.json:")
        self.assert_refused(run("describe", self.folder / "absent.json"), 3, "there is no such file")
        self.assert_refused(run("describe", self.folder), 3, "folder")

    def test_huge_scenario_is_refused(self):
        path = self.folder / "huge.json"
        with path.open("wb") as file:
            file.truncate((64 << 20) + 1)
        self.assert_refused(run("describe", path), 3, "64 MiB")

    def test_strange_texts_are_drawn(self):
        names = {
            "long": "x" * 100_000, "bidi": "Ann \u202e hsraM\u202c \u2066\u2067\u2069", "emoji": "👩‍👩‍👧‍👦" * 2000,
            "marks": "e" + "\u0301" * 5000, "lines": "Ann\nMarsh\t\u2028x", "empty": "", "nul": "a\0b",
        }
        for name, text in names.items():
            with self.subTest(name):
                scenario = self.scenario([{"latitude": 50.0, "longitude": -3.0, "label": text, "city": text,
                                           "friend": person(text)}], question=text, sentence=text[:1000])
                picture = self.folder / "strange.png"
                self.assert_done(run("render", scenario, "-o", picture))
                self.assert_done(run("describe", scenario))

    def test_plugins_that_cannot_be_used_are_told(self):
        no_library = self.folder / "no.so"
        no_library.write_text("text")
        for plugin, word in ((self.folder / "absent.so", "there is no such plugin"), (no_library, "cannot be loaded"),
                             (PLUGINS + "foreign.so", "no ktr_plugin_query"), (PLUGINS + "old.so", "ABI number")):
            with self.subTest(str(plugin)):
                self.assert_refused(run("describe", SCENARIOS / "dinner.json", "--plugin", plugin), 5, word)
                self.assert_refused(run("describe", SCENARIOS / "dinner.json", KTR_PLUGIN=str(plugin)), 5, word)

    def test_what_cannot_be_done_is_told(self):
        self.assert_refused(run("render", SCENARIOS / "dinner.json", "-o", "/nowhere/at/all.png"), 1, "/nowhere/at/all.png")
        self.assert_refused(run("describe", self.scenario([], contacts="nobody.vcf")), 1, "nobody.vcf")
        self.assert_refused(run("show", SCENARIOS / "dinner.json"), 1, "display")
        self.assert_refused(run("show", SCENARIOS / "dinner.json", DISPLAY=":987"), 1, "ktr: ")
        self.assert_refused(run("describe", SCENARIOS / "dinner.json", "--at", "2020-01-01T00:00Z"), 2, "--at")
        self.assert_refused_word("rendr", 'did you mean "render"?')
        self.assert_refused_word("frobnicate", "there is no command")

    def test_help_that_cannot_be_written_is_a_failure(self):
        for arguments in (["--help"], ["--version"], ["render", "--help"]):
            with open("/dev/full", "w", encoding="utf-8") as full:
                ended = subprocess.run([PROGRAM, *arguments], stdout=full, stderr=subprocess.PIPE, text=True, timeout=60,
                                       check=False)
            self.assertEqual(ended.returncode, 1, arguments)
            self.assertEqual(ended.stderr, "ktr: the answer cannot be written\n")

    def assert_refused_word(self, word, expected):
        result = run(word)
        self.assertEqual(result.returncode, 2)
        self.assertIn(expected, result.stderr)

    def test_a_slip_is_told_and_the_rest_is_done(self):
        told = run("describe", self.scenario([], langauge="de"))
        self.assertEqual(told.returncode, 0)
        self.assertEqual(told.stderr.count("\n"), 1, told.stderr)
        self.assertIn('$.langauge: there is no such member, it is passed over; did you mean "language"?', told.stderr)
        told = run("describe", self.scenario([]), "--language", "klingon")
        self.assertEqual(told.returncode, 0)
        self.assertIn('there are no texts in the language "klingon"; they are English', told.stderr)
        self.assert_done(run("describe", self.scenario([]), "--language", "de-AT"))

    def test_nothing_in_an_error_steers_the_terminal(self):
        for bad in ("\x1b[31m", "\u009b2J", "\x7f", "\u202e", "\r", "\u2067"):
            scenario = self.folder / f"a{bad}.json"
            scenario.write_text(json.dumps({"snippet": {"kind": f"VA{bad}View"}}), encoding="utf-8")
            for arguments in (("describe", scenario), ("describe", self.folder / f"b{bad}"), (f"describ{bad}",),
                              ("describe", "a.json", f"--{bad}"), ("render", scenario, "-o", f"{bad}.gif"),
                              ("describe", SCENARIOS / "dinner.json", "--plugin", self.folder / f"c{bad}"),
                              ("serve", "--friends", self.folder / f"d{bad}"), ("serve", "--fault", f"{bad}=1")):
                with self.subTest(repr(arguments)):
                    result = run(*arguments)
                    self.assertNotEqual(result.returncode, 0)
                    self.assertTrue(result.stderr.startswith("ktr: "), result.stderr)
                    self.assertNotIn(bad, result.stdout + result.stderr)

    def test_a_full_disk_leaves_the_good_picture(self):
        scenario = SCENARIOS / "forty-friends.json"
        for name in ("a.png", "a.svg", "a.pdf"):
            with self.subTest(name):
                picture = self.folder / name
                picture.write_bytes(b"the good old one")
                limited = subprocess.run(["bash", "-c", 'trap "" XFSZ; ulimit -f 4; exec "$@"', "-", PROGRAM, "render",
                                          scenario, "-o", picture], capture_output=True, text=True, timeout=120)
                self.assertEqual(limited.returncode, 1, limited.stderr)
                self.assertIn(f"{picture}: cannot be written: File too large", limited.stderr)
                self.assertEqual(picture.read_bytes(), b"the good old one")
                self.assertEqual([entry.name for entry in self.folder.iterdir()], [name])
                picture.unlink()

    def test_pieces_are_all_there_or_none(self):
        last = self.folder / "a-2.png"
        os.mkfifo(last)
        many = [{"latitude": 50.0, "longitude": -3.0, "friend":
                 {"object": {"fullName": f"Friend {i}", "emails": [{"emailAddress": f"f{i}@harbour.example"}]}}}
                for i in range(420)]
        arguments = ("render", self.scenario(many), "-o", self.folder / "a.png")
        self.assert_refused(run(*arguments), 1, f"{last}: cannot be written: this is a pipe, not a file")
        self.assertEqual(sorted(entry.name for entry in self.folder.iterdir()), ["a-2.png", "scenario.json"])
        last.unlink()
        self.assert_done(run(*arguments))
        self.assertEqual(sorted(entry.name for entry in self.folder.iterdir()), ["a-1.png", "a-2.png", "scenario.json"])

    def test_a_pipe_or_a_device_is_never_replaced(self):
        pipe, device = self.folder / "pipe.png", self.folder / "device.png"
        os.mkfifo(pipe)
        device.symlink_to("/dev/null")
        for place, what in ((pipe, "a pipe"), (device, "a device")):
            self.assert_refused(run("render", SCENARIOS / "single.json", "-o", place), 1, f"this is {what}, not a file")
        self.assertTrue(pipe.is_fifo())
        self.assertTrue(pathlib.Path("/dev/null").is_char_device())

    def test_few_descriptors_are_no_signal(self):
        for count in (6, 10, 16, 28):
            for command in (("describe", SCENARIOS / "single.json"), ("serve", "--ca-dir", self.folder / "ca"),
                            ("render", SCENARIOS / "single.json", "-o", self.folder / "a.png")):
                with self.subTest(count=count, command=command[0]):
                    few = subprocess.run(["bash", "-c", f'ulimit -n {count}; exec "$@"', "-", PROGRAM, *command],
                                         capture_output=True, text=True, timeout=120)
                    self.assert_refused(few, 1, "too few files may be open at a time")

    def test_what_others_may_change_is_not_served_from(self):
        open_folder = self.folder / "open"
        open_folder.mkdir()
        open_folder.chmod(0o777)
        self.assert_refused(run("serve", "--ca-dir", open_folder), 1, "others may write its folder", "chmod go-w")
        self.assert_refused(run("serve", "--ca-dir", open_folder / "below"), 1, "others may write its folder")
        own = self.folder / "own"
        own.mkdir(mode=0o700)
        (own / "ca.pem").mkdir()
        self.assert_refused(run("serve", "--ca-dir", own), 1, "ca.pem: this is a folder, not a file")
        (own / "ca.pem").rmdir()
        (own / "ca-key.pem").write_text("x")
        (own / "ca-key.pem").chmod(0o666)
        self.assert_refused(run("serve", "--ca-dir", own), 1, "ca-key.pem: others may write it (mode 0666)")

    def test_names_stay_out_of_the_log(self):
        quiet = run("describe", SCENARIOS / "dinner.json", KTR_LOG="debug")
        self.assertNotIn("harbour.example", quiet.stderr)
        self.assertNotEqual(quiet.stderr, "")


if __name__ == "__main__":
    unittest.main()
