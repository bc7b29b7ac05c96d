#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Builds examples/cmake against an installation, in folders with blanks, and builds it again.

What is done again must be what depends on what changed, a file must stay as it is when its contents
do, and an error in a source must fail the build.
"""

import argparse
import os
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import time

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent


def run(*command):
    done = subprocess.run(command, capture_output=True, text=True)
    return done.returncode, done.stdout + done.stderr


def expect(what, actual, expected, output=""):
    print(f"{what}: {actual}")
    if actual != expected:
        sys.exit(f"expected: {expected}\n{output}")


class Project:
    def __init__(self, cmake, folder, prefix, generator):
        self.cmake, self.source, self.build = cmake, folder / "the sources", folder / "the build"
        shutil.copytree(ROOT / "examples/cmake", self.source)
        status, output = run(cmake, "-G", generator, "-S", self.source, "-B", self.build,
                             f"-DCMAKE_PREFIX_PATH={prefix}")
        expect("configured", status, 0, output)

    def made(self):
        """Builds. Returns the status and the sources that were read."""
        status, output = run(self.cmake, "--build", self.build)
        return status == 0, sorted(set(re.findall(r"Preprocessing (\S+)", output)))

    def change(self, name, text):
        """Writes a file that is newer than all that was made."""
        time.sleep(1.1)
        (self.source / name).write_text(text)

    def written(self, name):
        return os.stat(self.build / name).st_mtime_ns


def check(project):
    expect("first build", project.made(), (True, ["clock.src", "leds.src"]))
    text = (project.build / "leds.txt").read_text()
    expect("its last line", text.splitlines()[-1], "led = P7 on board 2;")
    expect("nothing changed", project.made(), (True, []))
    before = project.written("leds.txt")
    project.change("inc/pins.inc", "#define PIN(port, n) n##port\n")
    expect("nested file changed", project.made(), (True, ["leds.src"]))
    expect("its text is new", project.written("leds.txt") > before, True)
    expect("nothing changed", project.made(), (True, []))
    before = project.written("leds.txt")
    project.change("inc/pins.inc", "#define PIN(port,  n) n##port // the same\n")
    expect("nested file says the same", project.made(), (True, ["leds.src"]))
    expect("its text is as old as before", project.written("leds.txt") == before, True)
    expect("nothing changed", project.made(), (True, []))
    project.change("clock.src", "#error stop\n")
    expect("error in a source", project.made(), (False, ["clock.src"]))


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--build", required=True, help="the folder of the build")
    parser.add_argument("--cmake", default="cmake")
    parser.add_argument("generator", nargs="+")
    arguments = parser.parse_args()
    with tempfile.TemporaryDirectory(prefix="umpre-cmake-") as name:
        prefix = pathlib.Path(name) / "a prefix"
        status, output = run(arguments.cmake, "--install", arguments.build, "--prefix", prefix)
        expect("installed", status, 0, output)
        for generator in arguments.generator:
            print(f"== {generator}")
            check(Project(arguments.cmake, pathlib.Path(name) / generator, prefix, generator))


if __name__ == "__main__":
    main()
