#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Runs the rows of tests/robust/*.rows: hostile input and failing surroundings, within limits.

A row is a golden case with a shell command, marks for what is repeated, and limits of time and
memory. docs/testing.md has the format. Each row runs in a process of its own, whose memory does not
hide the program's.
"""

import argparse
import collections
import concurrent.futures
import os
import pathlib
import re
import resource
import signal
import subprocess
import sys
import tempfile
import time

HERE = pathlib.Path(__file__).resolve().parent
sys.path.insert(0, str(HERE.parent))
import run_cases  # noqa: E402

LARGE = "large"  # the topic that a run leaves out unless it is asked for
HEADER = re.compile(r"(run|status|limits|needs): (\S.*)|(file|written) (\S+):|(output|errors):")
CONTENT = re.compile(r"(?:(\d+)\* )?\|(?: (.*))?")
REPEAT = re.compile(r"\{(\d+)\*([^{}]*)\}")
NUMBER = re.compile(r"%N(\+1|-1)?")
LIMITS = re.compile(r"([\d.]+) s, (\d+) MB")
MEGABYTE = 1 << 20
PORTION = 1000  # lines
Row = collections.namedtuple("Row", "name title sections")


def parse(path):
    """Returns the rows of a file."""
    rows = []
    for number, line in enumerate(path.read_text("utf-8").split("\n"), 1):
        header, content = HEADER.fullmatch(line), CONTENT.fullmatch(line)
        if line.startswith("## "):
            rows.append(Row(f"{path.stem}/{line[3:]}", [], {"status": "0", "limits": "1 s, 16 MB"}))
        elif header and header[1]:
            rows[-1].sections[header[1]] = header[2]
        elif header:
            rows[-1].sections[line] = lines = []
        elif content and rows and "run" in rows[-1].sections:
            lines.append((int(content[1] or 1), content[2] or ""))
        elif rows and "run" not in rows[-1].sections:
            rows[-1].title.append(line)
        elif line and rows:
            raise ValueError(f"{path.name}:{number}: neither a header nor a line of content")
    return rows


def numbered(text, first, last):
    """Returns a text for each number from `first` to `last`, with its %N, %N+1 and %N-1 filled in."""
    if not NUMBER.search(text):
        return text * (last - first + 1)
    place = NUMBER.sub(lambda mark: "{%d}" % {"+1": 2, "-1": 0}.get(mark[1], 1),
                       text.replace("{", "{{").replace("}", "}}"))
    return "".join(place.format(n - 1, n, n + 1) for n in range(first, last + 1))


def texts(lines):
    """Yields the text that lines of content stand for, one character for each byte, in portions."""
    for count, line in lines:
        line = REPEAT.sub(lambda mark: numbered(mark[2], 1, int(mark[1])), line)
        for first in range(1, count + 1, PORTION):
            yield numbered(run_cases.meaning(line), first, min(first + PORTION - 1, count))


def agree(expected, found):
    """Tells whether bytes are as expected, where <ANY> stands for the rest of a line."""
    mark = run_cases.BYTES["ANY"]
    if mark not in expected:
        return expected.encode("latin-1") == found
    pattern = re.escape(expected).replace(re.escape(mark), "[^\n]*")
    return re.fullmatch(pattern, found.decode("latin-1")) is not None


def limit(memory, seconds, sanitized):
    """Sets the limits of a row's processes; far beyond what the row allows, as a net."""
    resource.setrlimit(resource.RLIMIT_CORE, (0, 0))
    resource.setrlimit(resource.RLIMIT_CPU, (int(2 * seconds) + 2, int(2 * seconds) + 2))
    if not sanitized:
        resource.setrlimit(resource.RLIMIT_STACK, (MEGABYTE, MEGABYTE))
        resource.setrlimit(resource.RLIMIT_AS, (2 * memory + 256 * MEGABYTE,) * 2)


def execute(row, umpre, folder, options):
    """Runs a row's command. Returns its status and what it used, as (seconds, megabytes)."""
    seconds, megabytes = map(float, LIMITS.fullmatch(row.sections["limits"]).groups())
    seconds, megabytes = seconds * options.slack, megabytes * options.slack
    kept = {key: os.environ[key] for key in os.environ if key.endswith("_OPTIONS")}
    path = f"{folder / 'bin'}:/usr/bin:/bin"
    (folder / "bin").mkdir()
    (folder / "bin/umpre").symlink_to(umpre)
    with open(folder / "output", "wb") as output, open(folder / "errors", "wb") as errors:
        child = subprocess.Popen(
            ["bash", "-o", "pipefail", "-c", row.sections["run"]], cwd=folder / "row",
            stdin=subprocess.DEVNULL, stdout=output, stderr=errors, start_new_session=True,
            env={**kept, "LC_ALL": "C", "TZ": "UTC", "PATH": path},
            preexec_fn=lambda: limit(int(megabytes * MEGABYTE), seconds, options.slack > 1))
        deadline = time.monotonic() + 10 * seconds + 20
        pid, status, usage = 0, 0, None
        while pid == 0:
            pid, status, usage = os.wait4(child.pid, os.WNOHANG)
            if pid == 0 and time.monotonic() > deadline:
                os.killpg(child.pid, signal.SIGKILL)
                os.wait4(child.pid, 0)
                return "none: it had to be stopped", 0, 0, ["took too long"]
            time.sleep(0 if pid else 0.005)
        child.returncode = status
    code = os.waitstatus_to_exitcode(status)
    used, peak = usage.ru_utime + usage.ru_stime, usage.ru_maxrss / 1024
    wrong = [f"took {used:.2f} s, {seconds:g} s are allowed"] * (used > seconds)
    wrong += [f"took {peak:.0f} MB, {megabytes:g} MB are allowed"] * (peak > megabytes)
    return str(code if code >= 0 else 128 - code), used, peak, wrong


