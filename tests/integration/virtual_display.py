"""A display without a screen, for as long as a test needs it."""

import os
import subprocess


class VirtualDisplay:
    """Starts Xvfb on a free display; `name` is what DISPLAY wants. Use as a context manager, or `stop()`."""

    def __init__(self, size):
        read, write = os.pipe()
        # Without -noreset the display starts anew whenever its last program leaves, and refuses who comes meanwhile.
        self._server = subprocess.Popen(
            ["Xvfb", "-displayfd", str(write), "-screen", "0", f"{size}x24", "-noreset", "-nolisten", "tcp"],
            pass_fds=[write], stderr=subprocess.DEVNULL)
        os.close(write)
        with os.fdopen(read) as numbers:
            self.name = ":" + numbers.readline().strip()

    def stop(self):
        self._server.terminate()
        self._server.wait()

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.stop()
