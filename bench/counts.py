# SPDX-License-Identifier: MIT
"""Counts umpre's instructions on small inputs, which repeats where times do not."""

import pathlib
import re
import subprocess
import sys
import tempfile

import tools
from generate import generate
from workloads import WORKLOADS

BASELINE = pathlib.Path(__file__).resolve().parent / "baseline.txt"
SCALE = 0.01
HEAD = """\
# SPDX-License-Identifier: MIT
# Instructions of the release build on small inputs; `script/bench --counts` shows what changed.
"""
# What decides the counts besides the sources: the program that says its version, and where.
VERSIONS = {
    "g++": ("g++", r"\) (\S+)"),
    "flex": ("flex", r"flex (\S+)"),
    "libc": ("ldd", r"(\S+)$"),
    "valgrind": ("valgrind", r"valgrind-(\S+)"),
}


def version(program, pattern):
    """Returns the version that a program says it has."""
    said = subprocess.run([program, "--version"], capture_output=True, text=True, check=True)
    return re.search(pattern, said.stdout.splitlines()[0]).group(1)


def count(umpre, workload):
    """Returns the instructions of a run on the small input of a workload."""
    folder = generate(workload, SCALE)
    with tempfile.NamedTemporaryFile() as file:
        command = ["valgrind", "--tool=callgrind", f"--callgrind-out-file={file.name}", umpre]
        subprocess.run(
            tools.command_for(command, folder),
            cwd=folder,
            env={"LC_ALL": "C", "PATH": tools.ENVIRONMENT["PATH"]},
            stdin=subprocess.DEVNULL,
            capture_output=True,
            check=False,
        )
        found = re.search(r"^(?:summary|totals): (\d+)", file.read().decode(), re.MULTILINE)
    return int(found.group(1))


def baseline():
    """Returns the counts that are kept, by workload."""
    if not BASELINE.exists():
        return {}
    lines = [line.split() for line in BASELINE.read_text().splitlines()]
    return {words[0]: int(words[1]) for words in lines if words[0] != "#"}


def show(umpre, workloads, save):
    """Shows the counts beside those of the baseline, or makes them the baseline."""
    versions = "".join(f"# {name} {version(*asked)}\n" for name, asked in VERSIONS.items())
    old = baseline()
    if old and versions not in BASELINE.read_text():
        print(f"The baseline was counted with other tools than these:\n{versions}", file=sys.stderr)
    new = {}
    for workload in workloads:
        new[workload] = count(umpre, workload)
        was = old.get(workload)
        change = f"{(new[workload] / was - 1) * 100:+8.2f} %" if was else "     new"
        print(f"{workload:<10} {new[workload]:>12} {change}", flush=True)
    if save:
        kept = {**old, **new}
        lines = [f"{name} {kept[name]}\n" for name in WORKLOADS if name in kept]
        BASELINE.write_text(HEAD + versions + "".join(lines))
        print(f"Wrote {BASELINE}")
    return True
