"""A display and a session bus of a test's own, and what assistive technology sees on them."""
import os
import shutil
import subprocess
import sys
import tempfile

from virtual_display import VirtualDisplay

# The bindings belong to the system's Python.
SYSTEM_PYTHON = "/usr/bin/python3"


def outside(file, *programs, modules=("pyatspi",), seconds=120):
    """Starts a display and a session bus, and a file of tests again inside them, where it has the programs and the Python
    modules that it needs; else 77, which ctest calls skipped."""
    for needed in ("Xvfb", "dbus-run-session", SYSTEM_PYTHON, *programs):
        if not shutil.which(needed):
            print(needed, "is not installed")
            return 77
    for module in modules:
        if subprocess.run([SYSTEM_PYTHON, "-c", f"import {module}"], capture_output=True, check=False).returncode != 0:
            print("Python's", module, "is not installed")
            return 77
    with tempfile.TemporaryDirectory(ignore_cleanup_errors=True) as runtime, VirtualDisplay("900x900") as display:
        environment = {**os.environ, "DISPLAY": display.name, "XDG_RUNTIME_DIR": runtime, "KTR_INSIDE": "yes"}
        return subprocess.run(["dbus-run-session", "--", SYSTEM_PYTHON, file, *sys.argv[1:]], env=environment,
                              timeout=seconds, check=False).returncode


def nodes(root):
    yield root
    for i in range(root.childCount):
        yield from nodes(root.getChildAtIndex(i))


def tree(pid):
    """All nodes of a program's window; empty while the window comes, goes or is filled."""
    import pyatspi
    from gi.repository import GLib

    try:
        desktop = pyatspi.Registry.getDesktop(0)
        programs = [desktop.getChildAtIndex(i) for i in range(desktop.childCount)]
        mine = [one for one in programs if one and one.childCount and one.get_process_id() == pid]
        return list(nodes(mine[0])) if mine else []
    except (AttributeError, RuntimeError, LookupError, GLib.Error):
        return []
