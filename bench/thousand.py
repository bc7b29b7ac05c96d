#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Measures builds of a thousand sources by Ninja: by umpre-deps, by gcc, and by nothing but cp.

It is started by `script/bench --thousand`. The three build alike: a program writes the text and the
list of files, and the text replaces the old one only when it is another one. They take turns, so that
each meets the same noise. A run of all sources renews the table of docs/build-systems.md.
"""

import argparse
import os
import pathlib
import random
import shutil
import statistics
import subprocess
import sys
import time
from dataclasses import dataclass

import report
import tools
from generate import ROOT

PLACE = ROOT / "build/bench/thousand"
PAGE = ROOT / "docs/build-systems.md"
ALL = 1000
LAYERS, LAYER = 4, 50  # headers include headers of the layer below
FIELDS = 15
COMMANDS = {
    "umpre-deps": "{umpre} -Iinc -MF $out.d -MQ $out -o $out.new $in",
    "gcc -E -MD": "gcc -E -undef -nostdinc -w -Iinc -MD -MF $out.d -MQ $out -o $out.new $in",
    "cp": "cp $in $out.new && echo $out: $in >$out.d",
}
RULES = """builddir = {folder}
rule text
  command = {command} && $
      {{ cmp -s $out.new $out && rm $out.new || mv $out.new $out; }}
  depfile = $out.d
  deps = gcc
  restat = 1
