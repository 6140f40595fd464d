#!/usr/bin/python3
"""The maps that a picture is drawn on: those in configured files, what is said of the others, how dense they are where a picture is
not one of pixels, and a place beyond all of them."""

import base64
import json
import os
import pathlib
import re
import struct
import subprocess
import tempfile
import unittest
import zlib

from map_file import MAGENTA, PLACE, write_region

PROGRAM = os.environ["KTR_PROGRAM"]
SCENARIOS = pathlib.Path(os.environ["KTR_SOURCE"]) / "resources" / "scenarios"


def pixels_of(picture):
    """All that a picture of ktr's says of its pixels: it filters no row."""
    data, at, packed = picture.read_bytes(), 8, b""
    while at < len(data):
        length, kind = struct.unpack(">I4s", data[at:at + 8])
        packed += data[at + 8:at + 8 + length] if kind == b"IDAT" else b""
        at += length + 12
    return zlib.decompress(packed)


class MapsTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.config = self.folder / "config.json"
        scenario = json.loads((SCENARIOS / "single.json").read_text(encoding="utf-8"))
        location = scenario["snippet"]["locations"][0]
        location["latitude"], location["longitude"] = PLACE
        scenario["contacts"] = str(SCENARIOS / "contacts")
        del scenario["positions"]
        self.scenario = self.folder / "scenario.json"
        self.scenario.write_text(json.dumps(scenario), encoding="utf-8")

    def draw(self, name="a.png", scenario=None):
        """The picture, and what was said."""
        picture = self.folder / name
        result = subprocess.run([PROGRAM, "render", scenario or self.scenario, "-o", picture, "--light"], capture_output=True,
                                text=True, check=False,
                                env={**os.environ, "KTR_CONFIG": str(self.config), "XDG_DATA_HOME": str(self.folder / "data")})
        self.assertEqual(result.returncode, 0, result.stderr)
        return picture, result.stderr

    def test_a_picture_is_drawn_on_the_configured_files(self):
        picture, said = self.draw()
        self.assertEqual(said, "")
        self.assertNotIn(MAGENTA * 20, pixels_of(picture))
        self.config.write_text(json.dumps({"maps": {"sources": [{"file": str(write_region(self.folder / "region.mbtiles")), "attribution": "© Somebody"}]}}))
        picture, said = self.draw()
        self.assertEqual(said, "")
        self.assertIn(MAGENTA * 20, pixels_of(picture))

    def test_what_is_not_used_is_said_and_the_picture_comes_all_the_same(self):
        gone = str(self.folder / "gone.mbtiles")
        address = "https://tiles.example/{z}/{x}/{y}.png"
        self.config.write_text(json.dumps({"maps": {"sources": [{"url": address, "attribution": "-"}, {"file": gone}]}}))
        _, said = self.draw()
        self.assertIn(f'warning: the map "{address}" is not used: nothing is fetched here', said)
        self.assertIn(f'warning: the map "{gone}" is not there', said)
        self.config.write_text("{")
        _, said = self.draw()
        self.assertIn("warning: the configured maps are not used: ", said)
        self.assertEqual(said.count("\n"), 1)
        self.config.unlink()
        self.config.symlink_to(self.config)
        _, said = self.draw()
        self.assertIn("warning: the configured maps are not used: ", said)
        self.assertEqual(said.count("\n"), 1)

    def test_map_that_is_a_folder_is_called_no_file_and_not_missing(self):
        self.config.write_text(json.dumps({"maps": {"sources": [{"file": str(self.folder), "attribution": "-"}]}}))
        _, said = self.draw()
        self.assertIn(f"The map {self.folder} cannot be read: not a file", said)
        self.assertEqual(said.count("\n"), 1)

    def test_a_place_beyond_all_streets_has_a_town_on_its_map(self):
        drawing, said = self.draw("a.svg")
        self.assertEqual(said, "")
        # The names stand in a picture of their own: all of it is clear but "Berlin".
        names = self.pictures_in(drawing)[-2]
        clear, inked = names.count(b"\x00\x00\x00\x00"), len(names) // 4
        self.assertGreater(clear, inked * 0.9)
        self.assertLess(clear, inked - 1000)

    @staticmethod
    def pictures_in(drawing):
        """The unpacked pictures in an SVG file, unfiltered or not."""
        found = []
        for data in re.findall(r'xlink:href="data:image/png;base64,([^"]*)"', drawing.read_text(encoding="utf-8")):
            picture = base64.b64decode(data)
            packed, at = b"", 8
            while at < len(picture):
                length, kind = struct.unpack(">I4s", picture[at:at + 8])
                packed += picture[at + 8:at + 8 + length] if kind == b"IDAT" else b""
                at += length + 12
            found.append(zlib.decompress(packed))
        return found

    def test_maps_in_vector_pictures_are_three_times_as_dense(self):
        size = (3 * 376, 3 * 219)
        drawing, _ = self.draw("a.svg", SCENARIOS / "single.json")
        sizes = [struct.unpack(">II", base64.b64decode(data)[16:24]) for data in
                 re.findall(r'xlink:href="data:image/png;base64,([^"]*)"', drawing.read_text(encoding="utf-8"))]
        self.assertIn(size, sizes)
        page, _ = self.draw("a.pdf", SCENARIOS / "single.json")
        self.assertRegex(page.read_bytes(), b"/Width %d\\s*/Height %d" % size)


if __name__ == "__main__":
    unittest.main()
