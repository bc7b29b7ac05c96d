#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks what happens when the output, or a standard stream, cannot be used.

The shell sets each situation up, as it does for users: "$0" is the program, `>&-` closes standard
output, /dev/full takes nothing.
"""

import argparse
import pathlib
import subprocess
import sys
import tempfile

NO_STDOUT = "umpre: cannot write to standard output\n"
SHORT = "text\n"
LONG = "text\n" * 200_000  # more than any block that collects output
WRONG = "#endif\n"  # gives a message

# Title, source, shell command, status, messages, what the file "out" must hold (None: is not read).
SITUATIONS = [
    ("full standard output", SHORT, '"$0" main.src >/dev/full', 1, NO_STDOUT, None),
    ("full standard output, long", LONG, '"$0" main.src >/dev/full', 1, NO_STDOUT, None),
    ("closed standard output", SHORT, '"$0" main.src >&-', 1, NO_STDOUT, None),
    ("closed standard output, long", LONG, '"$0" main.src >&-', 1, NO_STDOUT, None),
    (
        "full standard output, endless input",
        SHORT,
        'yes text | "$0" >/dev/full',
        1,
        NO_STDOUT,
        None,
    ),
    (
        "full output file",
        SHORT,
        '"$0" -o /dev/full main.src',
        1,
        "umpre: cannot write output file '/dev/full'\n",
        None,
    ),
    (
        "full output file, long",
        LONG,
        '"$0" -o /dev/full main.src',
        1,
        "umpre: cannot write output file '/dev/full'\n",
        None,
    ),
    (
        "closed standard output, but an output file",
        SHORT,
        '"$0" -o out main.src >&-',
        0,
        "",
        '#line 1 "main.src"\ntext\n',
    ),
    (
        "closed standard input, but a source",
        SHORT,
        '"$0" main.src <&- >out',
        0,
        "",
        '#line 1 "main.src"\ntext\n',
    ),
    (
        "closed error stream: messages do not get into the output file",
        WRONG,
        '"$0" -o out main.src 2>&-',
        1,
        "",
        '#line 1 "main.src"\n\n',
    ),
]


def check(umpre, title, source, command, status, messages, output):
    """Runs one situation. Returns whether it came out as it must."""
    with tempfile.TemporaryDirectory() as name:
        folder = pathlib.Path(name)
        (folder / "main.src").write_text(source)
        done = subprocess.run(
            ["sh", "-c", command, umpre], cwd=folder, capture_output=True, text=True
        )
        written = (folder / "out").read_text() if output is not None else None
    if (done.returncode, done.stderr, written) == (status, messages, output):
        return True
    print(f"{title}: status {done.returncode}\n{done.stderr}out: {written!r}")
    return False


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--umpre", required=True, help="the program to test")
    umpre = str(pathlib.Path(parser.parse_args().umpre).resolve())
    good = [check(umpre, *situation) for situation in SITUATIONS]
    sys.exit(0 if all(good) else 1)


if __name__ == "__main__":
    main()
