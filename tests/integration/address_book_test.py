#!/usr/bin/python3
"""The program with the desktop's real address-book service on a bus and in folders of the test's own: 5,000 contacts, one whose
name the assistant does not know, and a service that hangs. Skipped without evolution-data-server."""

import base64
import contextlib
import json
import os
import pathlib
import shutil
import signal
import struct
import subprocess
import sys
import tempfile
import threading
import time
import unittest
import zlib

PROGRAM = os.environ["KTR_PROGRAM"]
REGISTRY = pathlib.Path("/usr/libexec/evolution-source-registry")
CONTACTS = 5000
WANTED = "wanted@harbour.example"
# Asks the service as its own programs do: prints what is wanted, and ends.
FILL = r"""
import sys, dbus
bus = dbus.SessionBus()
factory = dbus.Interface(bus.get_object("org.gnome.evolution.dataserver.AddressBook10",
    "/org/gnome/evolution/dataserver/AddressBookFactory"), "org.gnome.evolution.dataserver.AddressBookFactory")
path, name = factory.OpenAddressBook("system-address-book")
book = dbus.Interface(bus.get_object(name, path), "org.gnome.evolution.dataserver.AddressBook")
book.Open()
cards = sys.stdin.read().split("\0")
for begin in range(0, len(cards), 500):
    book.CreateContacts(cards[begin:begin + 500], dbus.UInt32(0))
"""


def card(name, family, address, photo=None):
    more = f"PHOTO;ENCODING=b;TYPE=PNG:{base64.b64encode(photo).decode()}\r\n" if photo else ""
    return (f"BEGIN:VCARD\r\nVERSION:3.0\r\nFN:{name} {family}\r\nN:{family};{name};;;\r\nEMAIL:{address}\r\n{more}"
            "END:VCARD")


def face(side=64):
    """A red picture (PNG)."""
    def chunk(kind, data):
        return struct.pack(">I", len(data)) + kind + data + struct.pack(">I", zlib.crc32(kind + data))
    rows = (b"\0" + b"\xff\0\0" * side) * side
    return (b"\x89PNG\r\n\x1a\n" + chunk(b"IHDR", struct.pack(">IIBBBBB", side, side, 8, 2, 0, 0, 0)) +
            chunk(b"IDAT", zlib.compress(rows)) + chunk(b"IEND", b""))


class AddressBookTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory(ignore_cleanup_errors=True)
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        os.chmod(folder.name, 0o700)
        own = {name: str(self.folder / name.lower()) for name in
               ("HOME", "XDG_DATA_HOME", "XDG_CONFIG_HOME", "XDG_CACHE_HOME", "XDG_STATE_HOME", "XDG_RUNTIME_DIR")}
        for path in own.values():
            os.mkdir(path, 0o700)
        hidden = ("DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM", "DBUS_SESSION_BUS_ADDRESS")
        self.environment = {**{k: v for k, v in os.environ.items() if k not in hidden}, **own, "LANG": "C.UTF-8",
                            "GSETTINGS_BACKEND": "memory", "KTR_CONFIG": str(self.folder / "config.json"),
                            "KTR_LOG": "default"}
        (self.folder / "config.json").write_text(json.dumps({"positions": {"source": "none"}, "language": "en-GB"}))
        bus = subprocess.Popen(["dbus-daemon", "--session", "--nofork", "--print-address=1"], env=self.environment,
                               stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, text=True)
        self.addCleanup(bus.stdout.close)
        self.addCleanup(bus.wait)
        self.addCleanup(bus.terminate)
        self.environment["DBUS_SESSION_BUS_ADDRESS"] = bus.stdout.readline().strip()

    def fill(self, cards):
        subprocess.run(["/usr/bin/python3", "-c", FILL], input="\0".join(cards), text=True, env=self.environment,
                       check=True, timeout=300)

    def assert_alike(self, one, other, why):
        """Of pictures that are taken anew until no minute has passed between them."""
        for _ in range(3):
            first, second = one(), other()
            if first == second:
                return
        self.fail(why)

    def show(self, *configured, bus=True):
        """What a window would draw of a friend on a map, as a picture; and what was said on standard error."""
        environment = {**self.environment, **({} if bus else {"DBUS_SESSION_BUS_ADDRESS": "unix:path=/nonexistent"})}
        (self.folder / "config.json").write_text(json.dumps(
            {"positions": {"source": "none"}, "language": "en-GB", "contacts": list(configured)}))
        answer = self.folder / "answer.json"
        answer.write_text(json.dumps({"sentence": "Here.", "snippet": {
            "kind": "VAKtrLocationSnippet", "locations": [
                {"friend": {"data": WANTED, "object": {"fullName": "Wanda Wanted", "emails": [{"emailAddress": WANTED}]}},
                 "latitude": 51.45, "longitude": -2.6, "accuracy": 25, "ageSeconds": 5, "label": "Home"}]}}))
        picture = self.folder / "picture.png"
        result = subprocess.run([PROGRAM, "render", "--live", "2s", "-o", picture, answer], env=environment,
                                capture_output=True, text=True, timeout=300)
        self.assertEqual(result.returncode, 0, result.stderr)
        return picture.read_bytes(), result.stderr

    def test_face_comes_from_five_thousand_contacts_and_is_the_one_that_a_file_has(self):
        wanted = card("Wanda", "Wanted", WANTED, face())
        (self.folder / "wanda.vcf").write_text(wanted)
        without, _ = self.show()
        of_file, _ = self.show("wanda.vcf")
        self.assertNotEqual(of_file, without)
        self.fill([card(f"Given{n}", f"Family{n}", f"person{n}@harbour.example") for n in range(CONTACTS - 1)] + [wanted])
        self.assert_alike(lambda: self.show()[0], lambda: self.show("wanda.vcf", bus=False)[0], "another face")
        photos = list((self.folder / "xdg_data_home/evolution/addressbook").rglob("photos/*"))
        self.assertTrue(photos, "the service keeps photos in files of its own")

    def daemons(self):
        """The service's processes on this test's bus."""
        daemons = subprocess.run(["pgrep", "-f", "^/usr/libexec/evolution-(source-registry|addressbook-factory)"],
                                 capture_output=True, text=True, check=False).stdout.split()
        own = []
        for pid in daemons:
            with contextlib.suppress(OSError):
                if self.environment["DBUS_SESSION_BUS_ADDRESS"].encode() in pathlib.Path(f"/proc/{pid}/environ").read_bytes():
                    own.append(int(pid))
        return own

    def test_service_that_dies_while_it_is_read_holds_nothing_up_and_is_read_when_it_is_back(self):
        wanted = card("Wanda", "Wanted", WANTED, face())
        (self.folder / "wanda.vcf").write_text(wanted)
        self.fill([card(f"Given{n}", f"Family{n}", f"person{n}@harbour.example") for n in range(CONTACTS - 1)] + [wanted])
        for moment in (0.05, 0.2, 0.5):
            own = self.daemons()
            self.assertTrue(own)
            dying = threading.Timer(moment, lambda own=own: [os.kill(pid, signal.SIGKILL) for pid in own])
            begin = time.monotonic()
            dying.start()
            self.show()
            dying.join()
            self.assertLess(time.monotonic() - begin, 60)
            # The bus starts it anew for whoever asks.
            self.assert_alike(lambda: self.show()[0], lambda: self.show("wanda.vcf", bus=False)[0], "another face")

    def test_service_that_hangs_costs_a_second_and_its_faces(self):
        self.fill([card("Wanda", "Wanted", WANTED, face())])
        own = self.daemons()
        self.assertTrue(own)
        for pid in own:
            os.kill(pid, 19)
            self.addCleanup(os.kill, pid, 18)
        begin = time.monotonic()
        _, said = self.show()
        self.assertLess(time.monotonic() - begin, 60)
        self.assertIn("not all contacts have been read yet", said)
        self.assert_alike(lambda: self.show()[0], lambda: self.show(bus=False)[0],
                          "the name that the answer carries, and its monogram")


if __name__ == "__main__":
    if not REGISTRY.exists() or not shutil.which("dbus-daemon"):
        print("skipped: evolution-data-server is needed")
        sys.exit(77)
    unittest.main()
