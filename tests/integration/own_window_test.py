#!/usr/bin/python3
"""The window beside a service of one's own, which has no assistant: signing in with a link, one's own sharing and its switch, and
those who share, by the accessibility bus alone. Skipped as the tests of the accessibility bus are."""

import json
import os
import pathlib
import re
import sys
import tempfile
import time
import unittest

import accessibility_test as accessibility
from accessibility_test import wait_for
from own_service import OwnService
from screen_session import tree

PROGRAM = os.environ["KTR_PROGRAM"]
SERVICE = os.environ["KTR_SERVICE"]


class OwnWindowTest(unittest.TestCase):
    def setUp(self):
        self.service = self.enterContext(OwnService(SERVICE)) if hasattr(self, "enterContext") else None
        if self.service is None:
            self.service = OwnService(SERVICE)
            self.addCleanup(self.service.__exit__)
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.config = self.folder / "config.json"

    def configure(self, **members):
        made = {"certificates": [self.service.authority], "language": "en-GB", "addressBooks": False,
                "positions": {"source": "none"}, **members}
        self.config.write_text(json.dumps(made))
        self.config.chmod(0o600)

    def sign_in_by_hand(self, name):
        token = self.folder / "reader-token"
        made = json.loads(self.service.command("reader", name, "--token-file", str(token)))
        self.configure(account=made["account"])

    def open(self, *words):
        import subprocess

        # Without a keyring that could ask somebody for a password.
        self.log = self.folder / "log"
        environment = {**os.environ, "QT_LINUX_ACCESSIBILITY_ALWAYS_ON": "1", "QT_QPA_PLATFORM": "xcb",
                       "KTR_CONFIG": str(self.config), "XDG_STATE_HOME": str(self.folder / "state"), "KTR_LOG": "debug"}
        with self.log.open("w") as stream:
            self.program = subprocess.Popen([PROGRAM, *words], env=environment, stdout=stream, stderr=stream)
        self.addCleanup(self.program.wait)
        self.addCleanup(self.program.kill)

    def tree(self):
        return tree(self.program.pid)

    def find(self, role, name):
        """The node whose name begins so, once it is there and shown."""
        import pyatspi
        from gi.repository import GLib

        def found():
            for node in self.tree():
                try:
                    if (node.getRoleName() == role and node.name.startswith(name)
                            and node.getState().contains(pyatspi.STATE_SHOWING)):
                        return node
                except GLib.Error:
                    continue  # it went between two questions
            return None
        try:
            return wait_for(f"{role} {name!r}", found)
        except AssertionError:
            try:
                seen = sorted({(node.getRoleName(), node.name) for node in self.tree() if node.name})
            except GLib.Error:
                seen = "what goes away"
            raise AssertionError(f"{role} {name!r} is not among {seen}; {self.log.read_text()[-2000:]}") from None

    def press(self, node):
        action = node.queryAction()
        names = [action.getName(i) for i in range(action.nActions)]
        action.doAction(next(i for i, name in enumerate(names) if name in ("Press", "Toggle", "press", "toggle", "click")))

    def is_hidden(self, name):
        shown = re.search(rf"^{name}\b.*$", self.service.command("people"), re.M).group(0)
        return "hidden" in shown

    def test_switch_asks_the_service_and_goes_back_with_the_reason(self):
        import pyatspi

        self.service.add("Mara")
        self.service.start()
        self.sign_in_by_hand("Mara")
        self.open("open", "wayloc://friend/")
        switch = self.find("check box", "Friends can see me, Those you allow")
        self.assertTrue(switch.getState().contains(pyatspi.STATE_CHECKED))
        self.press(switch)
        switch = self.find("check box", "Friends can see me, Nobody can see where you are.")
        self.assertTrue(self.is_hidden("Mara"), "the service has it before the window says so")
        self.press(switch)
        switch = self.find("check box", "Friends can see me, Those you allow")
        self.assertFalse(self.is_hidden("Mara"))
        self.service.stop()
        self.press(switch)
        switch = self.find("check box", "Friends can see me, Your service didn")
        self.assertTrue(switch.getState().contains(pyatspi.STATE_CHECKED), "it went back")

    def test_those_who_share_lead_to_their_pages(self):
        ann = self.service.add("Ann")
        self.service.add("Otto")
        self.service.add("Mara")
        for name in ("Ann", "Otto"):
            self.service.command("friend", name, "Mara")
        self.service.earlier()
        self.service.start()
        self.service.post("Ann", ann, 50.2104, -3.12)
        self.sign_in_by_hand("Mara")
        self.open("open", "wayloc://friends/")
        row = self.find("push button", "Ann")
        self.assertNotIn("Otto", [node.name for node in self.tree()], "nothing was heard of him yet")
        self.press(row)
        self.find("push button", "Copy place")

    def without_keyring(self):
        """Somebody has the keyring's name and knows nothing of secrets, so that none asks for a password."""
        import subprocess

        program = ("import dbus.bus, dbus.mainloop.glib as m; from gi.repository import GLib; m.DBusGMainLoop(set_as_default=True);"
                   "bus = dbus.SessionBus(); name = dbus.service.BusName('org.freedesktop.secrets', bus);"
                   "print('there', flush=True); GLib.MainLoop().run()")
        process = subprocess.Popen([sys.executable, "-c", "import dbus.service; " + program], stdout=subprocess.PIPE)
        self.addCleanup(process.stdout.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        self.assertEqual(process.stdout.readline().strip(), b"there")

    def test_link_signs_in_after_a_press_and_is_nowhere_afterwards(self):
        self.service.add("Mara")
        self.service.start()
        self.configure()
        self.without_keyring()
        link = re.search(r"https://\S+/me/in\?link=\w+", self.service.command("link", "Mara")).group(0)
        self.open("open", link)
        button = self.find("push button", "Sign in")
        self.assertNotIn("account", json.loads(self.config.read_text()), "nothing before the press")
        self.press(button)
        # No keyring here.
        self.press(self.find("push button", "Keep it in a file"))
        wait_for("the account", lambda: json.loads(self.config.read_text()).get("account"))
        self.assertEqual(json.loads(self.config.read_text())["account"]["personId"], "Mara")
        secret = (self.folder / "token").read_text().strip()
        self.find("text", "Ask about your friends")
        for file in self.folder.rglob("*"):
            if file.is_file():
                self.assertNotIn(link.split("=")[1].encode(), file.read_bytes(), file)
        self.assertNotIn(secret, self.log.read_text())
        self.assertNotIn(secret, self.config.read_text())


if __name__ == "__main__":
    if "KTR_INSIDE" not in os.environ:
        sys.exit(accessibility.outside(__file__))
    unittest.main()
