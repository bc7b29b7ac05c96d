#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Writes the inputs of the benchmark, the same ones each time.

bench/generate.py [--scale S] [--into FOLDER] [WORKLOAD...]

Each workload gets a folder below build/bench: the source main.c, and headers in folders whose names
begin with `inc`, which are searched in the order of their names. Run a preprocessor in the folder:

    cd build/bench/plain && ../../release/umpre main.c
    cd build/bench/distinct && ../../release/umpre -Iinc0 -Iinc1 -Iinc2 -Iinc3 main.c

All is C that umpre and C preprocessors read alike.
"""

import argparse
import hashlib
import pathlib
import random
import shutil
import sys

from workloads import WORKLOADS

ROOT = pathlib.Path(__file__).resolve().parent.parent
# Stands for the code that makes the inputs: they are made anew when it has changed.
SOURCES = sorted(pathlib.Path(__file__).resolve().parent.glob("workloads/*.py"))
MADE_BY = hashlib.sha256(b"".join(path.read_bytes() for path in SOURCES)).hexdigest()


class Folder:
    """A folder of inputs that is being written."""

    def __init__(self, path):
        self.path = path

    def write(self, name, text):
        """Writes a file; the name may hold folders."""
        path = self.path / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_bytes(text.encode("latin-1"))


def place_of(workload, scale, into=None):
    """Returns the folder of a workload at this scale."""
    name = workload if scale == 1 else f"{workload}-{scale:g}"
    return (into or ROOT / "build/bench") / name


def generate(workload, scale=1.0, into=None):
    """Writes a workload's files unless they are there. Returns their folder."""
    place = place_of(workload, scale, into)
    stamp = place / ".made-by"
    if not stamp.exists() or stamp.read_text() != MADE_BY:
        print(f"Writing {place} ...", file=sys.stderr)
        shutil.rmtree(place, ignore_errors=True)
        place.mkdir(parents=True)
        WORKLOADS[workload](Folder(place), random.Random(workload), scale)
        stamp.write_text(MADE_BY)
    return place


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", maxsplit=1)[0])
    parser.add_argument("--scale", type=float, default=1.0, help="1 is full size")
    parser.add_argument("--into", type=pathlib.Path, help="build/bench without it")
    parser.add_argument("workload", nargs="*", metavar="WORKLOAD", help="all without it")
    options = parser.parse_args()
    unknown = [name for name in options.workload if name not in WORKLOADS]
    if unknown:
        parser.error(f"no such workload: {' '.join(unknown)} (there are: {' '.join(WORKLOADS)})")
    for workload in options.workload or WORKLOADS:
        print(generate(workload, options.scale, options.into))


if __name__ == "__main__":
    main()
