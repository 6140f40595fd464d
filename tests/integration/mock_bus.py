"""A message bus of a test's own, and services on it that python3-dbusmock plays: what they say is written down there and not here,
and they check the types of what they are told."""

import shutil
import subprocess
import time

PYTHON = "/usr/bin/python3"
NEEDED = ("dbus-daemon", "gdbus", PYTHON)


def is_possible():
    return (all(map(shutil.which, NEEDED))
            and subprocess.run([PYTHON, "-c", "import dbusmock"], capture_output=True, check=False).returncode == 0)


class MockBus:
    """Plays a system bus. `address` is what DBUS_SYSTEM_BUS_ADDRESS wants."""

    def __init__(self, folder):
        configuration = folder / "bus.conf"
        configuration.write_text("""<busconfig><type>system</type><listen>unix:tmpdir=/tmp</listen>
            <policy context="default"><allow send_destination="*"/><allow receive_sender="*"/><allow own="*"/></policy>
            </busconfig>""")
        self._processes = [subprocess.Popen(["dbus-daemon", f"--config-file={configuration}", "--nofork",
                                             "--print-address=1"], stdout=subprocess.PIPE, text=True)]
        self.address = self._processes[0].stdout.readline().strip()
        self._environment = {"DBUS_SYSTEM_BUS_ADDRESS": self.address, "PATH": "/usr/bin:/bin"}

    def stop(self):
        for process in reversed(self._processes):
            process.terminate()
            process.wait()
        self._processes[0].stdout.close()

    def play(self, name, path, interface):
        """A service of this name with one object; returns once it is there."""
        self._processes.append(subprocess.Popen([PYTHON, "-m", "dbusmock", "--system", name, path, interface],
                                                env=self._environment, stdout=subprocess.DEVNULL))
        deadline = time.monotonic() + 20
        while not self.tell(name, path, "GetMethodCalls", "-"):
            if time.monotonic() > deadline:
                raise AssertionError(f"{name} does not come")
            time.sleep(0.1)

    def tell(self, name, path, method, *arguments):
        """Of the mock itself, in gdbus's words for values; whether it was done."""
        return subprocess.run(["gdbus", "call", "--system", "-d", name, "-o", path, "-m", f"org.freedesktop.DBus.Mock.{method}",
                               *arguments], env=self._environment, capture_output=True, check=False).returncode == 0
