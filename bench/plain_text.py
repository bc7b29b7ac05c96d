#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Times umpre beside gcc -E on one file of plain text, and prints the ratio of their CPU times.

bench/plain_text.py [--umpre PATH] [--megabytes N] [--runs N]

The file is C text in which one name of a hundred is a macro. It is made from a fixed seed and kept
below build/bench. The programs run in turn; the figure is the median, since single runs are noisy.
"""
import argparse
import os
import random
import resource
import statistics
import subprocess
import sys

HERE = os.path.dirname(os.path.abspath(__file__))
ROOT = os.path.dirname(HERE)
MACROS = 200


def make_text(path, size):
    rng = random.Random(1)
    letters = "abcdefghijklmnopqrstuvwxyz_"
    names = ["".join(rng.choice(letters) for _ in range(rng.randint(3, 12))) for _ in range(3000)]
    with open(path, "w", encoding="ascii") as file:
        for number in range(MACROS):
            file.write(f"#define MACRO{number} {number * 7}\n")
        while file.tell() < size:
            words = []
            for _ in range(rng.randint(3, 10)):
                is_macro = rng.random() < 0.01
                words.append(f"MACRO{rng.randrange(MACROS)}" if is_macro else rng.choice(names))
                words.append(rng.choice([" = ", " + ", "(", ")", ", ", "->", " * ", " 12 + "]))
            file.write("    " * rng.randint(0, 3) + "".join(words) + ";\n")


def cpu_time(command):
    before = resource.getrusage(resource.RUSAGE_CHILDREN)
    subprocess.run(command, stdout=subprocess.DEVNULL, check=True)
    after = resource.getrusage(resource.RUSAGE_CHILDREN)
    return after.ru_utime + after.ru_stime - before.ru_utime - before.ru_stime


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", maxsplit=1)[0])
    parser.add_argument("--umpre", default=os.path.join(ROOT, "build/release/umpre"))
    parser.add_argument("--megabytes", type=int, default=20)
    parser.add_argument("--runs", type=int, default=7)
    options = parser.parse_args()
    folder = os.path.join(ROOT, "build/bench")
    os.makedirs(folder, exist_ok=True)
    text = os.path.join(folder, f"plain-{options.megabytes}.c")
    if not os.path.exists(text):
        print(f"Writing {text} ...", file=sys.stderr)
        make_text(text, options.megabytes * 1_000_000)
    commands = {"umpre": [options.umpre, text], "gcc": ["gcc", "-E", "-undef", "-nostdinc", text]}
    times = {name: [] for name in commands}
    for run in range(options.runs):
        print(f"\rrun {run + 1} of {options.runs}", end="", file=sys.stderr)
        for name, command in commands.items():
            times[name].append(cpu_time(command))
    print(file=sys.stderr)
    ratio = statistics.median(times["gcc"]) / statistics.median(times["umpre"])
    print(f"plain text, {options.megabytes} MB: gcc -E needs {ratio:.1f} times the CPU time of umpre")


if __name__ == "__main__":
    main()
