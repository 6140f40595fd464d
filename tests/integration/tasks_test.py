#!/usr/bin/python3
"""What a new user does, on a virtual display with keys and a mouse, without a terminal (docs/tasks.md). Skipped as the live window's
tests are."""

import json
import pathlib
import time
import unittest

import live_window_test
from live_window_test import FIRST_ROW, wait_for


class TasksTest(live_window_test.LiveWindowTest):
    def sign_in_page(self):
        """A service, and a window of somebody who was never signed in; their person and secret."""
        service = self.serve()
        self.config = self.folder / "config.json"
        known = json.loads(self.config.read_text())
        account = known.pop("account")
        self.host, self.person = account["host"], account["personId"]
        self.secret = pathlib.Path(account["tokenFile"]).read_text().strip()
        self.config.write_text(json.dumps(known))
        # No keyring here: its absence is part of the task.
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = "disabled:"
        self.open()
        time.sleep(1.0)
        return service

    def type(self, text):
        self.xdotool("type", "--delay", 5, text)

    def key(self, *names):
        self.xdotool("key", *names)

    def account(self):
        return json.loads(self.config.read_text()).get("account")

    def keep_in_file(self):
        """Where no keyring keeps the secret, the second button keeps it in a file."""
        def kept():
            self.key("Tab")
            self.key("space")
            time.sleep(0.5)
            return self.account()
        return wait_for("the account", kept)

    def test_task_sign_in_and_ask(self):
        self.sign_in_page()
        for text in (self.host, self.person, self.secret):
            self.type(text)
            self.key("Tab" if text != self.secret else "Return")
        time.sleep(1.5)
        self.assertIsNone(self.account(), "nothing is written before the secret is kept")
        account = self.keep_in_file()
        self.assertEqual((account["host"], account["personId"]), (self.host, self.person))
        token = self.config.parent / "token"
        self.assertEqual(token.read_text().strip(), self.secret)
        self.assertEqual(oct(token.stat().st_mode & 0o777), "0o600")
        self.assertNotIn(self.secret, self.config.read_text())
        time.sleep(1.5)
        self.type("where are my friends")
        self.key("Return")
        self.assertEqual(self.url_of(FIRST_ROW), "wayloc://friend/ann@harbour.example")

    def test_task_mend_a_wrong_secret(self):
        self.sign_in_page()
        for text in (self.host, self.person, "wrong"):
            self.type(text)
            self.key("Tab" if text != "wrong" else "Return")
        time.sleep(2.0)
        self.assertIsNone(self.account())
        # The focus is in the secret, where what is wrong is said.
        self.key("ctrl+a")
        self.type(self.secret)
        self.key("Return")
        time.sleep(1.5)
        self.assertEqual(self.keep_in_file()["personId"], self.person)


def load_tests(loader, _tests, _pattern):
    names = [name for name in loader.getTestCaseNames(TasksTest) if name.startswith("test_task_")]
    return unittest.TestSuite(TasksTest(name) for name in names)


if __name__ == "__main__":
    unittest.main()
