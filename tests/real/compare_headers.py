#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Preprocesses the public headers of a Debian package with umpre and with gcc and compares tokens.

Each header is included by a source of one line, and then every macro that it defines is used once,
function-like ones with as many arguments as they have parameters. The system headers are the stubs
beside this file, so that both programs read the same text. Line markers and white space do not
count. What differs because the languages differ is listed in differences.txt, one line each:

    HEADER  WHAT  reason

WHAT is "text" (what including the header gives), "error" (one program reports an error in this
header, the other does not) or the name of the macro whose use differs. A difference that is not
listed fails, and so does a listed one that is none any more. Exit status 77 says that the package
is not installed.
"""

import argparse
import difflib
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile

HERE = pathlib.Path(__file__).resolve().parent
GCC = ["gcc", "-E", "-undef", "-nostdinc", "-std=c17", "-x", "c"]
SOURCE = "source.src"
TOKEN = re.compile(
    rb"""(?:[uUL]|u8)?"(?:[^"\\\n]|\\.)*" | (?:[uUL])?'(?:[^'\\\n]|\\.)*'
    | \.?[0-9](?:[eEpP][+-]|[A-Za-z0-9_.])* | [A-Za-z_$][A-Za-z0-9_$]*
    | \.\.\. | <<= | >>= | -> | \+\+ | -- | << | >> | <= | >= | == | != | && | \|\|
    | [-+*/%&|^]= | \#\# | [^\s]""",
    re.VERBOSE,
)
MARKER = re.compile(rb'^#(?:line)? [0-9]+ "[^\n]*\n', re.MULTILINE)
USE = re.compile(rb"^use_of_([A-Za-z_]\w*) :", re.MULTILINE)
MACRO = re.compile(r"#(define|undef) ([A-Za-z_]\w*)(?:\(([^)]*)\))?")
ERROR = re.compile(r"^([^:\n]+):[0-9]+:(?:[0-9]+:)? (.*)$", re.MULTILINE)


def headers_of(package, folders):
    """Returns the package's headers in these folders (in all if there are none): name -> file.

    A header that stands under two names, one a link, is taken once, by its shorter name.
    """
    listing = subprocess.run(["dpkg", "-L", package], capture_output=True, text=True)
    names = {}
    for line in listing.stdout.splitlines():
        match = re.fullmatch(r"/usr/include/(?:[a-z0-9_]+-linux-gnu/)?(.+\.h)", line)
        if match and (not folders or match.group(1).rpartition("/")[0] in folders):
            names.setdefault(pathlib.Path(line).resolve(), []).append(match.group(1))
    return {min(found, key=len): path for path, found in sorted(names.items())}


def copy_headers(package, to):
    """Copies all headers of a package, so that nothing else of /usr/include is found."""
    for name, path in headers_of(package, []).items():
        copy = to / name
        copy.parent.mkdir(parents=True, exist_ok=True)
        shutil.copy(path, copy)


