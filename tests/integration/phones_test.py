#!/usr/bin/env python3
"""Many phones of both kinds against a service of one's own: each answer is one that they can take, and shows each friend once.

  phones_test.py SERVICE [unittest options]
"""
import base64
import concurrent.futures
import random
import struct
import sys
import time
import unittest
import zlib

from own_service import OwnService
from phone import PRIVATE, SCHEMA, Phone, other_messages

SERVICE = sys.argv.pop(1)
PEOPLE, ROUNDS = 50, 40
# Two by two grey pixels.
PNG = base64.b64decode("iVBORw0KGgoAAAANSUhEUgAAAAIAAAACCAAAAABX3VL4AAAAC0lEQVR4nGNgAAEAAAYAAf6MZ8gAAAAASUVORK5CYII=")


class PhonesTest(unittest.TestCase):
    def setUp(self):
        self.service = OwnService(SERVICE)
        self.addCleanup(self.service.__exit__)

    def phone(self, kind, name, key=None):
        password = self.service.add(name, *(["--key", key] if key else []))
        phone = Phone(kind, self.service.url, name, password, self.service.authority, key)
        self.addCleanup(phone.close)
        return phone

    def assert_sound(self, phone):
        """Every answer so far is one that either phone takes."""
        for answer in phone.answers:
            SCHEMA.validate(answer)
            self.assertFalse([one for one in answer if one["_type"] == "transition"], phone.user)
        self.assertEqual(phone.lost, 0)
        self.assertEqual(phone.alerts, [])

    def test_two_thousand_posts_of_fifty_accounts(self):
        # Names that begin alike: two letters tell nobody apart.
        phones = [self.phone("android" if number % 2 else "ios", f"Ann{number}", "a key" if number % 5 == 0 else None)
                  for number in range(PEOPLE)]
        friends = {phone.user: set() for phone in phones}
        for number, phone in enumerate(phones):
            for step in (1, 7):
                other = phones[(number + step) % PEOPLE]
                self.service.command("friend", phone.user, other.user)
                friends[phone.user].add(other.user)
                friends[other.user].add(phone.user)
        self.service.earlier()
        self.service.start()
        posts = 0

        def turn(phone, number):
            if number % 3 == 1:
                phone.put(other_messages(number // 3 + phones.index(phone)))
            else:
                phone.locate(50 + random.random(), -3 - random.random(), time.time() - 600 + number,
                             trigger="p" if number % 10 == 9 else "u", acc=number % 4)
            return phone.send()

        with concurrent.futures.ThreadPoolExecutor(8) as pool:
            for number in range(ROUNDS):
                done = list(pool.map(lambda phone, number=number: turn(phone, number), phones))
                self.assertEqual(done, [True] * PEOPLE)
                posts += len(done)
        self.assertEqual(posts, 2000)
        self.assertEqual(sum(len(phone.answers) for phone in phones), 2000)
        for phone in phones:
            self.assert_sound(phone)
            self.assertEqual(set(phone.contacts), {f"owntracks/http/{name}" for name in friends[phone.user]})
            self.assertEqual({phone.shown(identity) for identity in phone.contacts}, friends[phone.user])
            cards = [one["tid"] for answer in phone.answers for one in answer if one["_type"] == "card"]
            self.assertEqual(sorted(cards), sorted(friends[phone.user]), "a card comes once")
        self.service.stop()
        kept = self.service.bytes()
        for word in PRIVATE:
            self.assertNotIn(word.encode(), kept)

    def test_faces_travel_without_anything_but_the_picture(self):
        ann, otto, zoe = self.phone("android", "Ann"), self.phone("ios", "Otto", "a key"), self.phone("android", "Zoe")
        self.service.command("friend", "Ann", "Otto")
        self.service.command("friend", "Ann", "Zoe")
        self.service.earlier()
        self.service.start()
        ann.locate(50, -3)
        self.assertTrue(ann.send())
        otto.locate(50, -3, time.time() - 9)
        zoe.locate(50, -3, time.time() - 9)
        self.assertTrue(otto.send() and zoe.send())
        identity = "owntracks/http/Ann"
        self.assertIsNone(otto.contacts[identity].face)
        hidden = b"tEXtComment\0HiddenPlace"
        hidden = struct.pack(">I", len(hidden) - 4) + hidden + struct.pack(">I", zlib.crc32(hidden))
        ann.put({"_type": "card", "tid": "xx", "name": "Somebody else", "face": base64.b64encode(PNG[:33] + hidden + PNG[33:]).decode()})
        ann.put({"_type": "card", "face": base64.b64encode(b"GIF89a").decode()})
        self.assertTrue(ann.send())
        for phone in (otto, zoe):
            phone.locate(50, -3, time.time() - 8)
            phone.locate(50, -3, time.time() - 7)
            self.assertTrue(phone.send())
            self.assert_sound(phone)
            contact = phone.contacts[identity]
            self.assertEqual((contact.name, base64.b64decode(contact.face)), ("Ann", PNG))
            self.assertEqual(["card" in (one["_type"] for one in answer) for answer in phone.answers], [True, True, False])
            # Its answer does not arrive, and it sends again.
            phone.locate(50, -3, time.time() - 7)
            self.assertTrue(phone.send())
            self.assertEqual(phone.answers[-1][0]["_type"], "location")
        self.service.command("face", "Ann")
        for phone in (otto, zoe):
            moment = time.time() - 6
            for answered in (False, True):
                phone.locate(50, -3, moment)
                self.assertTrue(phone.send())
                self.assertEqual(phone.answers[-1][0], {"_type": "card", "tid": "Ann", "name": "Ann"},
                                 "again, since the first answer may have been lost" if answered else "it changed")
                self.assertIsNone(phone.contacts[identity].face)
        self.service.stop()
        self.assertNotIn(b"HiddenPlace", self.service.bytes())


if __name__ == "__main__":
    unittest.main(warnings="ignore")
