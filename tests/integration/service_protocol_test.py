#!/usr/bin/env python3
"""Runs the curl lines of docs/service-protocol.md against the development service and compares their answers.

  service_protocol_test.py PROGRAM DOCUMENT
"""
import os
import pathlib
import re
import subprocess
import sys

from serve import Service


def examples(document):
    """(command, expected answer) of the lines that begin with "$ "; "..." in an answer stands for anything."""
    lines = document.read_text(encoding="utf-8").splitlines()
    for line, answer in zip(lines, lines[1:]):
        if line.startswith("    $ "):
            yield line[6:], answer.strip()


def main():
    program, document = sys.argv[1], pathlib.Path(sys.argv[2])
    failures = count = 0
    with Service(program) as service:
        folder = service.folder / "ca"
        settings = re.search(r"^    AUTH=(.*)$", document.read_text(encoding="utf-8"), re.M)
        script = f"set -euo pipefail; DIR={folder}; PORT={service.port}; AUTH={settings.group(1)}; "
        for command, expected in examples(document):
            count += 1
            run = subprocess.run(["bash", "-c", script + command], capture_output=True, text=True, env=os.environ,
                                 timeout=60, check=False)
            pattern = ".*".join(re.escape(part) for part in expected.split("..."))
            if run.returncode != 0 or not re.fullmatch(pattern, run.stdout.strip()):
                failures += 1
                print(f"$ {command}\nexpected: {expected}\nfound:    {run.stdout}{run.stderr}")
    print(f"{count} examples, {failures} failures")
    # A document without examples would prove nothing.
    return 1 if failures or count < 5 else 0


if __name__ == "__main__":
    sys.exit(main())
