#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Measures umpre beside other preprocessors. It is started by script/bench."""

import argparse
import pathlib
import statistics
import sys
from dataclasses import dataclass, field

import counts
import report
import tools
from generate import ROOT, generate
from workloads import WORKLOADS

# Growing inputs, as shares of full size, which is the last.
SHARES = (0.125, 0.25, 0.5, 1)


@dataclass
class Result:
    """What was found on one input."""

    workload: str
    folder: pathlib.Path
    size: int = 0  # in bytes, all files together
    cpu: dict = field(default_factory=dict)  # program -> median of its runs, in seconds
    memory: dict = field(default_factory=dict)  # program -> bytes
    failed: dict = field(default_factory=dict)  # program -> how

    def __post_init__(self):
        files = (path for path in self.folder.rglob("[!.]*") if path.is_file())
        self.size = sum(path.stat().st_size for path in files)

    def best_peer(self):
        """Returns the fastest of those that gave the right tokens, umpre aside."""
        return min((name for name in self.cpu if name != "umpre"), key=self.cpu.get, default=None)

    def ratio(self):
        """Returns how many times umpre's time the fastest of the others takes."""
        best = self.best_peer()
        return self.cpu[best] / self.cpu["umpre"] if best and "umpre" in self.cpu else None


class Progress:
    """One line on the terminal that says what is being done."""

    def __init__(self):
        self.shown = sys.stderr.isatty()

    def say(self, text):
        if self.shown:
            print(f"\r\033[K{text}", end="", file=sys.stderr, flush=True)

    def done(self, text):
        self.say("")
        print(text, flush=True)


class Bench:
    """The programs to compare, and how often each is run."""

    def __init__(self, programs, runs):
        self.programs = programs  # name -> the words of its command
        self.runs = runs
        self.progress = Progress()

    def each(self, result, what, action):
        """Calls action(command, folder) for each program that has not failed, unless it now does.

        Returns what the calls gave, by program.
        """
        found = {}
        for name, words in self.programs.items():
            if name not in result.failed:
                self.progress.say(f"{result.workload}: {what} of {name}")
                try:
                    command = tools.command_for(words, result.folder)
                    found[name] = action(command, result.folder)
                except tools.Failed as failure:
                    result.failed[name] = str(failure)
        return found

    def check(self, result):
        """Finds the programs whose tokens are not those of gcc, or of umpre where it runs alone."""
        sums = self.each(result, "tokens", tools.tokens)
        right = sums.get("gcc", sums.get("umpre"))
        result.failed.update({name: "wrong" for name, found in sums.items() if found != right})

    def time(self, results):
        """Runs all programs on all inputs in turn, so that each meets the same noise."""
        seconds = [{name: [] for name in self.programs} for _ in results]
        for number in range(self.runs):
            for result, lists in zip(results, seconds):
                times = self.each(result, f"run {number + 1} of {self.runs}", tools.run)
                for name, cpu in times.items():
                    lists[name].append(cpu)
        for result, lists in zip(results, seconds):
            result.cpu = {
                name: statistics.median(times)
                for name, times in lists.items()
                if name not in result.failed
            }

    def weigh(self, result):
        """Takes the memory of all programs."""
        result.memory = self.each(result, "memory", tools.peak_memory)

    def compared(self, workload, scale):
        """Returns the result of all programs on a workload."""
        result = Result(workload, generate(workload, scale))
        self.check(result)
        self.time([result])
        self.weigh(result)
        return result

    def grown(self, workload, scale):
        """Returns the results of all programs on a workload in growing sizes."""
        results = [Result(workload, generate(workload, scale * share)) for share in SHARES]
        self.time(results)
        for result in results:
            self.weigh(result)
        return results

    def started(self):
        """Returns the result of all programs on an empty file."""
        folder = ROOT / "build/bench/empty"
        folder.mkdir(parents=True, exist_ok=True)
        (folder / tools.SOURCE).write_text("")
        result = Result("start-up", folder)
        # It is over in no time, so it can be measured more often.
        Bench(self.programs, 10 * self.runs).time([result])
        self.weigh(result)
        return result


def parse_arguments():
    parser = argparse.ArgumentParser(
        prog="script/bench", description="Measures umpre beside other preprocessors."
    )
    parser.add_argument("workload", nargs="*", metavar="WORKLOAD", help="all without it")
    parser.add_argument("--runs", type=int, default=7, help="of each program; the median counts")
    parser.add_argument("--scale", type=float, default=1.0, help="of the inputs; 1 is full size")
    parser.add_argument("--umpre", default="build/release/umpre", help="the program to measure")
    parser.add_argument("--against", metavar="UMPRE", help="another one, instead of the peers")
    parser.add_argument("--peers", default=",".join(tools.PEERS), help="which, with commas between")
    parser.add_argument("--linear", action="store_true", help="measure growing inputs instead")
    parser.add_argument("--counts", action="store_true", help="count instructions instead")
    parser.add_argument("--save", action="store_true", help="make the counts the new baseline")
    options = parser.parse_args()
    unknown = [name for name in options.workload if name not in WORKLOADS]
    unknown += [name for name in options.peers.split(",") if name not in tools.PEERS]
    if unknown:
        parser.error(f"not known: {' '.join(unknown)} (workloads: {' '.join(WORKLOADS)})")
    if options.save and not options.counts:
        parser.error("--save goes with --counts")
    options.whole = not options.workload and options.scale == 1 and not options.against
    options.workload = options.workload or list(WORKLOADS)
    return options


def compare(bench, options):
    """Measures umpre beside others. Returns whether it and gcc, the judge, did their work."""
    results = []
    for workload in options.workload:
        results.append(bench.compared(workload, options.scale))
        bench.progress.done(report.comparison_line(results[-1]))
    start_up = bench.started()
    bench.progress.done(report.comparison_line(start_up))
    right = not any({"umpre", "gcc"} & result.failed.keys() for result in results)
    if options.whole and right:
        report.write_comparison(results, start_up, bench.runs)
    return right


def grow(bench, options):
    """Measures umpre on growing inputs."""
    start_up = bench.started()
    rows = []
    for workload in options.workload:
        rows.append(report.Growth(bench.grown(workload, options.scale), start_up))
        bench.progress.done(rows[-1].line())
    if options.whole:
        report.write_growth(rows)
    return True


def main():
    options = parse_arguments()
    umpre = str(pathlib.Path(options.umpre).resolve())
    if options.counts:
        return counts.show(umpre, options.workload, options.save)
    programs = {"umpre": [umpre]}
    if options.linear:
        return grow(Bench(programs, options.runs), options)
    if options.against:
        programs["other"] = [str(pathlib.Path(options.against).resolve())]
    else:
        programs.update({name: tools.PEERS[name] for name in options.peers.split(",")})
    return compare(Bench(programs, options.runs), options)


if __name__ == "__main__":
    sys.exit(0 if main() else 1)