def difference(found, expected):
    """Returns where two texts part, and how they go on there."""
    same = len(os.path.commonprefix([found, expected]))
    start = max(same - 40, 0)
    for title, text in ("is", found), ("should be", expected):
        more = " ..." * (len(text) > same + 80)
        yield f"  {title}, from byte {start}: " + run_cases.marked(text[start:same + 80]) + more


def run(row, umpre, options):
    """Runs a row here. Returns what is wrong, and what the row used."""
    with tempfile.TemporaryDirectory(prefix="umpre-row-") as name:
        folder = pathlib.Path(name)
        (folder / "row").mkdir()
        for header, content in row.sections.items():
            if header.startswith("file "):
                path = folder / "row" / header[5:-1]
                path.parent.mkdir(parents=True, exist_ok=True)
                with open(path, "wb") as file:
                    for text in texts(content):
                        file.write(text.encode("latin-1"))
        status, used, peak, wrong = execute(row, umpre, folder, options)
        if status != row.sections["status"]:
            wrong.append(f"status {status}, not {row.sections['status']}")
        places = {"output:": folder / "output", "errors:": folder / "errors"}
        for header in row.sections:
            if header.startswith("written "):
                places[header] = folder / "row" / header[8:-1]
        for header, path in places.items():
            found = path.read_bytes() if path.is_file() else b"(no such file)"
            expected = "".join(texts(row.sections.get(header, [])))
            if not agree(expected, found):
                wrong += [header, *difference(found.decode("latin-1"), expected)]
    return wrong, used, peak


def missing(row):
    """Returns what a row needs and is not there; a row needs what a shell command says."""
    needs = row.sections.get("needs")
    return needs and subprocess.run(["bash", "-c", needs], capture_output=True).returncode != 0


def run_here(row, umpre, options):
    if missing(row):
        print(f"skipped {row.name}: this machine has not: {row.sections['needs']}")
        return 77
    wrong, used, peak = run(row, umpre, options)
    print(f"{'FAILED' if wrong else 'passed'} {row.name} ({used:.2f} s, {peak:.0f} MB)")
    for line in wrong:
        print(f"  {line}")
    return 1 if wrong else 0


def run_apart(row, arguments):
    command = [sys.executable, __file__, "--here", *arguments, row.name]
    done = subprocess.run(command, stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True)
    return done.returncode, done.stdout


def main():
    parser = argparse.ArgumentParser(description="Run robustness rows, all or those that are named.")
    parser.add_argument("--umpre", default="build/release/umpre", help="the program")
    parser.add_argument("--slack", type=float, default=1, help="multiplies the limits")
    parser.add_argument("--jobs", type=int, default=os.cpu_count(), help="rows at a time")
    parser.add_argument("--large", action="store_true", help="the large rows, too")
    parser.add_argument("--list", action="store_true", help="print the names of all rows")
    parser.add_argument("--here", action="store_true", help="the one row NAME, in this process")
    parser.add_argument("names", metavar="NAME", nargs="*", help="rows with NAME in their name")
    options = parser.parse_args()
    rows = [row for path in sorted(HERE.glob("*.rows")) for row in parse(path)]
    if options.list:
        print("\n".join(row.name for row in rows))
        return 0
    umpre = os.path.abspath(options.umpre)
    if not os.access(umpre, os.X_OK):
        sys.exit(f"run.py: there is no program {umpre}")
    if options.here:
        return run_here(next(row for row in rows if row.name == options.names[0]), umpre, options)
    chosen = [row for row in rows if any(name in row.name for name in options.names)
              or not options.names and (options.large or not row.name.startswith(LARGE + "/"))]
    arguments = ["--umpre", umpre, "--slack", str(options.slack)]
    counts = collections.Counter()
    with concurrent.futures.ThreadPoolExecutor(options.jobs) as pool:
        for status, text in pool.map(lambda row: run_apart(row, arguments), chosen):
            print(text, end="", flush=True)
            counts[{0: "passed", 77: "skipped"}.get(status, "failed")] += 1
    skipped = f", {counts['skipped']} skipped" if counts["skipped"] else ""
    print(f"{counts['passed']} passed, {counts['failed']} failed{skipped}")
    return 1 if counts["failed"] or not chosen else 0


if __name__ == "__main__":
    sys.exit(main())
