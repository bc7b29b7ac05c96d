#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Runs the golden cases: tests/cases/**/*.case and the umpre-case blocks of the documentation.

The program runs in an empty folder that holds just the files of the case. What it then did is
written down as a case again. The two are equal, or the case has failed; their difference is what
is shown, and --update puts the second in the place of the first. docs/testing.md has the format.
"""

import argparse
import collections
import concurrent.futures
import difflib
import os
import pathlib
import re
import resource
import shlex
import signal
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent
LIMIT = 20
PROGRAMS = ["umpre", "umpre-lines", "umpre-deps"]
ORDER = ["run", "file", "input", "output", "errors", "written", "status"]
HEADER = re.compile(r"(run|status): \S.*|(file|written) \S.*:|(input|output|errors):")
MARK = re.compile(r"<(SP|TAB|VT|FF|CR|NUL|LT|END|ANY|x[0-9A-F]{2})>")
BYTES = {"SP": " ", "TAB": "\t", "VT": "\v", "FF": "\f", "CR": "\r", "NUL": "\0", "LT": "<",
         "END": "", "ANY": "\uE000"}
MARKS = {byte: f"<{mark}>" for mark, byte in BYTES.items()}
# The lines of a case stand in the file `path`, after `start` others.
Case = collections.namedtuple("Case", "name path start lines")


def program_of(case):
    """Returns the program that a case runs; nothing if it is not exactly one."""
    runs = [line for line in case.lines if line.startswith("run: ")]
    return shlex.split(runs[0])[1] if len(runs) == 1 else None


def path_for(case, umpre):
    """Returns where the program is that a case runs: others than umpre lie beside it."""
    name = program_of(case)
    return umpre if name == "umpre" else os.path.join(os.path.dirname(umpre), name)


def parse(case):
    """Returns the title and the sections of a case: lines of content by headers."""
    title, sections = [], {}
    for number, line in enumerate(case.lines, case.start + 1):
        where = f"{case.path.relative_to(ROOT)}:{number}: "
        if line != line.rstrip():
            raise ValueError(where + "the line ends in an invisible blank")
        if HEADER.fullmatch(line) and line not in sections:
            sections[line] = content = []
        elif not sections:
            title.append(line)
        elif re.fullmatch(r"\|( [ -~]+)?", line):
            content.append(line[2:])
        elif line:
            raise ValueError(where + "neither a new section nor a bar, a blank and visible text")
    if case.path.suffix == ".case" and not "".join(title):
        raise ValueError("a case opens with a title")
    if program_of(case) not in PROGRAMS:
        raise ValueError("a case has one line `run: umpre ...`, or of a program beside it")
    return "\n".join(title).strip(), sections


def text_of(sections):
    """Returns the lines of each section, in the order in which sections stand in a case."""
    headers = sorted(sections, key=lambda header: ORDER.index(re.match("[a-z]+", header)[0]))
    return [[header] + [f"| {line}".rstrip() for line in sections[header]] for header in headers]


def meaning(line, expected=True):
    """Returns what a line of content stands for, one character for each byte."""
    def replace(mark):
        kind = mark[1]
        if kind == "END" and mark.end() < len(line) or kind == "ANY" and not expected:
            raise ValueError(f"<{kind}> cannot stand here: {line}")
        return BYTES[kind] if kind in BYTES else chr(int(kind[1:], 16))
    return MARK.sub(replace, line) + ("" if line.endswith("<END>") else "\n")


def given(lines):
    return "".join(meaning(line, expected=False) for line in lines).encode("latin-1")


def marked(text):
    """Returns text with marks for all that cannot be seen."""
    text = MARK.sub(lambda mark: "<LT>" + mark[0][1:], text)
    text = re.sub("[^ -~]", lambda c: MARKS.get(c[0], f"<x{ord(c[0]):02X}>"), text)
    return re.sub("^ | $", "<SP>", text)


def observed(data, expected):
    """Returns bytes as lines of content, written as in `expected` where that says the same."""
    lines = []
    for index, raw in enumerate(re.findall("[^\n]*\n|[^\n]+", data.decode("latin-1"))):
        candidates = expected[index:index + 1] + [line for line in expected if line != "<ANY>"]
        plain = marked(raw[:-1]) if raw.endswith("\n") else marked(raw) + "<END>"
        lines.append(next((line for line in candidates if re.fullmatch(
            re.escape(meaning(line)).replace(BYTES["ANY"], "[^\n]*"), raw)), plain))
    return lines


def execute(sections, command, folder):
    """Runs the program in `folder`. Returns status, output, errors and the files by their names."""
    for header, content in sections.items():
        if header.startswith("file"):
            path = folder / os.fsdecode(given([header[5:-1] + "<END>"]))
            path.parent.mkdir(parents=True, exist_ok=True)
            path.write_bytes(given(content))
        if header.startswith("run"):
            words = [given([word + "<END>"]) for word in shlex.split(header)[2:]]
    kept = {key: os.environ[key] for key in os.environ if key == "PATH" or key.endswith("_OPTIONS")}
    try:
        done = subprocess.run(command + words, capture_output=True, cwd=folder,
                              input=given(sections.get("input:", [])),
                              env={**kept, "LC_ALL": "C", "TZ": "UTC"}, timeout=LIMIT, check=False)
    except subprocess.TimeoutExpired as late:
        return f"none after {LIMIT} s", late.stdout or b"", late.stderr or b"", {}
    files = {marked(os.fsencode(path.relative_to(folder)).decode("latin-1")): path.read_bytes()
             for path in sorted(folder.rglob("*")) if path.is_file()}
    status = done.returncode
    return signal.Signals(-status).name if status < 0 else status, done.stdout, done.stderr, files


def outcome(sections, command):
    """Returns the sections with what a run gives in the place of what it should give."""
    with tempfile.TemporaryDirectory(prefix="umpre-case-") as folder:
        status, output, errors, files = execute(sections, command, pathlib.Path(folder))
    result, before = {}, {"output:": b"", "errors:": b""}
    for header, content in sections.items():
        if header.startswith(("run", "file", "input")):
            result[header] = content
            before[header.replace("file", "written", 1)] = given(content)
    found = {f"written {name}:": data for name, data in files.items()}
    for header, data in {"output:": output, "errors:": errors, **found}.items():
        if header in sections or data != before.get(header):
            result[header] = observed(data, sections.get(header, []))
    if status != 0 or "status: 0" in sections:
        result[f"status: {status}"] = []
    return result


def run(case, command):
    """Returns how a case differs from what happened, and the lines that would say what did."""
    try:
        title, sections = parse(case)
        result = outcome(sections, [*command[:-1], path_for(case, command[-1])])
    except ValueError as why:
        return f"--- {case.name}\n{why}\n", None
    before, after = (sum(text_of(part), []) for part in (sections, result))
    difference = difflib.unified_diff(before, after, case.name, "what happened", lineterm="")
    blocks = [title] * bool(title) + ["\n".join(lines) for lines in text_of(result)]
    return "".join(line + "\n" for line in difference), "\n\n".join(blocks).split("\n")


def find_cases():
    cases = []
    for path in sorted(ROOT.glob("tests/cases/**/*.case")):
        name = str(path.relative_to(ROOT / "tests/cases").with_suffix(""))
        cases.append(Case(name, path, 0, path.read_text("utf-8").split("\n")[:-1]))
    for path in sorted(ROOT.glob("*.md")) + sorted(ROOT.glob("docs/*.md")):
        lines = path.read_text("utf-8").split("\n")
        starts = [at for at, line in enumerate(lines, 1) if line == "```umpre-case"]
        for number, start in reversed(list(enumerate(starts, 1))):  # an update moves what follows
            cases.append(Case(f"{path.stem.lower()}/{number}", path, start,
                              lines[start:lines.index("```", start)]))
    return cases


def main():
    parser = argparse.ArgumentParser(description="Run golden cases, all or those that are named.")
    parser.add_argument("--umpre", default=str(ROOT / "build/release/umpre"), help="the program")
    parser.add_argument("--under", default="", help="a command to run the program under")
    parser.add_argument("--jobs", type=int, default=os.cpu_count(), help="cases at a time")
    parser.add_argument("--update", action="store_true", help="fill in what the program does")
    parser.add_argument("--list", action="store_true", help="print the names of the cases")
    parser.add_argument("--exact", action="store_true", help="a NAME is a whole name, not a part")
    parser.add_argument("names", metavar="NAME", nargs="*", help="cases with NAME in their name")
    options = parser.parse_args()
    cases = [case for case in find_cases() if not options.names or any(
        case.name == name if options.exact else name in case.name for name in options.names)]
    if options.list:
        print("\n".join(case.name for case in cases))
        return 0
    command = shlex.split(options.under) + [os.path.abspath(options.umpre)]
    if not os.access(command[-1], os.X_OK):
        sys.exit(f"run_cases.py: there is no program {command[-1]}")
    # A build need not have all the programs.
    cases = [case for case in cases if program_of(case) not in PROGRAMS
             or os.access(path_for(case, command[-1]), os.X_OK)]
    resource.setrlimit(resource.RLIMIT_CORE, (0, 0))  # a core would be one more file
    failed = 0
    with concurrent.futures.ThreadPoolExecutor(options.jobs) as pool:
        results = pool.map(lambda case: run(case, command), cases)
        for number, (case, (difference, lines)) in enumerate(zip(cases, results), 1):
            if sys.stderr.isatty():
                sys.stderr.write(f"\r{number}/{len(cases)}" + "\n" * (number == len(cases)))
            failed += bool(difference)
            print(difference, end="\n" if difference else "")
            if difference and lines and options.update:
                page = case.path.read_text("utf-8").split("\n")
                page[case.start:case.start + len(case.lines)] = lines
                case.path.write_text("\n".join(page), "utf-8")
    print(f"{len(cases) - failed} passed, {failed} failed")
    return 1 if failed or not cases else 0


if __name__ == "__main__":
    sys.exit(main())
