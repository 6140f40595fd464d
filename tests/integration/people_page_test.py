#!/usr/bin/env python3
"""The people's page in a real browser: by keyboard, without scripts, narrow, dark, from right to left, for everybody.

  people_page_test.py SERVICE FOLDER [unittest options]

FOLDER: where axe-core is, or is installed when KTR_LONG_TESTS is set. KTR_PICTURES=FOLDER keeps a picture of each page.
"""
import base64
import http.server
import json
import os
import pathlib
import re
import shutil
import socket
import ssl
import subprocess
import sys
import tempfile
import threading
import unittest
import urllib.request

sys.path.insert(0, os.path.dirname(__file__))
import browser as browsers  # noqa: E402

SERVICE, AXE = sys.argv.pop(1), pathlib.Path(sys.argv.pop(1))
LONG = bool(os.environ.get("KTR_LONG_TESTS"))
PICTURES = os.environ.get("KTR_PICTURES")
LANGUAGES = ("en de fr es pt it nl sv pl uk ru tr el ar he fa hi zh-Hans zh-Hant ja ko").split()
# What a finger has to hit is at least as high; the words of a box to tick count with it.
SMALL = """return [...document.querySelectorAll('a,button,select,input:not([type=hidden])')].filter(e => {
  const row = e.matches('input[type=radio],input[type=checkbox]') ? e.closest('.row') : e;
  const box = row.getBoundingClientRect(); return box.height < 44 || box.width < 44; }).map(e => e.outerHTML)"""


def axe_source():
    file = AXE / "node_modules" / "axe-core" / "axe.min.js"
    if not file.exists() and LONG:
        AXE.mkdir(parents=True, exist_ok=True)
        subprocess.run(["npm", "install", "--silent", "--no-save", "--ignore-scripts", "--prefix", AXE, "axe-core@4"],
                       check=True, timeout=300)
    return file.read_text() if file.exists() else None


class PeoplePageTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.axe = axe_source()
        cls.browser = browsers.Browser()
        cls.addClassCleanup(cls.browser.close)

    def setUp(self):
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix="ktr-page-"))
        self.addCleanup(lambda: subprocess.run(["rm", "-rf", os.fspath(self.folder)], check=True))
        with socket.socket() as probe:
            probe.bind(("127.0.0.1", 0))
            port = probe.getsockname()[1]
        self.origin = f"https://localhost:{port}"
        self.command("init", "--host", "localhost", "--port", str(port))
        for name in ("Mara", "Lea", "Ann"):
            self.command("add", name, "--handle", f"{name.lower()}@x.example")
        self.command("zone", "Mara", "Europe/Berlin")
        self.command("place", "Mara", "--name", "Home", "--at", "50.21,-3.12", "--label", "home")
        process = subprocess.Popen([SERVICE, "--data", str(self.folder / "data"), "serve"], stdout=subprocess.PIPE,
                                   stderr=subprocess.DEVNULL, text=True)
        self.addCleanup(lambda: (process.kill(), process.wait(), process.stdout.close()))
        self.assertTrue(process.stdout.readline().startswith("ready"))
        self.browser.protocol("Network.clearBrowserCookies")
        self.browser.protocol("Emulation.setScriptExecutionDisabled", value=False)
        self.browser.language("en")
        self.browser.screen(320)

    def command(self, *words):
        done = subprocess.run([SERVICE, "--data", str(self.folder / "data"), *words], capture_output=True, text=True,
                              timeout=60, check=False)
        self.assertEqual(done.returncode, 0, (words, done.stderr))
        return done.stdout

    def link(self, name="Mara"):
        return re.search(r"https://\S+", self.command("link", name)).group(0)

    def sign_in(self):
        self.browser.open(self.link())
        self.browser.press("Tab", "Enter")
        self.waitFor("Nobody can see where you are.|can see where you are.")

    def waitFor(self, title):
        for _ in range(200):
            if re.search(title, self.browser.title()):
                return
            threading.Event().wait(0.05)
        self.fail(f"the page is {self.browser.title()!r}, not {title!r}")

    def waitForWords(self, words):
        """Where the page that comes has the title of the one that goes."""
        for _ in range(200):
            if words in self.browser.source():
                return
            threading.Event().wait(0.05)
        self.fail(f"{words!r} is not on the page {self.browser.title()!r}")

    def test_by_keyboard_and_without_scripts_at_320(self):
        browser = self.browser
        browser.protocol("Emulation.setScriptExecutionDisabled", value=True)
        link = self.link()
        browser.open(link)
        self.assertEqual(browser.title(), "Your own page")
        self.assertEqual(browser.cookies(), [])
        browser.tab_to("Open my page")
        browser.press("Enter")
        self.waitFor("^Nobody can see where you are.$")
        cookie, = browser.cookies()
        self.assertEqual((cookie["name"], cookie["httpOnly"], cookie["secure"], cookie["sameSite"], cookie["path"]),
                         ("__Host-session", True, True, "Strict", "/"))
        browser.tab_to("Share with somebody")
        browser.press("Enter")
        self.waitFor("^Share with somebody$")
        browser.tab_to("Name, e-mail")
        browser.press(*"LEA@x.example", "Enter")
        self.waitFor("sees$")
        browser.tab_to("The town")
        browser.press("Up", "Tab", "Down", "Tab", "Tab")
        browser.tab_to("May be said aloud")
        browser.press("Space")
        browser.tab_to("Save")
        browser.press("Enter")
        self.waitForWords("Saved.")
        browser.tab_to("Back")
        browser.press("Enter")
        self.waitFor("^One person can see where you are.$")
        people = self.command("people")
        self.assertRegex(people, r"seen by Lea: 1km until \d{4}-\d\d-\d\d 00:00.*aloud")
        browser.tab_to("Visible to friends")
        self.assertRegex(re.sub("[\u2068\u2069]", "", browser.focused()[0]), "^Visible to friends, on")
        browser.press("Space")
        self.waitFor("^Nobody can see where you are.$")
        self.assertIn("Mara, hidden", self.command("people"))
        browser.open(link)
        browser.tab_to("Open my page")
        browser.press("Enter")
        self.waitForWords("This link has been used")

    def test_page_of_another_site_changes_nothing(self):
        """A form of somebody else's, in a browser that is signed in."""
        self.sign_in()
        form = (f'<title>trap</title><form method=post action="{self.origin}/me/visible"><input name=state value=off>'
                '<button>x</button></form>').encode()

        class Trap(http.server.BaseHTTPRequestHandler):
            def do_GET(self):
                self.send_response(200)
                self.send_header("Content-Type", "text/html")
                self.end_headers()
                self.wfile.write(form)

            def log_message(self, *_):
                pass

        server = http.server.HTTPServer(("127.0.0.1", 0), Trap)
        threading.Thread(target=server.serve_forever, daemon=True).start()
        self.addCleanup(lambda: (server.shutdown(), server.server_close()))
        self.browser.open(f"http://127.0.0.1:{server.server_port}/")
        self.browser.tab_to("x")
        self.browser.press("Enter")
        self.waitFor("This page opens with a link|did not come from")
        self.assertNotIn("hidden", self.command("people"))
        self.browser.open(self.origin + "/me")
        self.assertIn("where you are", self.browser.title(), "still signed in")

    def test_another_host_is_none_of_ours(self):
        import ssl
        context = ssl.create_default_context(cafile=self.folder / "data" / "ca.pem")
        for host in ("evil.example", "localhost:1@evil.example", "localhost:", "localhost.evil.example"):
            request = urllib.request.Request(self.origin + "/me", headers={"Host": host})
            with self.assertRaises(urllib.error.HTTPError) as refused:
                urllib.request.urlopen(request, context=context, timeout=20)
            self.assertEqual(refused.exception.code, 421, host)
            refused.exception.close()

    def fence(self, watcher, handle):
        """Somebody wishes to be told when somebody comes to a place without a name, and leaves one."""
        token = self.folder / "token"
        self.command("reader", watcher, "--token-file", str(token))
        context = ssl.create_default_context(cafile=str(self.folder / "data" / "ca.pem"))
        credentials = base64.b64encode(f"{watcher}:{token.read_text().strip()}".encode()).decode()
        for trigger, latitude in (("OnArrival", 50.2), ("OnDeparture", 50.3)):
            body = {"clientContext": {}, "handle": handle, "trigger": trigger,
                    "place": {"latitude": latitude, "longitude": -3.1}}
            request = urllib.request.Request(
                self.origin + "/qloxservice/friends/va/setFence", json.dumps(body).encode(), {
                    "Authorization": "Basic " + credentials, "Content-Type": "application/json",
                    "X-Orcha-Seek-API-Ver": "4.0", "X-Orcha-AuthScheme": "Forever"})
            with urllib.request.urlopen(request, context=context, timeout=20) as answer:
                self.assertEqual(answer.status, 200)

    def pages(self):
        """The address of each page, with a rule that ends and one that does not."""
        self.command("share", "Mara", "Lea", "--precision", "town", "--until", "midnight")
        self.command("share", "Mara", "Ann", "--arrival", "Home", "--fences")
        self.fence("Ann", "mara@x.example")
        self.browser.open(self.origin + "/me")
        rule, device = "", ""
        rule = re.search(r"/me/sees/\d+", self.browser.source()).group(0)
        self.browser.open(self.origin + "/me/devices")
        device = re.search(r"/me/devices/\d+/end", self.browser.source()).group(0)
        return {"main": "/me", "share": "/me/share", "looks": "/me/looks", "phone": "/me/phone",
                "set-up": device.replace("devices", "phone").replace("/end", ""), "devices": "/me/devices",
                "end": device, "settings": "/me/settings", "places": "/me/places", "told": "/me/fences", "delete": "/me/delete",
                "rule": rule, "stop": rule + "/stop", "link": "/me/in?link=x", "none": "/me/none"}

    def check(self, name, where):
        browser = self.browser
        self.assertEqual(browser.run(SMALL), [], (name, where))
        width = browser.run("return document.documentElement.scrollWidth")
        self.assertLessEqual(width, 320, (name, where, "is wider than the window"))
        if PICTURES:
            browser.picture(f"{PICTURES}/{name}-{where}.png")

    def violations(self):
        self.browser.run(self.axe + ";return true")
        found = self.browser.run_later("""const done = arguments[arguments.length - 1];
            axe.run(document, {resultTypes: ['violations']}).then(r => done(r.violations.map(
              v => [v.id, v.help, v.nodes.map(n => n.html + ' ' + n.failureSummary)])), e => done([String(e)]))""")
        return found

    def test_every_page_is_open_to_everybody(self):
        if self.axe is None:
            self.skipTest("needs axe-core: KTR_LONG_TESTS=1 installs it")
        self.sign_in()
        pages = self.pages()
        for language, dark, contrast in (("en", False, False), ("en", True, False), ("ar", False, False),
                                         ("ar", True, False), ("en", False, True), ("en", True, True)):
            self.browser.language(language)
            self.browser.screen(320, dark=dark, contrast=contrast)
            for name, path in pages.items():
                self.browser.open(self.origin + path)
                where = f"{language}-{'dark' if dark else 'light'}{'-contrast' if contrast else ''}"
                self.check(name, where)
                self.assertEqual(self.violations(), [], (name, where))

    def test_every_language_fits_into_320(self):
        self.sign_in()
        pages = self.pages()
        for language in LANGUAGES if LONG else ("de", "ar", "ru", "ja"):
            self.browser.language(language)
            for name, path in pages.items():
                self.browser.open(self.origin + path)
                self.check(name, language)
                self.assertEqual(self.browser.run("return document.documentElement.dir"),
                                 "rtl" if language in ("ar", "he", "fa") else "ltr")

    def test_code_for_another_phone_is_read_by_a_camera_and_opens_the_page_there(self):
        """From the picture of the page as it is drawn: narrow, wide, in light and in the dark."""
        if not shutil.which("zbarimg"):
            self.assertFalse(LONG, "zbarimg is not installed")
            self.skipTest("zbarimg is not installed")
        self.sign_in()
        for language, width, dark in (("en", 320, False), ("en", 320, True), ("ar", 1280, True)):
            self.browser.language(language)
            self.browser.screen(width, dark=dark)
            self.browser.open(self.origin + "/me/phone")
            self.browser.run("document.querySelector('main form button').click()")
            self.waitForWords("?id=")
            picture = self.folder / "page.png"
            self.browser.picture(picture)
            done = subprocess.run(["zbarimg", "--quiet", "--raw", str(picture)], capture_output=True, text=True, timeout=60,
                                  check=False)
            link = done.stdout.strip()
            self.assertTrue(link.startswith(self.origin + "/me/in?link="), (language, width, dark, done))
            # The other phone's browser is not signed in, until its owner presses the button.
            self.browser.protocol("Network.clearBrowserCookies")
            self.browser.language("en")
            self.browser.open(link)
            self.browser.tab_to("Open my page")
            self.browser.press("Enter")
            self.waitFor("can see where you are.")

    def test_new_phone_is_shown_what_to_type_once(self):
        self.sign_in()
        self.browser.open(self.origin + "/me/phone")
        self.browser.tab_to("Show what to type")
        self.browser.press("Enter")
        for _ in range(200):
            if "?id=" in self.browser.source():
                break
            threading.Event().wait(0.05)
        self.check("made", "en")
        if self.axe is not None:
            self.assertEqual(self.violations(), [])
        secret = re.search(r"\?id=(\w{26})", self.browser.source()).group(1)
        self.browser.tab_to("Look again")
        self.browser.press("Enter")
        self.waitFor("Set up a phone")
        for _ in range(200):
            if secret not in self.browser.source():
                break
            threading.Event().wait(0.05)
        self.assertNotIn(secret, self.browser.source())
        self.assertIn("Nothing has come yet.", self.browser.source())


if __name__ == "__main__":
    if not browsers.is_here():
        print("skipped: needs chromium and its driver (scripts/install-packages browser)")
        sys.exit(1 if LONG else 77)
    unittest.main()
