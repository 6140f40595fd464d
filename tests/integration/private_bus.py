"""Message buses of a test's own: with services that they start, and with a login manager that says whether it is locked."""
import os
import pathlib
import subprocess

import dbus
import dbus.bus

POLICY = '<policy context="default"><allow send_destination="*"/><allow receive_sender="*"/><allow own="*"/></policy>'
LOGIND, MANAGER, SESSION = "org.freedesktop.login1", "/org/freedesktop/login1", "/org/freedesktop/login1/session/_31"
SAVER, SAVER_PATH = "org.freedesktop.ScreenSaver", "/org/freedesktop/ScreenSaver"


class PrivateBus:
    """A bus; `services`: a folder with what it starts, in the environment that is given here."""

    def __init__(self, folder, kind, services=None, environment=None):
        configuration = pathlib.Path(folder) / f"{kind}-bus.conf"
        started = f"<servicedir>{services}</servicedir>" if services else ""
        limits = "".join(f'<limit name="{name}">{10**8}</limit>' for name in (
            "max_incoming_bytes", "max_outgoing_bytes", "max_message_size"))
        configuration.write_text(f"<busconfig><type>{kind}</type><listen>unix:tmpdir=/tmp</listen>{started}{POLICY}{limits}"
                                 "</busconfig>")
        self.process = subprocess.Popen(["dbus-daemon", f"--config-file={configuration}", "--nofork", "--print-address=1"],
                                        stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, text=True, env=environment)
        self.address = self.process.stdout.readline().strip()

    def connect(self):
        return dbus.bus.BusConnection(self.address)

    def stop(self):
        self.process.terminate()
        self.process.wait()
        self.process.stdout.close()


class Mock:
    """A python3-dbusmock of one service on one of those buses."""

    def __init__(self, bus, kind, name, path, interface):
        variable = "DBUS_SYSTEM_BUS_ADDRESS" if kind == "system" else "DBUS_SESSION_BUS_ADDRESS"
        self.connection = bus.connect()
        self.name = name
        options = ["--system"] if kind == "system" else []
        self.process = subprocess.Popen(["/usr/bin/python3", "-m", "dbusmock", *options, name, path, interface],
                                        env={**os.environ, variable: bus.address}, stdout=subprocess.DEVNULL)
        while not self.connection.name_has_owner(name):
            assert self.process.poll() is None, "python3-dbusmock does not start"

    def tell(self, path, method, *arguments):
        mock = dbus.Interface(self.connection.get_object(self.name, path, introspect=False), "org.freedesktop.DBus.Mock")
        return getattr(mock, method)(*arguments)

    def stop(self):
        self.process.terminate()
        self.process.wait()


class Logind(Mock):
    """A login manager with one session."""

    def __init__(self, bus):
        super().__init__(bus, "system", LOGIND, MANAGER, f"{LOGIND}.Manager")
        self.tell(MANAGER, "AddMethod", f"{LOGIND}.Manager", "GetSessionByPID", "u", "o", f"ret = dbus.ObjectPath('{SESSION}')")
        self.tell(MANAGER, "AddObject", SESSION, f"{LOGIND}.Session", dbus.Dictionary({"LockedHint": False}, signature="sv"),
                  dbus.Array([], signature="(ssss)"))

    def lock(self, locked):
        self.tell(SESSION, "UpdateProperties", f"{LOGIND}.Session", dbus.Dictionary({"LockedHint": locked}, signature="sv"))


class Saver(Mock):
    """A screen saver, active or not."""

    def __init__(self, bus, active):
        super().__init__(bus, "session", SAVER, SAVER_PATH, SAVER)
        self.tell(SAVER_PATH, "AddMethod", SAVER, "GetActive", "", "b", f"ret = {active}")

    def set_active(self, active):
        self.tell(SAVER_PATH, "EmitSignal", SAVER, "ActiveChanged", "b", [active])