class Comparison:
    """The headers of one package, copied into a folder where both programs run."""

    def __init__(self, umpre, folder):
        self.umpre = umpre
        self.folder = folder
        self.includes = [f"-I{HERE / 'stubs'}", f"-I{folder / 'include'}"]
        listing, _ = self.run([*GCC, "-dM", "/dev/null"])
        words = [line.split(" ", 2) for line in listing.decode().splitlines()]
        self.definitions = [f"-D{word[1]}={' '.join(word[2:])}" for word in words]

    def run(self, command):
        """Runs a preprocessor. Returns its output and the headers in which it found errors."""
        done = subprocess.run(
            command, cwd=self.folder, stdin=subprocess.DEVNULL, capture_output=True
        )
        messages = done.stderr.decode("latin-1")
        if done.returncode not in (0, 1) or "fatal error:" in messages:
            sys.exit(f"{command[0]} ended with status {done.returncode}:\n{messages}")
        errors = set()
        for path, message in ERROR.findall(messages):
            if not message.lower().startswith(("warning: ", "note: ")):
                errors.add(path.removeprefix(f"{self.folder / 'include'}/"))
        return done.stdout, errors

    def uses(self, header):
        """Returns one line of use for each macro that the header itself leaves defined."""
        listing, _ = self.run([*GCC, "-dD", *self.includes, SOURCE])
        here, uses = False, {}
        for line in listing.decode("latin-1").splitlines():
            if line.startswith("# "):
                here = line.split('"')[1] == str(self.folder / "include" / header)
            elif here and (match := MACRO.match(line)):
                word, name, parameters = match.groups()
                uses.pop(name, None)
                if word == "define":
                    uses[name] = f"use_of_{name} : {name}{arguments_for(parameters)} ;\n"
        return "".join(uses.values())

    def compare(self, header):
        """Returns what differs: (header, what) -> the difference, to be shown."""
        source = self.folder / SOURCE
        source.write_text(f"#include <{header}>\n")
        uses = self.uses(header)
        source.write_text(f"#include <{header}>\n{uses}")
        expected, expected_errors = self.run([*GCC, *self.includes, SOURCE])
        actual, errors = self.run([self.umpre, *self.includes, *self.definitions, SOURCE])
        expected, actual = parts(expected), parts(actual)
        found = {}
        for what in sorted(expected.keys() | actual.keys()):
            if expected.get(what) != actual.get(what):
                found[header, what] = diff(expected.get(what, []), actual.get(what, []))
        for place in expected_errors ^ errors:
            who = "umpre" if place in errors else "gcc"
            found[header if place == SOURCE else place, "error"] = f"only {who} reports an error"
        return found


def arguments_for(parameters):
    """Returns the parenthesised arguments that a macro with these parameters takes."""
    if parameters is None:
        return ""
    count = len(parameters.split(",")) if parameters.strip() else 0
    return "(" + ", ".join(f"argument{n + 1}" for n in range(count)) + ")"


def parts(output):
    """Cuts an output: "text" -> tokens of the header, macro name -> tokens of its use."""
    pieces = USE.split(MARKER.sub(b"", output))
    result = {"text": TOKEN.findall(pieces[0])}
    for name, use in zip(pieces[1::2], pieces[2::2]):
        result[name.decode()] = TOKEN.findall(use)
    return result


def diff(expected, actual):
    """Returns two token sequences as a unified diff, a token on each line."""
    texts = [[token.decode("latin-1") for token in tokens] for tokens in (expected, actual)]
    return "\n".join(difflib.unified_diff(*texts, "gcc", "umpre", n=4, lineterm=""))


def listed_differences():
    """Returns the differences that are meant, as (header, what)."""
    lines = (HERE / "differences.txt").read_text().splitlines()
    return {tuple(line.split()[:2]) for line in lines if line and not line.startswith("#")}


def check(umpre, package, folders):
    """Compares the headers of a package. Returns whether all is as listed."""
    headers = headers_of(package, folders)
    if not headers:
        print(f"{package} is not installed")
        sys.exit(77)
    found = {}
    with tempfile.TemporaryDirectory() as folder:
        copy_headers(package, pathlib.Path(folder) / "include")
        comparison = Comparison(umpre, pathlib.Path(folder))
        for header in headers:
            found.update(comparison.compare(header))
    listed = listed_differences()
    wrong = [f"{key[0]}: {key[1]} differs:\n{found[key]}" for key in found if key not in listed]
    stale = {key for key in listed if key[0] in headers} - found.keys()
    wrong += [f"{header}: {what} is listed but does not differ" for header, what in sorted(stale)]
    print("\n".join(wrong + [f"{package}: {len(headers)} headers compared"]))
    return not wrong


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--umpre", default="build/release/umpre", help="the program to test")
    parser.add_argument("package", help="a Debian package with C headers")
    parser.add_argument("folders", nargs="*", help="only these folders below /usr/include")
    arguments = parser.parse_args()
    umpre = shutil.which(arguments.umpre)
    if umpre is None:
        sys.exit(f"no such program: {arguments.umpre}")
    good = check(str(pathlib.Path(umpre).resolve()), arguments.package, arguments.folders)
    sys.exit(0 if good else 1)


if __name__ == "__main__":
    main()
