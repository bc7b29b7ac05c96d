#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks that the running program's three version functions are found by name, and their texts."""

import argparse
import os
import re
import subprocess
import sys

DATE = r"(Jan|Feb|Mar|Apr|May|Jun|Jul|Aug|Sep|Oct|Nov|Dec) [ 1-3][0-9] [0-9]{4}"
VERSION = rf'[0-9]+\.[0-9]+\.[0-9]+ win32 \({DATE}\) "Amber Crossroads"'


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--umpre", required=True, help="the program to test")
    parser.add_argument("--probe", required=True, help="the library that calls the functions")
    arguments = parser.parse_args()
    done = subprocess.run(
        [arguments.umpre, "-v"],
        env={**os.environ, "LD_PRELOAD": arguments.probe},
        capture_output=True,
        text=True,
    )
    expected = re.compile(
        rf"UmGetVersionString=(?P<version>{VERSION})\n"
        r"UmGetLibNameAndVersionString=Umbrite (?P=version)\n"
        r"UmGetCopyrightString=(?P<copyright>[^\n]+)\n"
        r"umpre version (?P=version)\n"
        r"(?P=copyright)\n"
    )
    if done.returncode != 1 or done.stderr or not expected.fullmatch(done.stdout):
        sys.exit(f"status {done.returncode}\n{done.stdout}{done.stderr}")


if __name__ == "__main__":
    main()
