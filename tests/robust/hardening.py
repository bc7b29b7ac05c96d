#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks that the guards of cmake/Harden.cmake are in programs."""

import pathlib
import platform
import re
import subprocess
import sys

ENDBR64 = b"\xf3\x0f\x1e\xfa"  # where an indirect jump may go


def readelf(program, *options):
    return subprocess.run(["readelf", "--wide", *options, program], capture_output=True, text=True,
                          check=True, env={"LC_ALL": "C", "PATH": "/usr/bin:/bin"}).stdout


def missing(program):
    """Yields what a program lacks."""
    headers, dynamic = readelf(program, "--file-header", "--segments"), readelf(program, "--dynamic")
    symbols = readelf(program, "--dyn-syms")
    if not re.search(r"Type:\s+DYN", headers) or "PIE" not in dynamic:
        yield "it is loaded at one address always"
    if "GNU_RELRO" not in headers:
        yield "nothing is read-only after linking"
    if not re.search(r"\(FLAGS_1\).*\bNOW\b", dynamic):
        yield "the dynamic linker goes on filling in while it runs"
    if not re.search(r"GNU_STACK.*\sRW\s", headers):
        yield "its stack can be executed"
    if "__stack_chk_fail" not in symbols:
        yield "no return address is guarded"
    if platform.machine() == "x86_64" and pathlib.Path(program).read_bytes().count(ENDBR64) < 50:
        yield "targets of jumps are not marked"
    if re.search(r"\((RPATH|RUNPATH|TEXTREL)\)", dynamic):
        yield "it says where libraries are, or its code is written to"


def main():
    wrong = [f"{program}: {what}" for program in sys.argv[1:] for what in missing(program)]
    print("\n".join(wrong) or f"{len(sys.argv) - 1} programs are hardened")
    return 1 if wrong or len(sys.argv) < 2 else 0


if __name__ == "__main__":
    sys.exit(main())
