#!/usr/bin/env python3
"""What a phone was told is kept: the service ends at any moment, its database server as well. 10 moments on SQLite;
with KTR_LONG_TESTS=1 200, and 200 on PostgreSQL.

  kill_test.py SERVICE [unittest options]
"""
import concurrent.futures
import http.client
import os
import random
import sqlite3
import sys
import threading
import time
import unittest

import postgres
from service_program import ServiceProgram

SERVICE = sys.argv.pop(1)
LONG = bool(os.environ.get("KTR_LONG_TESTS"))
MOMENTS = 200 if LONG else 10


class Posting:
    """Phones that post, one fix after the other, until they are told to end; and what they were told."""

    def __init__(self, service, people, first):
        self.service, self.people = service, people
        self.kept, self.refused = set(), 0
        self.next = first
        self.lock = threading.Lock()
        self.ending = False

    def number(self):
        with self.lock:
            self.next += 1
            return self.next

    def post(self, name, secret):
        while not self.ending:
            time_of_fix = self.number()
            try:
                status = self.service.post(name, secret, True, _type="location", lat=50, lon=-3, tst=time_of_fix, acc=9)[0]
            except (OSError, http.client.HTTPException):
                time.sleep(0.01)
                continue
            with self.lock:
                if status == 200:
                    self.kept.add(time_of_fix)
                else:
                    assert status == 503, status
                    self.refused += 1

    def __enter__(self):
        self.pool = concurrent.futures.ThreadPoolExecutor(len(self.people))
        self.futures = [self.pool.submit(self.post, name, secret) for name, secret in self.people]
        return self

    def __exit__(self, *_):
        self.ending = True
        self.pool.shutdown()
        for future in self.futures:
            future.result()

    def waits_for_more(self, count, patience=60):
        deadline = time.monotonic() + patience
        more = len(self.kept) + count
        while len(self.kept) < more:
            assert time.monotonic() < deadline, "nothing is kept any more"
            time.sleep(0.02)


class Killed:
    """What holds for either store."""

    def prepare(self, **options):
        self.service = ServiceProgram(self, SERVICE, **options)
        self.people = [(name, self.service.add(name)) for name in ("Ann", "Otto", "Mara", "Lea")]
        self.random = random.Random(20261122)

    def serve(self):
        self.service.start("--socket", self.service.socket)

    def end(self):
        self.service.process.kill()
        self.service.process.wait()

    def test_what_was_acknowledged_is_kept(self):
        self.prepare()
        kept = set()
        moments = 0
        for moment in range(MOMENTS):
            self.serve()
            with Posting(self.service, self.people, int(time.time()) - 100000 + moment * 400) as posting:
                time.sleep(self.random.uniform(0.02, 0.3))
                self.end()
            moments += 1 if posting.kept else 0
            kept |= posting.kept
        self.assertGreater(moments, MOMENTS // 3, "else nothing was tried")
        self.assertEqual(kept - self.times(), set())
        self.serve()
        self.assertIn("the store is whole", self.service.command("check"))
        self.service.stop()


class SqliteTest(Killed, unittest.TestCase):
    def times(self):
        database = sqlite3.connect(self.service.folder / "data" / "service.db")
        self.addCleanup(database.close)
        return {row[0] for row in database.execute("SELECT time FROM fix")}


@unittest.skipUnless(LONG, "starts a database server: KTR_LONG_TESTS=1 does")
class PostgresTest(Killed, unittest.TestCase):
    def prepare(self, **_):
        self.assertIsNotNone(postgres.programs(), "there is no PostgreSQL server here")
        self.server = postgres.Postgres(self)
        super().prepare(store=self.server.address)

    def times(self):
        return {int(time_of_fix) for time_of_fix in self.server.rows("SELECT time FROM fix")}

    def test_server_that_starts_again_loses_nothing(self):
        self.prepare()
        self.serve()
        with Posting(self.service, self.people, int(time.time()) - 100000) as posting:
            for _ in range(5):
                posting.waits_for_more(50)
                self.server.stop()
                refused, deadline = posting.refused, time.monotonic() + 60
                while posting.refused == refused:
                    self.assertLess(time.monotonic(), deadline, "nobody is told")
                    time.sleep(0.02)
                self.server.start()
                posting.waits_for_more(50)  # by itself
        self.assertEqual(posting.kept - self.times(), set())
        self.service.stop()


if __name__ == "__main__":
    unittest.main(warnings="ignore")