"""


def header(rng, layer, number):
    """Returns the text of a header."""
    name = f"part_{layer}_{number}"
    lines = [f"/* Registers of {name}. */", f"#ifndef {name}_h", f"#define {name}_h"]
    if layer > 0:
        lines += [f'#include "part_{layer - 1}_{n}.h"' for n in rng.sample(range(LAYER), 2)]
    lines.append(f"#define {name}_BASE {0x40000000 + 0x1000 * number:#x}")
    for field in range(FIELDS):
        lines.append(f"#define {name}_REG{field} ({name}_BASE + {4 * field})")
        lines.append(f"#define {name}_SET{field}(v) write({name}_REG{field}, (v) << {field % 8})")
    lines += ["#if defined DEBUG", f"void {name}_dump(void);", "#endif"]
    lines += [f"extern int {name}_get{n}(int channel, const char *why);" for n in range(FIELDS)]
    return "\n".join([*lines, "#endif", ""])


def source(rng, number):
    """Returns the text of a source, which includes a few dozen headers."""
    used = rng.sample(range(LAYER), 3)
    lines = [f'#include "part_{LAYERS - 1}_{n}.h"' for n in used]
    for function in range(20):
        lines.append(f"int f{number}_{function}(int x)\n{{")
        for _ in range(5):
            name = f"part_{LAYERS - 1}_{rng.choice(used)}"
            to, value = rng.randrange(FIELDS), rng.randrange(FIELDS)
            lines.append(f"    {name}_SET{to}(x + {name}_REG{value});")
        lines.append("    return x; /* as it came */\n}")
    return "\n".join([*lines, ""])


def folder_of(name):
    """Returns the folder that a command writes to."""
    return PLACE / name.split()[0]


def write_inputs(count, umpre):
    """Writes the sources and headers, the same ones each time, and the rules to build them."""
    shutil.rmtree(PLACE, ignore_errors=True)
    (PLACE / "inc").mkdir(parents=True)
    rng = random.Random(ALL)
    for layer in range(LAYERS):
        for number in range(LAYER):
            text = header(rng, layer, number)
            (PLACE / f"inc/part_{layer}_{number}.h").write_text(text)
    for number in range(count):
        (PLACE / f"s{number}.c").write_text(source(rng, number))
    for name, command in COMMANDS.items():
        folder = folder_of(name).name
        rules = RULES.format(folder=folder, command=command.format(umpre=umpre))
        rules += "".join(f"build {folder}/s{n}.i: text s{n}.c\n" for n in range(count))
        (PLACE / f"{folder}.ninja").write_text(rules)


@dataclass
class Build:
    """What a build took, in seconds, and of how many steps it was."""

    wall: float
    cpu: float
    steps: int


def build(name):
    """Builds by one of the commands, which must succeed."""
    words = ["ninja", "-f", f"{folder_of(name).name}.ninja"]
    start = time.perf_counter()
    with open(PLACE / "log", "w+", encoding="utf-8") as log:
        child = subprocess.Popen(words, cwd=PLACE, stdout=log, stderr=subprocess.STDOUT)
        _, status, usage = os.wait4(child.pid, 0)
        child.returncode = os.waitstatus_to_exitcode(status)
        wall = time.perf_counter() - start
        log.seek(0)
        said = log.read()
    if child.returncode != 0:
        sys.exit(f"{words} failed:\n{said[-2000:]}")
    step = said.splitlines()[-1].split("/")[0]
    steps = int(step[1:]) if step.startswith("[") else 0
    return Build(wall, usage.ru_utime + usage.ru_stime, steps)


def forget_all():
    for name in COMMANDS:
        shutil.rmtree(folder_of(name), ignore_errors=True)


def change_nothing():
    pass


def change_header():
    """Changes a header that about a fifth of the sources include, through others."""
    time.sleep(0.02)
    path = PLACE / "inc/part_1_20.h"
    path.write_text(path.read_text() + "extern int more;\n")


# What happens before a build.
BEFORE = {"all": forget_all, "nothing": change_nothing, "one header": change_header}


def measure(runs):
    """Returns lists of builds, by what happened before and by command."""
    found = {what: {name: [] for name in COMMANDS} for what in BEFORE}
    for run in range(runs):
        for what, happen in BEFORE.items():
            happen()
            for name in COMMANDS:
                found[what][name].append(build(name))
        print(f"run {run + 1} of {runs}", file=sys.stderr, flush=True)
    return found


def check_tokens(count):
    """Fails unless umpre-deps and gcc made the same of the sources; some of them are compared."""
    for number in range(0, count, 50):
        sums = {
            tools.tokens(["cat", f"s{number}.i"], folder_of(name)) for name in list(COMMANDS)[:2]
        }
        if len(sums) != 1:
            sys.exit(f"s{number}.i: umpre-deps and gcc made different tokens")


def median(builds, what):
    return statistics.median(getattr(it, what) for it in builds)


def table(found):
    """Returns the table: for each kind of build the times of each command, and the ratios."""
    head = ["what changed", "steps", "what"]
    rows = []
    for before, builds in found.items():
        steps = str(builds["umpre-deps"][0].steps)
        for what in ("wall", "cpu"):
            times = {name: median(builds[name], what) for name in COMMANDS}
            ratio = times["gcc -E -MD"] / times["umpre-deps"]
            label = "time" if what == "wall" else "CPU time"
            seconds = [f"{value:.2f}" for value in times.values()]
            rows.append([before, steps, label, *seconds, f"**{ratio:.1f}**" if int(steps) else ""])
    return report.table([*head, *COMMANDS, "ratio"], rows)


def main():
    parser = argparse.ArgumentParser(
        prog="script/bench --thousand", description=__doc__.split("\n", 1)[0]
    )
    parser.add_argument("--runs", type=int, default=5, help="of each build; the median counts")
    parser.add_argument("--sources", type=int, default=ALL, help="how many, instead of 1000")
    parser.add_argument("--umpre-deps", default="build/release/umpre-deps", help="the program")
    options = parser.parse_args()
    write_inputs(options.sources, pathlib.Path(options.umpre_deps).resolve())
    found = measure(options.runs)
    check_tokens(options.sources)
    text = table(found)
    print(text, end="")
    if options.sources == ALL:
        intro = f"Seconds, medians of {options.runs} runs on {os.cpu_count()} cores:\n\n"
        report.put("thousand", intro + text, PAGE)


if __name__ == "__main__":
    main()
