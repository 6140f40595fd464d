"""Runs the skill until it is ended."""
import argparse
import signal
import sys
import threading

from .skill import Skill


def main():
    parser = argparse.ArgumentParser(prog="ktr-ovos-skill", description=__doc__)
    parser.add_argument("--bus", default="ws://127.0.0.1:8181/core", help="the assistant's message bus (%(default)s)")
    parser.add_argument("--ktr", default="ktr", help="the program that answers (%(default)s)")
    parser.add_argument("--no-picture", action="store_true", help="only say the answer")
    parser.add_argument("--shown", type=float, default=30.0, help="seconds that a picture is shown and kept (%(default)s)")
    parser.add_argument("--patience", type=float, default=10.0, help="seconds that an answer may take (%(default)s)")
    skill = Skill(parser.parse_args())
    ended = threading.Event()
    for number in (signal.SIGINT, signal.SIGTERM):
        signal.signal(number, lambda *_: ended.set())
    threading.Thread(target=skill.run, daemon=True).start()
    ended.wait()
    skill.close()
    return 0


if __name__ == "__main__":
    sys.exit(main())
