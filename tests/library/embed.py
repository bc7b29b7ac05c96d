#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks that the embedding example prints what its folder says."""

import argparse
import pathlib
import subprocess
import sys

EXPECTED = pathlib.Path(__file__).resolve().parents[2] / "examples/embed/expected.txt"


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--program", required=True, help="the example")
    arguments = parser.parse_args()
    done = subprocess.run([arguments.program], capture_output=True, text=True)
    if done.returncode != 0 or done.stderr or done.stdout != EXPECTED.read_text():
        sys.exit(f"status {done.returncode}\n{done.stderr}{done.stdout}")


if __name__ == "__main__":
    main()
