"""A browser without a screen for the tests of pages: Chromium, driven by the WebDriver protocol."""
import base64
import json
import os
import re
import shutil
import subprocess
import tempfile
import urllib.error
import urllib.request

ELEMENT = "element-6066-11e4-a52e-4f735466cecf"
KEYS = {"Tab": "\ue004", "Enter": "\ue007", "Space": "\ue00d", "Down": "\ue015", "Up": "\ue013", "Shift": "\ue008"}


def is_here():
    return shutil.which("chromedriver") is not None and shutil.which("chromium") is not None


class Browser:
    """One session with a profile of its own. `close` ends the browser and its driver."""

    def __init__(self, language="en"):
        self.folder = tempfile.mkdtemp(prefix="ktr-browser-")
        self.driver = subprocess.Popen(["chromedriver", "--port=0"], stdout=subprocess.PIPE,
                                       stderr=subprocess.DEVNULL, text=True, env={**os.environ, "LANGUAGE": language, "HOME": self.folder})
        port = None
        while port is None:
            line = self.driver.stdout.readline()
            if not line:
                raise RuntimeError("chromedriver did not start")
            found = re.search(r"successfully on port (\d+)", line)
            port = found and found.group(1)
        self.root = f"http://127.0.0.1:{port}"
        options = {"args": ["--headless=new", "--no-sandbox", "--disable-gpu", "--hide-scrollbars",
                            "--disable-dev-shm-usage", f"--user-data-dir={self.folder}/profile"]}
        try:
            answer = self._call("POST", "/session", {"capabilities": {"alwaysMatch": {
                "browserName": "chrome", "acceptInsecureCerts": True, "goog:chromeOptions": options}}})
        except BaseException:
            self._end()
            raise
        self.root += f"/session/{answer['sessionId']}"

    def _call(self, method, path, body=None):
        request = urllib.request.Request(self.root + path, method=method,
                                         data=None if body is None else json.dumps(body).encode())
        try:
            with urllib.request.urlopen(request, timeout=60) as answer:
                return json.load(answer)["value"]
        except urllib.error.HTTPError as error:
            raise RuntimeError(error.read().decode()) from None

    def close(self):
        try:
            self._call("DELETE", "")
        finally:
            self._end()

    def _end(self):
        self.driver.terminate()
        self.driver.wait()
        self.driver.stdout.close()
        shutil.rmtree(self.folder, ignore_errors=True)

    def protocol(self, command, **parameters):
        return self._call("POST", "/goog/cdp/execute", {"cmd": command, "params": parameters})

    def screen(self, width, height=800, dark=False, contrast=False):
        self.protocol("Emulation.setDeviceMetricsOverride", width=width, height=height, deviceScaleFactor=1,
                      mobile=False)
        self.protocol("Emulation.setEmulatedMedia", features=[
            {"name": "prefers-color-scheme", "value": "dark" if dark else "light"},
            {"name": "prefers-contrast", "value": "more" if contrast else "no-preference"}])

    def language(self, tag):
        self.protocol("Network.enable")
        self.protocol("Network.setExtraHTTPHeaders", headers={"Accept-Language": tag})

    def open(self, address):
        self._call("POST", "/url", {"url": address})

    def address(self):
        return self._call("GET", "/url")

    def title(self):
        return self._call("GET", "/title")

    def source(self):
        return self._call("GET", "/source")

    def cookies(self):
        return self._call("GET", "/cookie")

    def run(self, script, *arguments):
        return self._call("POST", "/execute/sync", {"script": script, "args": list(arguments)})

    def run_later(self, script, *arguments):
        return self._call("POST", "/execute/async", {"script": script, "args": list(arguments)})

    def focused(self):
        """What the element with the focus is called, and what it is."""
        element = self._call("GET", "/element/active")[ELEMENT]
        return (self._call("GET", f"/element/{element}/computedlabel"), self._call("GET", f"/element/{element}/name"))

    def press(self, *keys):
        for key in keys:
            value = KEYS.get(key, key)
            self._call("POST", "/actions", {"actions": [{"type": "key", "id": "keyboard", "actions": [
                {"type": "keyDown", "value": value}, {"type": "keyUp", "value": value}]}]})

    def tab_to(self, label, most=40):
        """Goes on with the Tab key to what is called so."""
        seen = []
        for _ in range(most):
            self.press("Tab")
            seen.append(self.focused()[0])
            if label in seen[-1]:
                return
        raise AssertionError(f"the Tab key does not reach {label!r}: {seen}")

    def picture(self, file):
        size = self.protocol("Page.getLayoutMetrics")["cssContentSize"]
        shot = self.protocol("Page.captureScreenshot", captureBeyondViewport=True, clip={
            "x": 0, "y": 0, "width": size["width"], "height": size["height"], "scale": 1})
        with open(file, "wb") as out:
            out.write(base64.b64decode(shot["data"]))
