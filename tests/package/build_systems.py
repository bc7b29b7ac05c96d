#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Builds the sources of examples/cmake by the rules of docs/build-systems.md, again and again.

The rules are taken from the page. Before each build something changes; what is then run must be what
depends on it, and no more. Folders have blanks in their names, and so has a source where the rule can
take it. Programs put in the place of umpre-deps and of a step behind it write down what is run.
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
from dataclasses import dataclass

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
EXAMPLE = ROOT / "examples/cmake"

RECORDER = """#!/bin/sh
for word; do
    case $word in *.src) echo "umpre-deps ${word##*/}" >>"$STEPS" ;; esac
done
exec "$0.real" "$@"
"""
FOLLOW = """#!/bin/sh
echo "follow ${1##*/}" >>"$STEPS"
cp "$1" "$2"
"""
# A step behind each text, in the words of each tool; CMake's is on the page.
MAKE_FOLLOW = """
all: $(texts:.txt=.after)
%.after: %.txt
	follow $< $@
"""
NINJA_FOLLOW = """
rule follow
  command = follow $in $out
build leds.after: follow leds.txt
build clock.after: follow clock.txt
build a$ b.after: follow a$ b.txt
"""
MESON_FOLLOW = """
foreach text : texts
  custom_target(input: text, output: '@BASENAME@.after', build_by_default: true,
    command: ['follow', '@INPUT@', '@OUTPUT@'])
endforeach
"""


def block(heading, number=0):
    """Returns a block of code below this heading of the page."""
    page = (ROOT / "docs/build-systems.md").read_text("utf-8")
    section = re.split(r"^##+ ", page.split(f"# {heading}\n")[1], flags=re.MULTILINE)[0]
    return re.findall(r"^```\w+\n(.*?)^```", section, re.MULTILINE | re.DOTALL)[number]


@dataclass
class Tool:
    """How a build system is told what to do."""

    rules: str  # of the page, with a step behind each text
    file: str
    setup: list
    build: list
    blank: tuple = ()  # what to replace, and with what, to add the source "a b.src"
    sees_deletions: bool = True


def cmake(generator):
    return Tool(block("CMake") + block("CMake", 1), "CMakeLists.txt",
                ["cmake", "-G", generator, "-S", ".", "-B", "../the build"],
                ["cmake", "--build", "../the build"], ("clock.src", 'clock.src "a b.src"'),
                sees_deletions=generator == "Ninja")


TOOLS = {
    "make": lambda: Tool(block("Make") + MAKE_FOLLOW, "Makefile", [], ["make", "-j2"]),
    "ninja": lambda: Tool(block("Ninja") + NINJA_FOLLOW, "build.ninja", [], ["ninja"],
                          ("umpre clock.src\n",
                           "umpre clock.src\nbuild a$ b.txt: umpre a$ b.src\n")),
    "meson": lambda: Tool(block("Meson") + MESON_FOLLOW, "meson.build",
                          ["meson", "setup", "../the build"], ["ninja", "-C", "../the build"],
                          ("'clock'", "'clock', 'a b'")),
    "cmake-ninja": lambda: cmake("Ninja"),
    "cmake-make": lambda: cmake("Unix Makefiles"),
}


def run(command, **options):
    done = subprocess.run(command, stdin=subprocess.DEVNULL, stdout=subprocess.PIPE,
                          stderr=subprocess.STDOUT, text=True, **options)
    return done.returncode == 0, done.stdout


def must_run(command, **options):
    good, output = run(command, **options)
    if not good:
        sys.exit(f"{command} failed:\n{output}")


def install(arguments, prefix):
    """Installs the build, with programs that write down what is run."""
    must_run([arguments.cmake, "--install", arguments.build, "--prefix", prefix])
    program = prefix / "bin/umpre-deps"
    program.rename(f"{program}.real")
    for path, text in [(program, RECORDER), (prefix / "bin/follow", FOLLOW)]:
        path.write_text(text)
        path.chmod(0o755)


