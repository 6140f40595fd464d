#!/usr/bin/env python3
"""The demo town's map, and whether everybody in the scenarios and in the demo service stands on its ground.

  demo_map_test.py BRINMOUTH.mbtiles
"""
import gzip
import json
import math
import pathlib
import re
import sqlite3
import subprocess
import sys
import tempfile
import unittest

sys.dont_write_bytecode = True
ROOT = pathlib.Path(__file__).resolve().parents[2]
sys.path.insert(0, str(ROOT / "scripts"))

from demo_map import shapes, tiles, town  # noqa: E402

HOME = 50.2104, -3.12
SHORTBREAD = {"ocean", "water_polygons", "water_polygons_labels", "water_lines", "water_lines_labels", "land", "streets",
              "street_labels", "street_polygons", "buildings", "pier_polygons", "pier_lines", "boundaries", "place_labels", "pois",
              "public_transport"}
MAP = None


def layers(tile):
    """Name and length of each layer of a tile."""
    at = 0
    while at < len(tile):
        assert tile[at] == 3 << 3 | 2
        size, shift, at = 0, 0, at + 1
        while True:
            size |= (tile[at] & 0x7F) << shift
            shift, at = shift + 7, at + 1
            if tile[at - 1] < 0x80:
                break
        body = tile[at:at + size]
        name = re.match(rb"\x78\x02\x0a(.)", body, re.DOTALL).group(1)[0]
        yield body[4:4 + name].decode(), size
        at += size


class DemoMapTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.tiles = tiles.Tileset(*HOME)
        cls.town = town.Town(cls.tiles)
        cls.town.build()
        cls.base = sqlite3.connect(f"file:{MAP}?mode=ro", uri=True)
        cls.facts = dict(cls.base.execute("SELECT name, value FROM metadata"))

    def metres(self, latitude, longitude):
        radius = 6378137.0
        return (math.radians(longitude - HOME[1]) * radius * math.cos(math.radians(HOME[0])),
                math.radians(latitude - HOME[0]) * radius)

    def check_place(self, latitude, longitude, what):
        west, south, east, north = map(float, self.facts["bounds"].split(","))
        self.assertTrue(south < latitude < north and west < longitude < east, f"{what} is off the map")
        point = self.metres(latitude, longitude)
        on_pier = any(shapes.inside(pier, point) for pier in self.town.piers)
        dry = self.town.is_land(point) or on_pier or self.town.roads.distance(point) < 12
        self.assertTrue(dry, f"{what} is in the water, at {point}")

    def test_friends_of_the_scenarios_stand_on_land(self):
        seen = 0
        for path in sorted((ROOT / "resources/scenarios").glob("*.json")):
            scenario = json.loads(path.read_text(encoding="utf-8"))
            snippet = scenario["snippet"]
            places = scenario.get("positions", []) + (snippet.get("locations") or [])
            if "cueKtrGeoFence" in snippet:
                places.append(snippet["cueKtrGeoFence"]["location"])
            for place in places:
                # Who is in another country, or nowhere, is not on this map.
                if "latitude" in place and math.hypot(*self.metres(place["latitude"], place["longitude"])) < 100000:
                    self.check_place(place["latitude"], place["longitude"], f"{path.name}: {place.get('label', 'somebody')}")
                    seen += 1
        self.assertGreater(seen, 60)

    def test_served_friends_keep_to_the_streets(self):
        served = json.loads((ROOT / "resources/service/friends.json").read_text(encoding="utf-8"))
        for friend in served["friends"]:
            track = [(stop["latitude"], stop["longitude"]) for stop in friend["track"]]
            for here, after in zip(track, track[1:] or track):
                for share in (0, 0.25, 0.5, 0.75):
                    latitude, longitude = shapes.between(here, after, share)
                    self.check_place(latitude, longitude, friend["fullName"])
                    if len(track) > 1:
                        self.assertLess(self.town.roads.distance(self.metres(latitude, longitude)), 10, friend["fullName"])

    def test_the_walk_is_on_land(self):
        text = (ROOT / "resources/service/walk.gpx").read_text(encoding="utf-8")
        points = re.findall(r'lat="([^"]+)" lon="([^"]+)"', text)
        self.assertGreater(len(points), 10)
        for latitude, longitude in points:
            self.check_place(float(latitude), float(longitude), "the walk")

    def test_places_of_the_scenarios_are_on_the_map(self):
        names = set()
        for _, _, _, attributes, _, _ in self.tiles.features:
            names.add(attributes.get("name"))
        for name in ("Fish Market", "Fish Quay", "Ferry Pier", "Lantern Park", "Ropewalk", "Brinmouth", "Harbour", "River Brin"):
            self.assertIn(name, names)
        served = json.loads((ROOT / "resources/service/friends.json").read_text(encoding="utf-8"))
        for friend in served["friends"]:
            for stop in friend["track"]:
                self.assertIn(stop["street"], names)
                self.assertIn(stop["city"], names)

    def test_main_names_are_in_four_languages(self):
        named = {attributes["name"]: attributes for _, _, _, attributes, _, _ in self.tiles.features if "name" in attributes}
        for name in ("Fish Market", "Quay Road", "Lantern Park", "Harbour"):
            self.assertEqual({"name_en", "name_de", "name_ar", "name_ja"} - set(named[name]), set(), name)

    def test_the_file_is_small_and_in_the_schema(self):
        self.assertLess(pathlib.Path(MAP).stat().st_size, 1 << 20)
        self.assertTrue(self.facts["attribution"])
        self.assertEqual(self.facts["format"], "pbf")
        rows = self.base.execute("SELECT zoom_level, tile_data FROM tiles").fetchall()
        self.assertEqual({level for level, _ in rows}, set(range(6, 15)))
        for level, data in rows:
            found = [name for name, _ in layers(gzip.decompress(data))]
            self.assertEqual(set(found) - SHORTBREAD, set())
            self.assertEqual(len(found), len(set(found)))
            self.assertIn("ocean" if level < 9 else found[0], found)

    def test_the_streets_of_dinner_are_in_its_tile(self):
        x, y = self.tiles.world(200, 60)
        column, row = int(x * (1 << 14)), int(y * (1 << 14))
        data, = self.base.execute("SELECT tile_data FROM tiles WHERE zoom_level = 14 AND tile_column = ? AND tile_row = ?",
                                  (column, (1 << 14) - 1 - row)).fetchone()
        tile = gzip.decompress(data)
        for name in ("Quay Road", "Fish Quay", "Lantern Street", "سوق السمك"):
            self.assertIn(name.encode(), tile)
        self.assertGreater(dict(layers(tile))["buildings"], 5000)

    def test_it_is_the_same_every_time(self):
        with tempfile.TemporaryDirectory() as folder:
            again = pathlib.Path(folder) / "again.mbtiles"
            subprocess.run([ROOT / "scripts/make-demo-map", again], check=True, capture_output=True)
            self.assertEqual(again.read_bytes(), pathlib.Path(MAP).read_bytes())


if __name__ == "__main__":
    MAP = sys.argv.pop(1)
    unittest.main()
