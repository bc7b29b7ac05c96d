#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks that the executable exports the three version functions and nothing else."""

import argparse
import subprocess
import sys

EXPORTS = ["UmGetCopyrightString", "UmGetLibNameAndVersionString", "UmGetVersionString"]


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--umpre", required=True, help="the program to test")
    parser.add_argument("--nm", default="nm", help="the program that lists symbols")
    arguments = parser.parse_args()
    listing = subprocess.run(
        [arguments.nm, "-D", "--defined-only", "--format=posix", arguments.umpre],
        check=True,
        capture_output=True,
        text=True,
    )
    found = sorted(line.split()[0] for line in listing.stdout.splitlines())
    if found != EXPORTS:
        sys.exit(f"exported: {' '.join(found)}")


if __name__ == "__main__":
    main()
