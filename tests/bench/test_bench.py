#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Tests the benchmark on tiny inputs, with gcc as the only peer.

test_bench.py --umpre PATH

The workload `real` is not among them: its headers are fetched from the network. Headers that others
wrote are what tests/real is about.
"""

import argparse
import pathlib
import subprocess
import sys
import tempfile
import unittest

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
sys.path.insert(0, str(ROOT / "bench"))

import generate  # noqa: E402
import tools  # noqa: E402
from workloads import WORKLOADS  # noqa: E402

SCALE = 0.002
MADE = [name for name in WORKLOADS if name != "real"]
UMPRE = ""


def measure(*words):
    command = [sys.executable, ROOT / "bench/measure.py", "--scale", str(SCALE), "--runs", "1"]
    return subprocess.run([*command, *words], capture_output=True, text=True, check=False)


def tokens_of(text):
    """Returns what stands for the tokens of a program that writes this text."""
    return tools.tokens(["printf", "%s", text], pathlib.Path.cwd())


class Bench(unittest.TestCase):
    def test_umpre_makes_the_tokens_of_gcc_on_every_workload(self):
        done = measure("--peers", "gcc", "--umpre", UMPRE, *MADE)
        self.assertEqual(done.returncode, 0, done.stdout + done.stderr)
        for name in [*MADE, "start-up"]:
            self.assertRegex(done.stdout, rf"(?m)^{name} +gcc [0-9.]+x ")

    def test_a_program_with_other_tokens_is_wrong(self):
        done = measure("--peers", "gcc", "--umpre", "/bin/echo", "plain")
        self.assertEqual(done.returncode, 1, done.stdout + done.stderr)
        self.assertIn("umpre wrong", done.stdout)

    def test_two_builds_are_compared(self):
        done = measure("--umpre", UMPRE, "--against", UMPRE, "plain")
        self.assertEqual(done.returncode, 0, done.stdout + done.stderr)
        self.assertRegex(done.stdout, r"plain +other [0-9.]+x ")

    def test_growing_inputs_are_measured(self):
        done = measure("--umpre", UMPRE, "--linear", "plain")
        self.assertEqual(done.returncode, 0, done.stdout + done.stderr)
        self.assertRegex(done.stdout, r"plain +-?[0-9.]+: ")

    def test_a_build_of_a_few_sources_is_measured(self):
        words = ["--sources", "3", "--runs", "1", "--umpre-deps", UMPRE + "-deps"]
        command = [sys.executable, ROOT / "bench/thousand.py", *words]
        done = subprocess.run(command, capture_output=True, text=True, check=False)
        self.assertEqual(done.returncode, 0, done.stdout + done.stderr)
        self.assertRegex(done.stdout, r"all \| 3 \| CPU time \|")

    def test_inputs_are_the_same_each_time(self):
        for name in MADE:
            with tempfile.TemporaryDirectory() as one, tempfile.TemporaryDirectory() as two:
                places = [generate.generate(name, SCALE, pathlib.Path(into)) for into in (one, two)]
                found = [
                    {path.relative_to(place): path.read_bytes() for path in place.rglob("*.*")}
                    for place in places
                ]
                self.assertEqual(found[0], found[1], name)
                self.assertIn(pathlib.Path(tools.SOURCE), found[0])


class Tokens(unittest.TestCase):
    def test_white_space_and_line_markers_do_not_count(self):
        self.assertEqual(
            tokens_of('# 1 "a.c" 2\nint a=b  + c;\n'), tokens_of('int\na = b+c;\n\n#line 3 "a.c"')
        )

    def test_blanks_between_words_count(self):
        self.assertNotEqual(tokens_of("int a;"), tokens_of("inta;"))

    def test_text_counts(self):
        self.assertNotEqual(tokens_of("a + b"), tokens_of("a - b"))


if __name__ == "__main__":
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--umpre", default="build/release/umpre", help="the program to measure")
    options, rest = parser.parse_known_args()
    UMPRE = str(pathlib.Path(options.umpre).resolve())
    unittest.main(argv=[sys.argv[0], *rest])
