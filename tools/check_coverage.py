#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Says which lines and branches of src/ the tests of a coverage build did not take, and how many they
did.

Run the tests of the preset `coverage` first. Lines and branches are counted once, however often they
were compiled. Neither the generated scanner counts nor the branches that the compiler adds wherever
something may throw.
"""

import argparse
import collections
import json
import pathlib
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent


def decisions(branches):
    """Returns the counts of a line's branches without those of exceptions: the way out of a call by an
    exception stands behind the way on."""
    kept = []
    for branch in branches:
        if not branch["throw"]:
            kept.append(branch["count"])
        elif kept:
            kept.pop()
    return kept


def counts(build):
    """Returns, for each file of src/, how often each of its lines ran, and of its branches, which are
    known by their line and their number there."""
    lines = collections.defaultdict(collections.Counter)
    branches = collections.defaultdict(collections.Counter)
    notes = sorted(str(path) for path in build.rglob("*.gcno"))
    with tempfile.TemporaryDirectory() as scratch:
        done = subprocess.run(
            ["gcov", "--branch-probabilities", "--json-format", "--stdout", *notes],
            cwd=scratch, check=False, capture_output=True,
        )
    if done.returncode != 0:
        # As after a build that the tests were not run with, or where a source was moved.
        said = done.stderr.decode(errors="replace").splitlines()
        sys.exit("gcov: " + next((line for line in said if "mismatch" in line), said[-1]))
    for document in done.stdout.splitlines():
        data = json.loads(document)
        for file in data["files"]:
            path = pathlib.Path(data["current_working_directory"], file["file"]).resolve()
            if not path.is_relative_to(ROOT / "src") or path.suffix not in (".h", ".cc"):
                continue
            name = path.relative_to(ROOT).as_posix()
            for line in file["lines"]:
                lines[name][line["line_number"]] += line["count"]
                for number, count in enumerate(decisions(line["branches"])):
                    branches[name][line["line_number"], number] += count
    return lines, branches


def ranges(numbers):
    """Returns numbers as text, runs of them as "3-5"."""
    runs = []
    for number in sorted(numbers):
        if runs and runs[-1][1] == number - 1:
            runs[-1][1] = number
        else:
            runs.append([number, number])
    return ", ".join(str(a) if a == b else f"{a}-{b}" for a, b in runs)


def report(what, found, least):
    """Shows what was not taken. Tells whether enough was."""
    taken, total = 0, 0
    for file, counted in sorted(found.items()):
        missed = [place for place, count in counted.items() if count == 0]
        taken, total = taken + len(counted) - len(missed), total + len(counted)
        if missed:
            numbers = {place[0] if isinstance(place, tuple) else place for place in missed}
            print(f"{file}: {what} not taken: {ranges(numbers)}")
    share = 100 * taken / total if total else 0
    print(f"coverage: {taken} of {total} {what} of src/, {share:.1f} %")
    return share >= least


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n\n", 1)[0])
    parser.add_argument("--build", default="build/coverage", help="the coverage build's folder")
    parser.add_argument("--lines", type=float, default=97.0, help="the least per cent of lines")
    parser.add_argument("--branches", type=float, default=90.0, help="the same of branches")
    arguments = parser.parse_args()
    lines, branches = counts(pathlib.Path(arguments.build).resolve())
    enough = [report("lines", lines, arguments.lines),
              report("branches", branches, arguments.branches)]
    return 0 if all(enough) else 1


if __name__ == "__main__":
    sys.exit(main())
