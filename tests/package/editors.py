#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Gives real messages of umpre to what docs/editors.md says an editor should read them with."""

import argparse
import json
import pathlib
import re
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
SOURCE = '#define N 1\n#define N 2\ntext\n#endif\n#line 7 "a b.inc"\n#error stop: 5: here\n/*\n'
# File, line, severity and text of what a reader must find in the messages for SOURCE.
FOUND = [
    ("main.src", 3, "warning", 'Macro "N" has an incompatible redefinition'),
    ("main.src", 4, "error", 'No "#if" directive associated to "#endif"'),
    ("a b.inc", 8, "error", "#error directive:  stop: 5: here"),
]
FATAL = "cannot open missing.src"


def block(language):
    """Returns the one block of the page in this language."""
    page = (ROOT / "docs/editors.md").read_text("utf-8")
    (found,) = re.findall(rf"^```{language}\n(.*?)^```", page, re.MULTILINE | re.DOTALL)
    return found


def messages_of(umpre, folder):
    """Returns what umpre says about SOURCE, and about a source that is not there."""
    (folder / "main.src").write_text(SOURCE)
    run = [subprocess.run([umpre, name], cwd=folder, capture_output=True, text=True)
           for name in ["main.src", "missing.src"]]
    return [done.stderr for done in run]


def found_by_vs_code(messages, matchers):
    found = []
    for line in messages.splitlines():
        for matcher in matchers:
            pattern = matcher["pattern"]
            match = re.search(pattern["regexp"], line)
            if match:
                place = int(match[pattern["line"]]) if "line" in pattern else 0
                weight = match[pattern["severity"]] if "severity" in pattern else None
                found.append((match[pattern["file"]], place, (weight or matcher["severity"]).lower(),
                              match[pattern["message"]]))
                break
    return found


def check_vs_code(umpre, folder):
    matchers = json.loads(block("json"))["tasks"][0]["problemMatcher"]
    messages, fatal = messages_of(umpre, folder)
    return (found_by_vs_code(messages, matchers) == FOUND
            and found_by_vs_code(fatal, matchers) == [("missing.src", 0, "error", FATAL)])


def found_by_vim(vim, messages, folder):
    (folder / "messages").write_text(messages)
    (folder / "script.vim").write_text(
        block("vim") + "cgetfile messages\n"
        "let found = filter(getqflist(), 'v:val.valid')\n"
        "let lines = map(found, 'json_encode([bufname(v:val.bufnr), v:val.lnum, v:val.type,"
        " v:val.text])')\n"
        "call writefile(lines, 'found')\nqall!\n")
    subprocess.run([vim, "-N", "-u", "NONE", "-i", "NONE", "-es", "-S", "script.vim"], cwd=folder,
                   stdin=subprocess.DEVNULL, timeout=60, check=True)
    return [tuple(json.loads(line)) for line in (folder / "found").read_text().splitlines()]


def check_vim(vim, umpre, folder):
    messages, fatal = messages_of(umpre, folder)
    weights = {"warning": "W", "error": ""}
    expected = [(file, line, weights[weight], text) for file, line, weight, text in FOUND]
    last = found_by_vim(vim, fatal, folder)
    return (found_by_vim(vim, messages, folder) == expected
            and [(line[0], line[3]) for line in last] == [("", FATAL)])


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--umpre", required=True, help="the program")
    parser.add_argument("--vim", help="the editor to ask, instead of reading the matcher of VS Code")
    arguments = parser.parse_args()
    with tempfile.TemporaryDirectory(prefix="umpre-editors-") as name:
        folder = pathlib.Path(name)
        good = (check_vim(arguments.vim, arguments.umpre, folder) if arguments.vim
                else check_vs_code(arguments.umpre, folder))
    sys.exit(0 if good else "not all was found")


if __name__ == "__main__":
    main()
