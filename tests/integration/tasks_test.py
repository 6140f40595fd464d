#!/usr/bin/python3
"""What a new user does, on a virtual display with keys and a mouse, without a terminal (docs/tasks.md). What stands where is
learnt from the accessibility bus of a session of its own, as the eye would. Skipped as the live window's and the accessibility
tests are."""

import json
import os
import pathlib
import re
import subprocess
import sys
import time
import unittest

import accessibility_test
import live_window_test
import map_file
import mock_bus
from live_window_test import FIRST_ROW, wait_for
from own_service import OwnService


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

    def open_spoken(self, *options):
        """The window of somebody who is signed in, and who is on the accessibility bus."""
        self.environment["QT_LINUX_ACCESSIBILITY_ALWAYS_ON"] = "1"
        self.environment.pop("NO_AT_BRIDGE", None)
        self.program = self.start(live_window_test.PROGRAM, "show", "--language", "en-GB", "--light", "--reduced-motion", *options)

    def seen(self, name, *roles):
        """What bears this name on screen now, or begins with it; none."""
        import pyatspi
        from gi.repository import GLib

        desktop = pyatspi.Registry.getDesktop(0)
        try:
            for i in range(desktop.childCount):
                application = desktop.getChildAtIndex(i)
                if not application or application.name != "ktr" or application.get_process_id() != self.program.pid:
                    continue
                for node in accessibility_test.nodes(application):
                    if ((node.name or "").startswith(name) and (not roles or node.getRoleName() in roles)
                            and node.getState().contains(pyatspi.STATE_SHOWING)):
                        return node
        except (AttributeError, RuntimeError, LookupError, GLib.Error):
            pass
        return None

    def await_seen(self, name, *roles):
        return wait_for(repr(name), lambda: self.seen(name, *roles))

    def click_on(self, name, *roles):
        import pyatspi

        place = self.await_seen(name, *roles).queryComponent().getExtents(pyatspi.DESKTOP_COORDS)
        self.xdotool("mousemove", place.x + place.width // 2, place.y + place.height // 2, "click", 1)

    def scroll_to(self, name, role):
        """Turns the wheel until this stands in the window."""
        import pyatspi

        def there():
            node = self.seen(name, role)
            place = node.queryComponent().getExtents(pyatspi.WINDOW_COORDS) if node else None
            if place and place.y >= 0 and place.y + place.height <= 800:
                return True
            self.xdotool("mousemove", "--window", self.window, 200, 500, "click", 5)
            time.sleep(0.2)
            return False
        wait_for(f"{name!r} in the window", there)

    def open_ann(self):
        """The page that a tap on her row leads to."""
        service = self.serve()
        self.open_spoken("--ask", "where are my friends")
        self.click_on("Ann Marsh", "link")
        self.await_seen("Back", "push button")
        return service

    def test_task_tap(self):
        self.open_ann()
        self.await_seen("Copy place", "push button")
        self.await_seen("Write", "push button")
        self.click_on("Back", "push button")
        self.await_seen("Otto Brandt", "link")

    def test_task_zoom(self):
        self.open_ann()
        ground = (20, 60, 380, 400)
        # Until the page is there and its map drawn.
        wait_for("a map at rest", lambda: (one := self.picture(ground)) and not time.sleep(1.0) and one == self.picture(ground))
        for hand in (lambda: self.click_on("Closer", "push button"), lambda: self.click_on("Further away", "push button"),
                     lambda: self.xdotool("mousemove", "--window", self.window, 200, 150, "click", 4),
                     lambda: self.key("minus")):
            before = self.picture(ground)
            hand()
            wait_for("another map", lambda before=before: self.picture(ground) not in (before, None))

    def test_task_copy(self):
        self.open_ann()
        self.click_on("Copy place", "push button")
        self.await_seen("Copied", "push button")
        self.key("Escape")
        field = self.await_seen("Ask about your friends", "text")
        self.click_on("Ask about your friends", "text")
        self.key("ctrl+v")
        copied = wait_for("the place", lambda: (text := field.queryText()).getText(0, text.characterCount))
        self.assertRegex(copied, r"50\.2\d+, -3\.1\d+")

    @unittest.skipUnless(mock_bus.is_possible(), "python3-dbusmock is not installed")
    def test_task_open_in_maps(self):
        """The desktop's portal is asked, and nobody else."""
        name, path, interface = ("org.freedesktop.portal.Desktop", "/org/freedesktop/portal/desktop",
                                 "org.freedesktop.portal.OpenURI")
        told = self.folder / "portal"
        with told.open("w") as stream:
            portal = subprocess.Popen([mock_bus.PYTHON, "-u", "-m", "dbusmock", "--session", name, path, interface], stdout=stream)
        self.addCleanup(portal.wait)
        self.addCleanup(portal.terminate)
        reply = "ret = dbus.ObjectPath('/org/freedesktop/portal/desktop/request/1_1/t')"
        wait_for("the portal", lambda: subprocess.run(
            ["gdbus", "call", "--session", "-d", name, "-o", path, "-m", "org.freedesktop.DBus.Mock.AddMethod", interface, "OpenURI",
             "ssa{sv}", "o", reply], capture_output=True, check=False).returncode == 0)
        self.open_ann()
        self.click_on("Open in Maps", "push button")
        wait_for("a place", lambda: "OpenURI" in told.read_text())
        self.assertRegex(told.read_text(), r'OpenURI "" "geo:50\.2\d*,-3\.1\d*\?q=50\.2\d*,-3\.1\d*\(Ann%20Marsh\)"')

    def test_task_get_streets(self):
        """Where no map has streets, the line under the card leads to where one is added; then the card has it."""
        self.environment["XDG_DATA_HOME"] = str(self.folder / "data")
        region = map_file.write_region(self.folder / "region.mbtiles")
        self.serve(start=map_file.PLACE)
        self.open_spoken("--ask", "where is ann")
        card = (24, 330, 376, 500)

        def drawn():
            # Four bytes a pixel, of which the last says nothing.
            return re.search(b"(?:\xff\x00\xff.){100}", self.picture(card) or b"", re.DOTALL)
        self.await_seen("No streets for this region here yet.")
        self.assertIsNone(drawn())
        self.click_on("Get streets", "link")
        # It has the focus.
        self.await_seen("Add a region", "push button")
        self.key("Return")
        dialog = wait_for("the dialog", lambda: self.xdotool("search", "--onlyvisible", "--name", "^Add a region", check=False))
        self.xdotool("windowfocus", "--sync", dialog.split()[0])
        self.type(region)
        self.key("Return")
        self.await_seen("region", "push button")
        self.click_on("Back", "push button")
        wait_for("the map under the earlier card", drawn)
        wait_for("nothing more to get", lambda: not self.seen("Get streets"))

    def test_task_hide(self):
        service = self.serve()
        self.open_spoken()
        self.click_on("Ask about your friends", "text")
        self.type("hide my location")
        self.key("Return")
        wait_for("nobody to see", lambda: service.hides())
        self.await_seen("Your location is hidden")

    def test_task_share_until_tonight(self):
        """With a service of one's own: typed, granted until the day ends, and the answer says so."""
        own = OwnService(os.environ["KTR_SERVICE"])
        self.addCleanup(own.__exit__)
        phone = own.add("Mara")
        own.add("Ann")
        own.start()
        own.post("Mara", phone, 50.2104, -3.12)
        made = json.loads(own.command("reader", "Mara", "--token-file", str(self.folder / "token")))
        (self.folder / "ann.vcf").write_text("BEGIN:VCARD\r\nVERSION:3.0\r\nN:Marsh;Ann;;;\r\nFN:Ann Marsh\r\n"
                                             "EMAIL:ann@x.example\r\nEND:VCARD\r\n")
        config = self.folder / "config.json"
        config.write_text(json.dumps({"account": made["account"], "certificates": [own.authority], "contacts": ["ann.vcf"],
                                      "addressBooks": False, "positions": {"source": "none"}}))
        config.chmod(0o600)
        self.environment["KTR_CONFIG"] = str(config)
        self.open_spoken()
        self.click_on("Ask about your friends", "text")
        self.type("share my location with Ann until tonight")
        self.key("Return")
        granted = wait_for("a grant", lambda: own.ends_of_shares("Mara"))
        self.assertEqual(len(granted), 1, granted)
        until = time.localtime(granted[0])
        self.assertLessEqual(0, granted[0] - time.time())
        self.assertLessEqual(granted[0] - time.time(), 86400 + 3600, "tonight")
        self.assertIn((until.tm_hour, until.tm_min), ((0, 0), (23, 59)), "when the day ends")
        self.await_seen("Ann Marsh may see where you are, until")

    def test_task_add_a_map(self):
        self.environment["XDG_DATA_HOME"] = str(self.folder / "data")
        self.serve()
        town = pathlib.Path(live_window_test.PROGRAM).parent.parent / "share" / "ktr" / "maps" / "brinmouth.mbtiles"
        self.assertTrue(town.exists(), town)
        self.open_spoken()
        self.click_on("Settings", "push button")
        self.await_seen("Text size")
        self.scroll_to("Add a region", "push button")
        self.click_on("Add a region", "push button")
        dialog = wait_for("a dialog", lambda: self.xdotool("search", "--onlyvisible", "--name", "Add a region", check=False).split())
        self.xdotool("windowfocus", "--sync", dialog[0])
        self.type(str(town))
        self.key("Return")
        added = wait_for("a map", lambda: list((self.folder / "data").rglob("*.mbtiles")))
        self.assertEqual(len(added), 1)
        self.xdotool("windowfocus", "--sync", self.window)
        self.await_seen("Brinmouth, Streets", "push button")

    def test_task_change_text_size(self):
        self.serve()
        self.open_spoken("--ask", "where are my friends")
        row = self.await_seen("Ann Marsh", "link")

        def height():
            import pyatspi
            return row.queryComponent().getExtents(pyatspi.DESKTOP_COORDS).height

        usual = wait_for("a row", height)
        self.key("ctrl+plus", "ctrl+plus")
        row = wait_for("a larger row", lambda: (one := self.seen("Ann Marsh", "link")) and
                       one.queryComponent().getExtents(0).height > usual and one)
        self.key("ctrl+0")
        wait_for("the usual row", lambda: (one := self.seen("Ann Marsh", "link")) and
                 one.queryComponent().getExtents(0).height == usual)

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
    if "KTR_INSIDE" not in os.environ:
        sys.exit(accessibility_test.outside(__file__, "xdotool", "xwd", seconds=560))
    unittest.main()
