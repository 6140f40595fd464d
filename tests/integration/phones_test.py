#!/usr/bin/env python3
"""Many phones of both kinds against a service of one's own: each answer is one that they can take, and shows each friend once.

  phones_test.py SERVICE [unittest options]
"""
import concurrent.futures
import random
import sys
import time
import unittest

from own_service import OwnService
from phone import PRIVATE, SCHEMA, Phone, other_messages

SERVICE = sys.argv.pop(1)
PEOPLE, ROUNDS = 50, 40


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
            cards = sum(one["_type"] == "card" for answer in phone.answers for one in answer)
            self.assertLessEqual(cards, 3 * len(friends[phone.user]), "a card comes when it changed")
        self.service.stop()
        kept = self.service.bytes()
        for word in PRIVATE:
            self.assertNotIn(word.encode(), kept)


if __name__ == "__main__":
    unittest.main(warnings="ignore")
