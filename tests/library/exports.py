#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks that the shared library exports the functions that its headers declare and nothing else."""

import argparse
import re
import subprocess
import sys

EXPORT = re.compile(r"umpre::(messageOf|Preprocessing::(~?Preprocessing|operator=|\w+))"
                    r"(\[abi:cxx11\])?\(.*\)( const)?")
NAMES = """
Preprocessing ~Preprocessing operator= setSourceFile setSourceText setSourceReader setSourceStream
setMessageName define addIncludeDirectory setOutput setDiagnostics setIncludeResolver setObserver run
version messageOf
""".split()


def name_of(symbol):
    """Returns the name of a function, or all of the symbol if it is not one of ours."""
    match = EXPORT.fullmatch(symbol)
    return (match.group(2) or match.group(1)) if match else symbol


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--library", required=True, help="the shared library")
    parser.add_argument("--nm", default="nm", help="the program that lists symbols")
    arguments = parser.parse_args()
    command = [arguments.nm, "-D", "-C", "--defined-only", arguments.library]
    listing = subprocess.run(command, check=True, capture_output=True, text=True)
    found = {name_of(line.split(" ", 2)[2]) for line in listing.stdout.splitlines()}
    if found != set(NAMES):
        sys.exit("\n".join(f"{'exported' if name in found else 'missing'}: {name}"
                           for name in sorted(found ^ set(NAMES))))


if __name__ == "__main__":
    main()
