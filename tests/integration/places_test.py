#!/usr/bin/env python3
"""What places are called, from the phone that was there to the row that says so.

  places_test.py SERVICE PROGRAM MAP [unittest options]
"""
import base64
import contextlib
import http.client
import json
import os
import pathlib
import random
import sqlite3
import ssl
import subprocess
import sys
import time
import unittest

from own_service import OwnService
from phone import Phone

SERVICE, PROGRAM, MAP = sys.argv.pop(1), sys.argv.pop(1), sys.argv.pop(1)
SOURCE = pathlib.Path(__file__).resolve().parents[2]
FAR_AWAY = (50.95, -3.90)


def walk():
    """Where Ann walks in the demo town, and in which street that is: away from crossings, where it is in one alone."""
    track = json.loads((SOURCE / "resources/service/friends.json").read_text(encoding="utf-8"))["friends"][0]["track"]
    for before, here, after in zip(track, track[1:], track[2:]):
        if before["street"] == here["street"] == after["street"]:
            yield here["latitude"], here["longitude"], here["street"]


class PlacesTest(unittest.TestCase):
    def setUp(self):
        self.service = OwnService(SERVICE)
        self.addCleanup(self.service.__exit__)
        self.settings(maps=[MAP])
        self.ann = Phone("android", self.service.url, "Ann", self.service.add("Ann"), self.service.authority)
        self.service.add("Mara")

    def settings(self, **members):
        file = self.service.folder / "data" / "settings.json"
        file.write_text(json.dumps({**json.loads(file.read_text()), **members}))

    def share(self, *options):
        self.service.command("share", "Ann", "Mara", *options)
        self.service.earlier()

    def send(self):
        self.assertTrue(self.ann.send())

    def locate(self, latitude, longitude, ago=0):
        self.ann.locate(latitude, longitude, time.time() - ago)
        self.send()

    def location(self, language="en", region="DE"):
        """Ann's, as Mara's answer has it."""
        token = self.service.folder / "mara-token"
        if not token.exists():
            self.service.command("reader", "Mara", "--token-file", str(token))
        connection = http.client.HTTPSConnection(
            "localhost", self.service.port, context=ssl.create_default_context(cafile=self.service.authority), timeout=60)
        connection.request("POST", "/qloxservice/friends/va/getlocations",
                           json.dumps({"clientContext": {"locale": language, "regionCode": region}, "handles": ["ann@x.example"]}),
                           {"Authorization": "Basic " + base64.b64encode(f"Mara:{token.read_text().strip()}".encode()).decode(),
                            "Content-Type": "application/json", "X-Orcha-Seek-API-Ver": "4.0",
                            "X-Orcha-AuthScheme": "Forever"})
        with connection.getresponse() as response:
            answer = json.loads(response.read())
        connection.close()
        return answer["locations"]["ann@x.example"]["location"]

    def test_a_walk_through_the_demo_town_reads_its_streets(self):
        self.share()
        self.service.start()
        places = list(walk())
        self.assertGreater(len(places), 8)
        for number, (latitude, longitude, street) in enumerate(places):
            self.locate(latitude, longitude, ago=1000 - number)
            location = self.location()
            self.assertEqual(location["streetAddress"], street)
            self.assertEqual(location["address"], {"locality": "Brinmouth"})
            self.assertEqual(location["labels"], [{"label": f"{street}, Brinmouth"}])

    def test_the_row_says_the_street(self):
        self.share()
        self.service.start()
        token = self.service.folder / "ktr-token"
        configuration = json.loads(self.service.command("reader", "Mara", "--token-file", str(token)))
        (self.service.folder / "config.json").write_text(json.dumps(configuration))
        (self.service.folder / "ann.json").write_text(json.dumps({"snippet": {
            "kind": "VAKtrLocationSnippet",
            "searchContext": "ktrServerContext://serverContext?clientId=own&minCallbackIntervalInMS=100&",
            "locations": [{"friend": {"data": "ann@x.example", "object": {
                "fullName": "Ann Example", "emails": [{"emailAddress": "ann@x.example"}]}}}]}}))
        environment = {**os.environ, "KTR_CONFIG": str(self.service.folder / "config.json"),
                       "XDG_STATE_HOME": str(self.service.folder / "state"), "QT_QPA_PLATFORM": "offscreen"}
        for place, words in ((next(walk())[:2], f"Place: {next(walk())[2]}, Brinmouth"),
                             (FAR_AWAY, "Place: near Exeter, ")):
            self.locate(*place, ago=0)
            seen = subprocess.run([PROGRAM, "describe", "--live", "3s", str(self.service.folder / "ann.json")],
                                  capture_output=True, text=True, timeout=120, check=False, env=environment)
            self.assertIn(words, seen.stdout, seen.stderr)
            time.sleep(1.1)  # the next place is a later one

    def test_words_are_those_of_who_asks(self):
        self.share()
        self.service.start()
        self.locate(*FAR_AWAY)
        for language, region, words in (("en-GB", "GB", "near Exeter, 24\u00a0mi"), ("de", "DE", "bei Exeter, 38\u00a0km"),
                                        ("ja", "JP", "Exeter付近、38\u00a0km")):
            label = self.location(language, region)["labels"][0]
            self.assertEqual(label, {"label": words, "phrase": True}, language)

    def test_below_exact_no_street_is_said(self):
        self.share("--precision", "town")
        self.service.start()
        latitude, longitude, _ = next(walk())
        slot = int(time.time()) // 900 * 900
        self.locate(latitude, longitude, ago=time.time() - slot + 3000)
        with contextlib.closing(sqlite3.connect(self.service.folder / "data" / "service.db")) as database:
            database.execute("UPDATE fix SET heard = time")
            database.commit()
        location = self.location()
        self.assertNotIn("streetAddress", location)
        self.assertNotIn("Road", json.dumps(location))

    def test_the_owners_name_goes_before_the_street(self):
        self.share()
        self.service.start()
        latitude, longitude, street = next(walk())
        self.locate(latitude, longitude, ago=60)
        self.ann.put({"_type": "waypoint", "desc": "Work", "lat": latitude, "lon": longitude, "rad": 120,
                      "tst": int(time.time())})
        self.send()
        self.assertEqual(self.service.command("places", "Ann"), "Work (work), 120 m, not said\n")
        self.assertEqual(self.location()["streetAddress"], street, "not said to anybody yet")
        self.service.command("place", "Ann", "--name", "Work", "--said")
        self.assertEqual(self.location()["labels"], [{"label": "_$!<work>!$_"}, {"label": "Work"}])
        self.assertNotIn("streetAddress", self.location())
        self.service.command("place", "Ann", "--name", "Work", "--rename", "Boatyard", "--label", "none")
        self.assertEqual(self.location()["labels"], [{"label": "Boatyard"}])
        self.service.command("place", "Ann", "--name", "Boatyard", "--unsaid")
        self.assertEqual(self.location()["streetAddress"], street)

    def test_a_map_that_goes_makes_names_coarser_and_check_says_so(self):
        map_ = self.service.folder / "map.mbtiles"
        map_.write_bytes(pathlib.Path(MAP).read_bytes())
        self.settings(maps=[str(map_)])
        self.assertIn("the store is whole", self.service.command("check"))
        self.share()
        self.service.start()
        self.locate(*next(walk())[:2])
        self.assertIn("streetAddress", self.location())
        for damage in (lambda: map_.write_bytes(random.Random(1).randbytes(100000)), map_.unlink,
                       lambda: os.mkfifo(map_), lambda: (map_.unlink(), map_.mkdir())):
            damage()
            location = self.location()
            self.assertNotIn("streetAddress", location)
            self.assertIn("near ", location["labels"][0]["label"])
            done = subprocess.run([SERVICE, "--data", str(self.service.folder / "data"), "check"], capture_output=True,
                                  text=True, timeout=60, check=False)
            self.assertEqual(done.returncode, 1)
            self.assertIn(f'the map "{map_}" cannot be read: ', done.stderr)

    def test_maps_are_set_by_a_command_while_the_service_runs(self):
        self.service.command("maps", "--none")
        self.assertIn("no map: ", self.service.command("maps"))
        self.share()
        self.service.start()
        latitude, longitude, street = next(walk())
        self.locate(latitude, longitude)
        self.assertNotIn("streetAddress", self.location())
        before = (self.service.folder / "data" / "settings.json").read_bytes()
        fifo = self.service.folder / "fifo"
        os.mkfifo(fifo)
        for wrong in ("/nonexistent.mbtiles", str(self.service.folder), str(fifo), __file__):
            done = subprocess.run([SERVICE, "--data", str(self.service.folder / "data"), "maps", MAP, wrong],
                                  capture_output=True, text=True, timeout=60, check=False)
            self.assertEqual(done.returncode, 1, wrong)
            self.assertIn(f'the map "{wrong}" cannot be read: ', done.stderr)
        self.assertEqual((self.service.folder / "data" / "settings.json").read_bytes(), before, "nothing was changed")
        there = pathlib.Path(MAP).resolve()
        done = subprocess.run([SERVICE, "--data", str(self.service.folder / "data"), "maps", there.name], cwd=there.parent,
                              capture_output=True, text=True, timeout=60, check=False)
        self.assertEqual((done.returncode, done.stdout), (0, f"{there}\n"), done.stderr)
        self.assertEqual(self.location()["streetAddress"], street)
        self.assertEqual(json.loads((self.service.folder / "data" / "settings.json").read_text())["host"], "localhost")
        self.service.command("maps", "--none")
        self.assertNotIn("streetAddress", self.location())

    def test_settings_that_name_no_whole_path_are_refused(self):
        for maps, words in ((["region.mbtiles"], "expected whole paths of files"), ("/region.mbtiles", "a list of strings"),
                            ([7], "a string"), ([""], "")):
            self.settings(maps=maps)
            done = subprocess.run([SERVICE, "--data", str(self.service.folder / "data"), "check"], capture_output=True,
                                  text=True, timeout=60, check=False)
            self.assertEqual(done.returncode, 1, maps)
            self.assertIn(words, done.stderr)
            self.assertIn("maps", done.stderr)


if __name__ == "__main__":
    unittest.main()