class Project:
    """The example, with the rules of a tool."""

    def __init__(self, tool, prefix, folder):
        self.tool, self.source = tool, folder / "the sources"
        self.steps = folder / "steps"
        shutil.copytree(EXAMPLE, self.source)
        (self.source / "CMakeLists.txt").unlink()
        rules = tool.rules
        if tool.blank:
            shutil.copy(self.source / "clock.src", self.source / "a b.src")
            assert rules.count(tool.blank[0]) == 1
            rules = rules.replace(*tool.blank)
        (self.source / tool.file).write_text(rules)
        self.environment = {**os.environ, "STEPS": str(self.steps),
                            "PATH": f"{prefix}/bin:{os.environ['PATH']}"}
        if tool.setup:
            must_run(tool.setup, cwd=self.source, env=self.environment)
        self.made_in = folder / "the build" if tool.setup else self.source

    def change(self, name, text):
        """Writes a file that is newer than all that was made; without a text, takes it away."""
        time.sleep(0.05)
        if text is None:
            (self.source / name).unlink()
        else:
            (self.source / name).write_text(text)

    def build_again(self):
        """Returns whether the build was good, the steps that it took and what it said."""
        self.steps.write_text("")
        good, output = run(self.tool.build, cwd=self.source, env=self.environment)
        return good, sorted(self.steps.read_text().splitlines()), output

    def expect(self, what, steps, good=True):
        """Builds, which must take these steps and no others."""
        was_good, taken, output = self.build_again()
        print(f"{what}: {', '.join(taken) or 'nothing'}{'' if was_good else ', failed'}")
        if (was_good, taken) != (good, sorted(steps)):
            sys.exit(f"expected: {sorted(steps)}\n{output}")
        if good:
            self.expect_nothing()

    def expect_nothing(self):
        """Builds once more, where nothing is to be done."""
        good, taken, output = self.build_again()
        if taken or not good:
            sys.exit(f"done again: {taken}\n{output}")

    def text(self, name):
        return (self.made_in / name).read_text()


LEDS = ["umpre-deps leds.src", "follow leds.txt"]
CLOCK = ["umpre-deps clock.src", "follow clock.txt"]
A_B = ["umpre-deps a b.src", "follow a b.txt"]


def check_deletions(project):
    (project.made_in / "leds.txt").unlink()
    project.expect("text deleted", LEDS)
    project.change("inc/board.inc", "#define PIN(port, n) n on port\n")
    project.change("inc/pins.inc", None)
    project.expect("nested file no longer needed", LEDS)


def check(project):
    project.expect("first build", LEDS + CLOCK + (A_B if project.tool.blank else []))
    assert project.text("leds.txt").endswith("\nled = P7 on board 2;\n"), project.text("leds.txt")
    project.change("inc/pins.inc", "#define PIN(port, n) n##port\n")
    project.expect("nested file changed", LEDS)
    assert project.text("leds.txt").endswith("\nled = 7P on board 2;\n"), project.text("leds.txt")
    project.change("inc/pins.inc", "#define PIN(port,  n) n##port // the same\n")
    project.expect("nested file says the same", LEDS[:1])
    if project.tool.sees_deletions:
        check_deletions(project)
    source, text = (project.source / "clock.src").read_text(), project.text("clock.txt")
    project.change("clock.src", "#error stop\n")
    project.expect("error in a source", CLOCK[:1], good=False)
    project.expect("still there", CLOCK[:1], good=False)
    assert project.text("clock.txt") == text, project.text("clock.txt")
    project.change("clock.src", source)
    project.expect("source as it was", CLOCK[:1])


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--build", required=True, help="the folder of the build")
    parser.add_argument("--cmake", default="cmake")
    parser.add_argument("tool", nargs="+", choices=TOOLS)
    arguments = parser.parse_args()
    example = re.sub(r"^#.*\n", "", (EXAMPLE / "CMakeLists.txt").read_text(), flags=re.MULTILINE)
    if example != block("CMake"):
        sys.exit("examples/cmake is not what the page shows")
    with tempfile.TemporaryDirectory(prefix="umpre-build-") as name:
        prefix = pathlib.Path(name) / "a prefix"
        install(arguments, prefix)
        for tool in arguments.tool:
            print(f"== {tool}")
            check(Project(TOOLS[tool](), prefix, pathlib.Path(name) / tool))


if __name__ == "__main__":
    main()
