"""Who comes and goes, from a phone's posts to `ktr watch`: nothing is told twice, nothing is lost, whatever is killed when."""
import json
import os
import pathlib
import random
import signal
import sqlite3
import subprocess
import sys
import time
import unittest

from service_program import COMMANDS, ServiceProgram

SERVICE, KTR = sys.argv[1:3]
# Metres along a meridian at this latitude, to a thousandth.
DEGREE = 111230.0
WORK, HOME = (50.2171, -3.1118), (50.2400, -3.1118)


class Watch:
    """`ktr watch --print`, with a state folder of its own."""

    def __init__(self, case, service, person):
        self.case, self.folder = case, service.folder / f"watch-{person}"
        (self.folder / "config").mkdir(parents=True)
        token = self.folder / "token"
        configuration = service.command("reader", person, "--token-file", str(token))
        self.secret = token.read_text().strip()
        file = self.folder / "config" / "config.json"
        file.write_text(configuration[configuration.index("{"):configuration.rindex("}") + 1])
        file.chmod(0o600)
        self.out = self.folder / "out"
        self.out.touch()
        self.process = None
        case.addCleanup(self.kill)

    def start(self):
        environment = {**os.environ, "KTR_CONFIG": str(self.folder / "config" / "config.json"),
                       "XDG_STATE_HOME": str(self.folder / "state"), "DBUS_SESSION_BUS_ADDRESS": "unix:path=/nonexistent",
                       "DBUS_SYSTEM_BUS_ADDRESS": "unix:path=/nonexistent"}
        with open(self.out, "ab") as out, open(self.folder / "err", "ab") as err:
            self.process = subprocess.Popen([KTR, "watch", "--print"], stdout=out, stderr=err, env=environment)

    def kill(self):
        if self.process is not None and self.process.poll() is None:
            self.process.send_signal(signal.SIGKILL)
        if self.process is not None:
            self.process.wait()

    def lines(self):
        return self.out.read_text().splitlines()

    def wait_for(self, number, seconds=60):
        """Until so many crossings were printed; what was."""
        end = time.monotonic() + seconds
        while time.monotonic() < end and len({line.split()[0] for line in self.lines()}) < number:
            time.sleep(0.05)
        return self.lines()


class WatchTest(unittest.TestCase):
    def setUp(self):
        self.service = ServiceProgram(self, SERVICE)
        self.phone = self.service.add("Ann")
        self.service.add("Otto")
        self.service.command("place", "Ann", "--name", "Office", "--label", "work", "--said", "--at", f"{WORK[0]},{WORK[1]}")
        self.service.command("place", "Ann", "--name", "Home", "--label", "home", "--said", "--at", f"{HOME[0]},{HOME[1]}")
        self.service.command("share", "Ann", "Otto", "--fences")
        self.watch = Watch(self, self.service, "Otto")
        # As if all was agreed hours ago: hours of walking then take no time.
        database = sqlite3.connect(self.service.folder / "data" / "service.db")
        database.execute("UPDATE share SET since = since - 14400")
        database.commit()
        database.close()
        self.clock = int(time.time()) - 12000
        self.service.start()

    def ask(self, path, **body):
        return self.service.request("POST", COMMANDS + path, json.dumps({"clientContext": {}, **body}), False,
                                    ("Otto", self.watch.secret), **{
                                        "Content-Type": "application/json", "X-Orcha-Seek-API-Ver": "4.0",
                                        "X-Orcha-AuthScheme": "Forever"})

    def fence(self, trigger, place, once):
        status, answer = self.ask("setFence", handle="ann@x.example", trigger=trigger, once=once, place={"name": place})
        self.assertEqual(status, 200, answer)

    def is_at(self, place, north=0.0, seconds=31):
        """Posts until the service has it, as phones do."""
        self.clock += seconds
        for _ in range(400):
            try:
                status, _ = self.service.post("Ann", self.phone, _type="location", lat=place[0] + north / DEGREE,
                                              lon=place[1], tst=self.clock, acc=10, tid="an")
                if status == 200:
                    return
            except OSError:
                pass
            time.sleep(0.05)
        self.fail("the service does not come back")

    def test_walk_from_work_to_home_is_one_leaving_and_one_arrival_and_no_other_word(self):
        self.is_at(WORK, seconds=1)
        self.fence("OnDeparture", "work", True)
        self.fence("OnArrival", "home", True)
        self.watch.start()
        metres = (HOME[0] - WORK[0]) * DEGREE
        for step in range(1, 10):
            self.is_at(WORK, metres * step / 9)
        self.is_at(HOME, 5.0, 5)
        lines = self.watch.wait_for(2)
        time.sleep(1.0)
        self.assertEqual(self.watch.lines(), lines)
        self.assertEqual([line.split("  ")[2] for line in lines], ["Ann left: Office", "Ann arrived: Home"])
        self.assertEqual([line.split()[0] for line in lines], ["1", "2"])
        status, left = self.ask("fences")
        self.assertEqual((status, json.loads(left)["fences"]), (200, []))

    def test_revoked_grant_stops_at_once(self):
        self.is_at(WORK, seconds=1)
        self.fence("OnDeparture", "work", False)
        self.fence("OnArrival", "work", True)
        seen = self.service.command("fences", "Ann")
        self.assertIn('  Otto is told when Ann leaves "Office", 150 m, always, since ', seen)
        self.assertIn('  Otto is told when Ann arrives at "Office", 150 m, once, since ', seen)
        arriving = next(line.split()[0] for line in seen.splitlines() if "arrives" in line)
        self.service.command("fences", "Ann", "--end", arriving)
        self.assertEqual(self.service.command("fences", "Ann").count("Otto"), 1)
        self.service.command("fences", "Ann", "--end", "2", fails=True)
        self.is_at(HOME)
        self.is_at(HOME)
        self.service.command("revoke", "Ann", "Otto")
        self.watch.start()
        time.sleep(2.0)
        self.assertEqual(self.watch.lines(), [])
        self.assertIn("nobody with this handle lets you be told", self.ask(
            "setFence", handle="ann@x.example", trigger="OnArrival", place={"name": "home"})[1])

    def test_killed_at_any_moment_each_is_told_once_and_in_order(self):
        kills = 200 if os.environ.get("KTR_LONG_TESTS") else 10
        chance = random.Random(7)
        self.is_at(WORK, seconds=1)
        self.fence("OnArrival", "work", False)
        self.watch.start()
        made = 0
        for number in range(kills):
            # On foot: nobody leaps there and back.
            self.is_at(WORK, 500.0, 10)
            self.is_at(WORK, 500.0)
            if number % 2 == 0:
                self.service.process.send_signal(signal.SIGKILL)
                self.service.process.wait()
                self.service.start()
            self.is_at(WORK, seconds=10)
            made += 1
            time.sleep(chance.random() * 0.3)
            if number % 2 == 1:
                self.watch.kill()
                self.watch.start()
        lines = self.watch.wait_for(made)
        numbers = [int(line.split()[0]) for line in lines]
        self.assertEqual(sorted(set(numbers)), list(range(1, made + 1)), "nothing is lost")
        self.assertEqual(numbers, sorted(numbers), "in order")
        # What was printed when the program was killed before it had written so down is known by its number.
        again = [number for at, number in enumerate(numbers) if number in numbers[:at]]
        self.assertLessEqual(len(again), kills // 2)
        heard = int((self.watch.folder / "state" / "ktr" / "watch").read_text())
        self.assertIn(heard, (made, made - 1))


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1] + sys.argv[3:])
