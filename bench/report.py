# SPDX-License-Identifier: MIT
"""Shows what was measured: lines on the terminal, tables and plots in the documentation."""

import subprocess
from dataclasses import dataclass

from generate import ROOT
from tools import PEERS

PAGE = ROOT / "docs/performance.md"
# Whose memory a line for the terminal has.
SHOWN = ("umpre", "other", "gcc", "tcc")
# The least ratio to keep for each workload.
GOALS = {
    "plain": 10,
    "oneline": 15,
    "data": 10,
    "comments": 6,
    "skipped": 6,
    "conditions": 4,
    "includes": 5.5,
    "distinct": 3.5,
    "reinclude": 6,
    "objects": 5.5,
    "defines": 3.5,
    "functions": 5,
    "bigmacro": 7,
    "real": 3.7,
    "hostile": 6,
}


def milliseconds(seconds):
    return f"{seconds * 1000:.{0 if seconds > 0.02 else 1}f}"


def megabytes(count):
    return f"{count / 1e6:.1f}"


def comparison_line(result):
    """Returns a result as a line for the terminal."""
    times = [f"{name} {milliseconds(cpu)}" for name, cpu in result.cpu.items()]
    times += [f"{name} {how}" for name, how in result.failed.items()]
    ratio = result.ratio()
    verdict = f"{result.best_peer()} {ratio:.2f}x" if ratio else "no ratio"
    memory = ", ".join(f"{n} {megabytes(result.memory[n])}" for n in result.memory if n in SHOWN)
    return f"{result.workload:<10} {verdict:<13} {', '.join(times)} ms; {memory} MB"


def table(head, rows):
    """Returns a table of the documentation; the first column is text, the others are numbers."""
    lines = [head, ["---"] + ["--:"] * (len(head) - 1), *rows]
    return "".join("| " + " | ".join(line) + " |\n" for line in lines)


def put(name, text, page=PAGE):
    """Replaces what stands between the two comments of this name on a page."""
    begin, end = f"<!-- {name}: begin -->\n", f"<!-- {name}: end -->\n"
    before, _, rest = page.read_text(encoding="utf-8").partition(begin)
    _, _, after = rest.partition(end)
    page.write_text(before + begin + text + end + after, encoding="utf-8")
    print(f"Wrote {name} into {page.relative_to(ROOT)}")


def comparison_row(result):
    cells = [milliseconds(result.cpu["umpre"])]
    for name in PEERS:
        cells.append(milliseconds(result.cpu[name]) if name in result.cpu else result.failed[name])
    return cells


def write_comparison(results, start_up, runs):
    """Writes the tables of ratios, times and memory, and the plot of the ratios."""
    head = ["workload", "MB", "ratio", "goal", "fastest peer"]
    head += ["umpre", *PEERS, "umpre MB", "gcc MB"]
    rows = [
        [
            result.workload,
            megabytes(result.size),
            f"**{result.ratio():.1f}**",
            f"{GOALS[result.workload]:g}",
            result.best_peer(),
            *comparison_row(result),
            *(megabytes(result.memory[name]) for name in ("umpre", "gcc")),
        ]
        for result in results
    ]
    image = "![A bar for each workload: the ratio, with its goal](ratios.svg)\n\n"
    put("ratios", image + f"Medians of {runs} runs, times in milliseconds:\n\n" + table(head, rows))
    names = ["umpre", *PEERS]
    rows = [
        ["CPU time, ms", *(milliseconds(start_up.cpu[name]) for name in names)],
        ["memory, MB", *(megabytes(start_up.memory[name]) for name in names)],
    ]
    put("start-up", table(["empty file", *names], rows))
    data = "".join(
        f'"{row.workload}" {row.ratio():.2f} {GOALS[row.workload]} "{row.best_peer()}"\n'
        for row in results
    )
    plot("ratios", data)


@dataclass
class Growth:
    """What was measured on one workload in growing sizes."""

    results: list
    start_up: object

    def per_byte(self):
        """Returns the nanoseconds per byte at each size, start-up taken off."""
        base = self.start_up.cpu["umpre"]
        return [(result.cpu["umpre"] - base) / result.size * 1e9 for result in self.results]

    def spread(self):
        """Returns the worst time per byte divided by the smallest."""
        return max(self.per_byte()) / min(self.per_byte())

    def memory(self):
        """Returns the memory at the smallest and at the largest size."""
        return [megabytes(self.results[n].memory["umpre"]) for n in (0, -1)]

    def line(self):
        """Returns it as a line for the terminal."""
        times = " ".join(f"{ns:.2f}" for ns in self.per_byte())
        memory = " to ".join(self.memory())
        return f"{self.results[0].workload:<10} {self.spread():.2f}: {times} ns/byte; {memory} MB"


def write_growth(rows):
    """Writes the table of growing sizes and its plot."""
    head = ["workload", "MB at 8x", "ns per byte at 1x", "2x", "4x", "8x"]
    head += ["worst to smallest", "memory at 1x, MB", "8x"]
    lines = [
        [
            row.results[-1].workload,
            megabytes(row.results[-1].size),
            *(f"{ns:.2f}" for ns in row.per_byte()),
            f"{row.spread():.2f}",
            *row.memory(),
        ]
        for row in rows
    ]
    image = "![Lines of time against size for each workload](growth.svg)\n\n"
    put("growth", image + table(head, lines))
    blocks = [
        f'"{row.results[0].workload}"\n'
        + "".join(f"{r.size / 1e6:.3f} {r.cpu['umpre'] * 1000:.3f}\n" for r in row.results)
        for row in rows
    ]
    plot("growth", "\n\n".join(blocks))


def plot(name, data):
    """Draws docs/<name>.svg from these data as bench/<name>.gp says."""
    script = f"$data << END\n{data}END\n" + (ROOT / f"bench/{name}.gp").read_text()
    path = ROOT / f"docs/{name}.svg"
    picture = subprocess.run(["gnuplot"], input=script, capture_output=True, text=True, check=True)
    path.write_text(picture.stdout)
    print(f"Wrote {path.relative_to(ROOT)}")
