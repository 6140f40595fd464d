"""One question to `ktr ask`: its answer as soon as there is one, its picture a little later."""
import json
import os
import pathlib
import re
import shutil
import subprocess
import tempfile
import threading

LONGEST_QUESTION = 2000  # bytes, as the program reads them
DRAWING = 20.0  # seconds
PREFIX = "ktr-skill-"
LANGUAGE = re.compile(r"[A-Za-z]{2,3}(-[A-Za-z0-9]{2,8})*")


def language_tag(text):
    """"en-us" as a language is written; none for what is no language."""
    if not isinstance(text, str) or not LANGUAGE.fullmatch(text):
        return None
    first, *others = text.split("-")
    return "-".join([first.lower(), *(part.upper() if len(part) == 2 else part.title() for part in others)])


class Pictures:
    """The picture of the newest answer, in a folder that nobody else can read; an older one is gone by then."""

    def __init__(self):
        base = os.environ.get("XDG_RUNTIME_DIR")
        base = pathlib.Path(base if base and os.path.isdir(base) else tempfile.gettempdir())
        self._remove_left(base)
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix=f"{PREFIX}{os.getpid()}-", dir=base))
        self.count = 0

    @staticmethod
    def _remove_left(base):
        """What one that was killed could not remove."""
        for folder in base.glob(f"{PREFIX}*"):
            owner = folder.name[len(PREFIX):].split("-")[0]
            if owner.isdigit() and not os.path.exists(f"/proc/{owner}") and folder.stat().st_uid == os.getuid():
                shutil.rmtree(folder, ignore_errors=True)

    def next(self):
        self.remove()
        self.count += 1
        # A page that shows a picture already looks again only at another name.
        return self.folder / f"answer-{self.count}.png"

    def remove(self):
        for file in self.folder.glob("answer-*"):
            file.unlink(missing_ok=True)

    def close(self):
        shutil.rmtree(self.folder, ignore_errors=True)


class Asking:
    """One question under way. `answer` is the program's object, or none when it gave none in time."""

    def __init__(self, program, question, language, picture, patience):
        self.picture = picture
        words = [program, "ask", "--json", "--aloud"]
        if language:
            words.append(f"--language={language}")
        if picture:
            words.append(f"--output={picture}")
        # After "--" nothing is an option, whatever somebody said.
        self.process = subprocess.Popen([*words, "--", question], stdin=subprocess.DEVNULL, stdout=subprocess.PIPE,
                                        umask=0o077)
        late = threading.Timer(patience, self.process.kill)
        late.start()
        line = self.process.stdout.readline()
        late.cancel()
        try:
            answer = json.loads(line)
        except (ValueError, RecursionError):
            answer = None
        self.answer = answer if isinstance(answer, dict) else None

    def end(self):
        self.process.kill()

    def finish(self):
        """Waits for the picture; none when there is nothing to show, or it could not be drawn."""
        with self.process.stdout:
            try:
                self.process.wait(DRAWING)
            except subprocess.TimeoutExpired:
                self.process.kill()
                self.process.wait()
        drawn = self.process.returncode == 0 and self.picture and self.picture.is_file()
        return self.picture if drawn and self.answer and self.answer.get("snippet") else None
