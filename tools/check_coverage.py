#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Says which lines of src/ the tests of a coverage build did not run, and how many they did.

Run the tests of the preset `coverage` first. Lines are counted once, however often they were
compiled; the generated scanner does not count.
"""

import argparse
import collections
import json
import pathlib
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent


def counts(build):
    """Returns, for each file of src/, how often each of its lines ran."""
    found = collections.defaultdict(collections.Counter)
    notes = sorted(str(path) for path in build.rglob("*.gcno"))
    with tempfile.TemporaryDirectory() as scratch:
        listing = subprocess.run(
            ["gcov", "--json-format", "--stdout", *notes],
            cwd=scratch, check=True, stdout=subprocess.PIPE, stderr=subprocess.DEVNULL,
        ).stdout
    for document in listing.splitlines():
        data = json.loads(document)
        for file in data["files"]:
            path = pathlib.Path(data["current_working_directory"], file["file"]).resolve()
            if path.is_relative_to(ROOT / "src") and path.suffix in (".h", ".cc"):
                for line in file["lines"]:
                    found[path.relative_to(ROOT).as_posix()][line["line_number"]] += line["count"]
    return found


def ranges(numbers):
    """Returns numbers as text, runs of them as "3-5"."""
    runs = []
    for number in sorted(numbers):
        if runs and runs[-1][1] == number - 1:
            runs[-1][1] = number
        else:
            runs.append([number, number])
    return ", ".join(str(a) if a == b else f"{a}-{b}" for a, b in runs)


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--build", default="build/coverage", help="the coverage build's folder")
    parser.add_argument("--least", type=float, default=95.0, help="fail below this many per cent")
    arguments = parser.parse_args()
    found = counts(pathlib.Path(arguments.build).resolve())
    ran, total = 0, 0
    for file, lines in sorted(found.items()):
        missed = [number for number, count in lines.items() if count == 0]
        ran, total = ran + len(lines) - len(missed), total + len(lines)
        if missed:
            print(f"{file}: not run: {ranges(missed)}")
    share = 100 * ran / total if total else 0
    print(f"coverage: {ran} of {total} lines of src/, {share:.1f} %")
    return 0 if share >= arguments.least else 1


if __name__ == "__main__":
    sys.exit(main())
