#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Runs golden cases again and again, each time with another call of the system failing.

The cases stand in cases.txt; in none of them is a file to be found in two directories, because one
that cannot be opened is looked for in the next. fail_nth.cc says which calls can fail and how.
Whatever fails, the program ends with status 0, 1 or 2 and never by a signal; with 0 only when its
whole output is there; a status that changes comes with a message; what is written before status 2 is
the beginning of what would have been; and all memory and every descriptor is given back, as in the
run without failures.
"""

import argparse
import collections
import concurrent.futures
import os
import pathlib
import shlex
import shutil
import subprocess
import sys
import tempfile

HERE = pathlib.Path(__file__).resolve().parent
sys.path.insert(0, str(HERE.parent))
import run_cases  # noqa: E402

LIMIT = 20
NO_MEMORY = b"out of dynamic memory in yy_create_buffer()\n"
MEMORY_CALLS = ("malloc", "calloc", "realloc", "aligned_alloc")
Run = collections.namedtuple("Run", "status output written errors calls memory failed kept")


class Tortured:
    """A case in a folder of its own, to be run many times."""

    def __init__(self, name, umpre, library, folder):
        self.name, self.folder = name, folder / "run"
        self.place = folder
        self.preload = library
        case = next(case for case in run_cases.find_cases() if case.name == name)
        self.sections = run_cases.parse(case)[1]
        header = next(header for header in self.sections if header.startswith("run"))
        self.command = [umpre] + [os.fsencode(run_cases.given([word + "<END>"]))
                                  for word in shlex.split(header)[2:]]
        self.writes = any(header.startswith("written") for header in self.sections)
        (folder / "input").write_bytes(run_cases.given(self.sections.get("input:", [])))

    def fresh(self):
        shutil.rmtree(self.folder, ignore_errors=True)
        self.folder.mkdir()
        for header, content in self.sections.items():
            if header.startswith("file"):
                path = self.folder / header[5:-1]
                path.parent.mkdir(parents=True, exist_ok=True)
                path.write_bytes(run_cases.given(content))

    def run(self, mode, call):
        """Runs the case once. Kept are blocks of memory and descriptors."""
        if not self.folder.exists() or self.writes:
            self.fresh()
        report = self.place / "report"
        report.unlink(missing_ok=True)
        environment = {"LC_ALL": "C", "TZ": "UTC", "LD_PRELOAD": self.preload,
                       "TORTURE_MODE": mode, "TORTURE_CALL": str(call),
                       "TORTURE_REPORT": str(report)}
        with open(self.place / "input", "rb") as source, \
                open(self.place / "output", "wb") as output, \
                open(self.place / "errors", "wb") as errors:
            status = subprocess.run(self.command, cwd=self.folder, stdin=source, stdout=output,
                                    stderr=errors, env=environment, timeout=LIMIT).returncode
        said = report.read_text().split() if report.exists() else "0 0 0 0 0 nothing 0 0 0 0".split()
        written = {str(path): path.read_bytes() for path in sorted(self.folder.rglob("*"))
                   if path.is_file() and f"file {path.name}:" not in self.sections}
        return Run(status, (self.place / "output").read_bytes(), written,
                   (self.place / "errors").read_bytes(), int(said[1]), int(said[3]), said[5],
                   (int(said[7]), int(said[9])))


def begins(part, whole):
    return all(whole.get(name, b"").startswith(data) for name, data in part.items())


def complaints(run, good):
    """Yields what is wrong with a run in which something failed, beside one in which nothing did."""
    if run.status not in (0, 1, 2):
        yield f"status {run.status}"
    whole = run.output == good.output and run.written == good.written
    if run.status == 0 and not whole:
        yield "status 0, but the output is not whole"
    if run.failed == "message" and (run.status != good.status or not whole):
        yield "a message that could not be written changed the status or the output"
    if run.status != good.status and not run.errors:
        yield "another status without a message"
    if run.status == 2 != good.status and run.failed in MEMORY_CALLS \
            and not run.errors.endswith(NO_MEMORY):
        yield "no memory, but another message"
    if run.status == 2 and not (good.output.startswith(run.output)
                                and begins(run.written, good.written)):
        yield "what was written before status 2 is not the beginning of the output"
    if run.kept[0] > good.kept[0]:
        yield f"{run.kept[0] - good.kept[0]} blocks of memory are not given back"
    if run.kept[1] > good.kept[1]:
        yield f"{run.kept[1] - good.kept[1]} descriptors stay open"


def torture(name, umpre, library):
    """Returns how many runs a case took, and what was wrong."""
    wrong = []
    with tempfile.TemporaryDirectory(prefix="umpre-torture-") as folder:
        case = Tortured(name, umpre, library, pathlib.Path(folder))
        good = case.run("once", 0)
        if good.calls == 0:
            return 1, [f"{name}: {library} had no effect"]
        plan = [("once", call) for call in range(1, good.calls + 1)]
        plan += [("memory", call) for call in range(1, good.memory + 1)]
        for mode, call in plan:
            try:
                found = list(complaints(case.run(mode, call), good))
            except subprocess.TimeoutExpired:
                found = [f"not done after {LIMIT} s"]
            wrong += [f"{name}: {mode} {call}: {text}" for text in found]
        short = case.run("short", 1)
        if (short.status, short.output, short.written) != (good.status, good.output, good.written):
            wrong.append(f"{name}: short: reading and writing a byte at a time changes the result")
    return len(plan) + 2, wrong


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--umpre", required=True, help="the program to test")
    parser.add_argument("--library", required=True, help="fail_nth.cc, built")
    parser.add_argument("--jobs", type=int, default=os.cpu_count(), help="cases at a time")
    parser.add_argument("names", metavar="NAME", nargs="*", help="cases, instead of cases.txt")
    options = parser.parse_args()
    names = options.names or (HERE / "cases.txt").read_text().split()
    umpre, library = (os.path.abspath(path) for path in (options.umpre, options.library))
    runs, wrong = 0, []
    with concurrent.futures.ThreadPoolExecutor(options.jobs) as pool:
        for count, found in pool.map(lambda name: torture(name, umpre, library), names):
            runs += count
            wrong += found
    print("\n".join(wrong + [f"{len(names)} inputs, {runs} runs, {len(wrong)} wrong"]))
    return 1 if wrong else 0


if __name__ == "__main__":
    sys.exit(main())
