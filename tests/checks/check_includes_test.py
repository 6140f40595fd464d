#!/usr/bin/env python3
"""scripts/check-includes has to find what points the wrong way."""
import pathlib
import subprocess
import sys
import tempfile
import unittest

SCRIPT = pathlib.Path(__file__).resolve().parents[2] / "scripts" / "check-includes"


class CheckIncludesTest(unittest.TestCase):
    def check(self, files):
        with tempfile.TemporaryDirectory() as folder:
            root = pathlib.Path(folder)
            (root / "cmake").mkdir()
            (root / "cmake" / "include-order.txt").write_text("Low\nMiddle Right\nHigh\n")
            for name, text in files.items():
                path = root / name
                path.parent.mkdir(parents=True, exist_ok=True)
                path.write_text(text)
            run = subprocess.run([SCRIPT, "--root", folder], capture_output=True, text=True, check=False)
            return run.returncode, run.stdout

    def test_downwards_is_in_order(self):
        code, out = self.check({"views/Middle.h": '#include "model/Low.h"\n', "model/Low.h": "#include <vector>\n"})
        self.assertEqual((code, out), (0, "includes: in order\n"))

    def test_upwards_is_found(self):
        code, out = self.check({"model/Low.h": '\n#include "views/High.h"\n', "views/High.h": ""})
        self.assertEqual(code, 1)
        self.assertIn("model/Low.h:2: Low may not include High", out)

    def test_right_neighbour_is_found(self):
        code, out = self.check({"model/Middle.cpp": '#include "model/Right.h"\n', "model/Right.h": ""})
        self.assertEqual(code, 1)
        self.assertIn("Middle may not include Right", out)

    def test_library_in_the_core_is_found(self):
        code, out = self.check({"platform/base/A.h": "#include <QString>\n"})
        self.assertEqual(code, 1)
        self.assertIn("platform/base/A.h:1: <QString> is no standard C++ header", out)

    def test_platform_including_the_plugin_is_found(self):
        code, out = self.check({"platform/base/A.h": '#include "model/Low.h"\n', "model/Low.h": ""})
        self.assertEqual(code, 1)
        self.assertIn("platform/ may not include model/", out)

    def test_class_without_a_place_is_found(self):
        code, out = self.check({"model/Unknown.h": ""})
        self.assertEqual(code, 1)
        self.assertIn("Unknown has no place", out)

    def test_circle_is_found(self):
        code, out = self.check({"linux/ui/A.h": '#include "linux/ui/B.h"\n', "linux/ui/B.h": '#include "linux/ui/A.h"\n'})
        self.assertEqual(code, 1)
        self.assertIn("headers include each other", out)


if __name__ == "__main__":
    sys.exit(unittest.main(verbosity=0))
