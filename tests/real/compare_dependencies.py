#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Holds umpre-deps against gcc -M: both must name the same files for each header of a package.

The headers and the stubs beside this file are all that both can find. A header in which one of them
reports an error is passed over, as gcc then writes no rule. Exit status 77 says that the package is
not installed.
"""

import argparse
import pathlib
import subprocess
import sys
import tempfile

import compare_headers


def files_in(rule):
    """Returns what the rule's target depends on."""
    return sorted(set(rule.replace("\\\n", " ").split()[1:]))


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--deps", required=True, help="the program umpre-deps")
    parser.add_argument("package", help="a Debian package with C headers")
    arguments = parser.parse_args()
    headers = compare_headers.headers_of(arguments.package, [])
    if not headers:
        sys.exit(77)
    compared, wrong = 0, []
    with tempfile.TemporaryDirectory() as name:
        folder = pathlib.Path(name)
        compare_headers.copy_headers(arguments.package, folder / "include")
        comparison = compare_headers.Comparison(arguments.deps, folder)
        for header in headers:
            (folder / "source.c").write_text(f"#include <{header}>\n")
            done = [subprocess.run([*command, *comparison.includes, "source.c"], cwd=folder,
                                   capture_output=True, text=True)
                    for command in ([arguments.deps, *comparison.definitions],
                                    [*compare_headers.GCC, "-M"])]
            if all(run.returncode == 0 for run in done):
                compared += 1
                ours, theirs = (files_in(run.stdout) for run in done)
                if ours != theirs:
                    wrong.append(f"{header}:\n  umpre-deps {ours}\n  gcc -M {theirs}")
    print("\n".join(wrong + [f"{arguments.package}: the files of {compared} headers compared"]))
    sys.exit(1 if wrong or not compared else 0)


if __name__ == "__main__":
    main()
