#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Has umpre-lines read a line that is longer than there is memory for what may be a line marker."""

import argparse
import resource
import subprocess
import sys
import tempfile

MEGABYTE = 1 << 20
MEMORY = 128 * MEGABYTE
MESSAGE = b"out of dynamic memory in yy_create_buffer()\n"


def limit():
    resource.setrlimit(resource.RLIMIT_CORE, (0, 0))
    resource.setrlimit(resource.RLIMIT_AS, (MEMORY, MEMORY))


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--lines", required=True, help="the program umpre-lines")
    arguments = parser.parse_args()
    with tempfile.TemporaryFile() as text:
        text.write(b'#line 1 "')
        text.truncate(2 * MEMORY)  # zero bytes, which take no room
        text.seek(0)
        done = subprocess.run([arguments.lines, "--strip"], stdin=text, stdout=subprocess.DEVNULL,
                              stderr=subprocess.PIPE, preexec_fn=limit)
    print(f"status {done.returncode}, {done.stderr!r}")
    sys.exit(done.returncode != 2 or done.stderr != MESSAGE)


if __name__ == "__main__":
    main()
