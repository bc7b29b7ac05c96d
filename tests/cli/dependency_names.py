#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Has make and ninja read the rules of umpre-deps for files with difficult names.

For each name, a source of that name, which includes a file of such a name, is built; then nothing is
left to be done, and a change of either file makes it be built again. In make, a deleted include does
not stop the build (-MP), and one that was looked for in vain makes the target be built again when it
comes to be (--absent). Exit status 77 says that one of the tools is missing.
"""

import argparse
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import time

NAMES = ["plain", "a b", "a  b", " a", "a#b", "#a", "a# b", "a$b", "$a$$b", "$(a)", "${a}", "a%b", "a\\b",
         "a:b", "a\\ b", "a\\\\ b", "a[b]", "a~b", "a+b,c@d", "ä"]
# What only make can read.
NAMES_OF_MAKE = ["a\\#b", "a'b", "a&b", "a*b", "a?b"]

# The recipe is a script, so that only the rule has to do with names.
SCRIPT = """\
#!/bin/sh
echo run >>runs
exec {deps} -Imissing -Iinc -o out.txt -MD -MP {absent} "$(cat name)"
"""
MAKEFILE = """\
out.txt: ; @./build.sh
-include out.d
"""
NINJA = """\
rule build
  command = ./build.sh
  depfile = out.d
  deps = gcc
build out.txt: build
"""


class Build:
    """A folder where one source is built by one tool."""

    def __init__(self, folder, deps, tool, name):
        self.folder, self.tool, self.name = folder, tool, name
        self.source, self.include = folder / f"{name}.src", folder / "inc" / f"{name}.inc"
        self.include.parent.mkdir()
        self.source.write_text(f'#include "{name}.inc"\n')
        self.include.write_text("text\n")
        (folder / "name").write_text(f"{name}.src")
        (folder / "Makefile").write_text(MAKEFILE)
        (folder / "build.ninja").write_text(NINJA)
        script = folder / "build.sh"
        script.write_text(SCRIPT.format(deps=deps, absent="--absent" if tool == "make" else ""))
        script.chmod(0o755)

    def runs_after(self, what):
        """Builds. Says so if that does not run the script just once more, or not at all."""
        before = self.count()
        done = subprocess.run([self.tool], cwd=self.folder, capture_output=True, text=True)
        if done.returncode != 0:
            return f"{self.tool} fails after {what}:\n{done.stdout}{done.stderr}"
        expected = 0 if what == "nothing" else 1
        runs = self.count() - before
        return "" if runs == expected else f"{self.tool} runs {runs} times after {what}"

    def count(self):
        runs = self.folder / "runs"
        return len(runs.read_text().splitlines()) if runs.exists() else 0

    def steps(self):
        yield "the beginning"
        yield "nothing"
        for path in (self.source, self.include):
            path.write_text(path.read_text() + "more\n")
            later = time.time() + 2
            os.utime(path, (later, later))
            yield f"a change of {path.name!r}"
            earlier = later - 10
            os.utime(path, (earlier, earlier))
            yield "nothing"
        if self.tool == "make":
            yield from self.steps_of_make()

    def steps_of_make(self):
        self.source.write_text("text\n")
        self.include.unlink()
        yield "an include was deleted"
        yield "nothing"
        self.source.write_text(f'#include "{self.name}.inc"\n')
        self.include.write_text("text\n")
        yield "it came back"
        first = self.folder / "missing" / self.include.name
        first.parent.mkdir()
        first.write_text("text\n")
        later = time.time() + 2
        os.utime(first, (later, later))
        yield "another came to be"


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--deps", required=True, help="the program umpre-deps")
    parser.add_argument("tool", choices=["make", "ninja"])
    arguments = parser.parse_args()
    if shutil.which(arguments.tool) is None:
        sys.exit(77)
    wrong = []
    names = NAMES + (NAMES_OF_MAKE if arguments.tool == "make" else [])
    for name in names:
        with tempfile.TemporaryDirectory() as folder:
            build = Build(pathlib.Path(folder), arguments.deps, arguments.tool, name)
            for what in build.steps():
                if found := build.runs_after(what):
                    wrong.append(f"{name!r}: {found}")
                    break
    print("\n".join(wrong + [f"{len(names)} names built"]))
    sys.exit(1 if wrong else 0)


if __name__ == "__main__":
    main()
