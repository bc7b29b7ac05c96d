#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks what holds for every input on inputs made at random, from fixed seeds."""

import argparse
import os
import pathlib
import random
import re
import subprocess
import sys
import tempfile

MARKER = re.compile(rb'#line (\d+) "((?:[^"\\]|\\.)*)"')
BLANK_LINE = re.compile(rb"^[ \t\v\f]+$", re.MULTILINE)
WORD = re.compile(rb"w\d+w")


class InputError(Exception):
    """Something was reported about the source."""


def preprocessed(umpre, folder, files):
    """Returns what comes out for the file main, in which there must be nothing to report."""
    for name, text in files.items():
        path = folder / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_bytes(text)
    done = subprocess.run([umpre, "-Iinc", "main"], cwd=folder, capture_output=True, check=False)
    if done.returncode not in (0, 1):
        raise AssertionError(f"{files!r} ended with status {done.returncode}")
    if done.returncode != 0 or done.stderr:
        raise InputError(f"{files!r} gave status {done.returncode}, errors {done.stderr!r}")
    return done.stdout


def plain_text(generator):
    """Returns lines of any bytes that do nothing: no directive, comment, continuation or macro."""
    allowed = bytes(set(range(256)) - set(b'#/\\\r\n_'))
    common = b"abcxyzN0189 \t()+,\"'.;"
    lines = []
    for _ in range(generator.randrange(1, 40)):
        alphabet = generator.choice((allowed, common))
        length = generator.choice((0, 1, generator.randrange(80), generator.randrange(2000)))
        lines.append(bytes(generator.choices(alphabet, k=length)))
    return b"\n".join(lines) + b"\n"


def stays_itself(umpre, folder, generator):
    """Text in which nothing means anything comes out as it is, after one line marker; but a line of
    blanks comes out empty."""
    text = plain_text(generator)
    found = preprocessed(umpre, folder, {"main": text})
    expected = b'#line 1 "main"\n' + BLANK_LINE.sub(b"", text)
    if found != expected:
        raise AssertionError(f"{text!r} became {found!r}")


class Words:
    """Lines of text whose words occur nowhere else, with where each of them stands."""

    def __init__(self, generator):
        self.generator = generator
        self.places = {}
        self.files = {}

    def word(self, name, line, meant=True):
        word = b"w%dw" % (len(self.places) + 1)
        self.places[word] = (name.encode(), line) if meant else None
        return word

    def text(self, name, line):
        """Returns one line of source, which may be several with continuations and comments."""
        parts = []
        for _ in range(self.generator.randrange(1, 6)):
            parts.append(self.word(name, line + b"".join(parts).count(b"\n")))
            parts.append(self.generator.choice((
                b" ", b" ", b", ", b" N ", b"/* c */", b" /* a\nb */ ", b" \\\n", b"/*\n\n*/",
                b"\t+ ")))
        return b"".join(parts) + self.generator.choice((b"", b"", b"", b"// c", b" /* c\n*/"))

    def skipped(self, name):
        return b"#if 0\n%s\n#if 1\n#else\n#endif\n%s\n#endif" % (
            self.word(name, 0, meant=False), self.word(name, 0, meant=False))

    def group(self, name, line):
        return self.generator.choice((
            lambda: b"#ifndef N0\n%s\n#endif" % self.word(name, line + 1),
            lambda: b"#if N == 3\n%s\n#else\n%s\n#endif" % (
                self.word(name, line + 1), self.word(name, 0, meant=False)),
            lambda: b"#if 0\n\n#elif 1 /*\n*/\n%s\n#endif" % self.word(name, line + 4)))()

    def file(self, name, depth):
        """Makes a file and those that it includes, each of them once."""
        text = b"" if depth else b"#define N 3\n"
        self.files[name] = text
        for _ in range(self.generator.randrange(1, 12)):
            line = text.count(b"\n") + 1
            kind = self.generator.randrange(8)
            if kind < 3:
                text += self.text(name, line)
            elif kind == 3:
                text += b"\n" * self.generator.randrange(30)
            elif kind == 4:
                text += self.group(name, line)
            elif kind == 5:
                text += self.skipped(name)
            elif kind == 6:
                text += b"#define M%d 1 \\\n + 2" % line
            elif depth < 4:
                found = f"f{len(self.files)}"
                where, form = self.generator.choice(((found, b'"%s"'), (f"inc/{found}", b"<%s>")))
                text += b"#include " + form % found.encode()
                self.file(where, depth + 1)
            text += b"\n"
        self.files[name] = text


def words_keep_their_places(umpre, folder, generator):
    """The line markers lead from each word of the output to where it stands in the source."""
    words = Words(generator)
    words.file("main", 0)
    found = {}
    name, line = b"", 0
    for text in preprocessed(umpre, folder, words.files).split(b"\n"):
        marker = MARKER.fullmatch(text)
        if marker:
            name, line = marker[2], int(marker[1])
            continue
        for word in WORD.findall(text):
            found[word] = (name, line)
        line += 1
    expected = {word: place for word, place in words.places.items() if place}
    for word in expected.keys() | found.keys():
        if found.get(word) != expected.get(word):
            raise AssertionError(f"{word} is at {found.get(word)}, not at {expected.get(word)}: "
                                 f"{words.files!r}")


def program(generator):
    """Returns the lines of a source in pieces that may be parted."""
    pieces = []
    for number in range(generator.randrange(2, 30)):
        names = [b"M%d" % generator.randrange(number + 1) for _ in range(3)]
        pieces.append(generator.choice((
            b"#define M%d(x) %s(x) x %s" % (number, names[0], names[1]),
            b"#define M%d %s(%s, 2) a##%s" % (number, *names),
            b"#undef %s" % names[0],
            b"%s(%s(1) %s) text" % tuple(names),
            b"%s %s(a, (b, c)) \"%s\"" % tuple(names),
            b"#ifdef %s\n%s yes\n#else\n%s no\n#endif" % tuple(names),
            b"#if defined %s /*\n*/ && 1\n%s(2)\n#endif\n%s" % tuple(names),
            b"%s /* a\nb */ %s // %s" % tuple(names),
            b"%s \\\n%s( 1 ) '%s'" % tuple(names),
        )) + b"\n")
    return pieces


def text_of(output):
    """Returns an output without its markers and white space. Where the search for an argument leaves
    a file, its includer's marker stands within a line."""
    return b"".join(MARKER.sub(b"", output).split())


def correct_program(umpre, folder, generator):
    """Returns the pieces of a source without errors, which would be others in other places, and what
    comes out for it."""
    for _ in range(1000):
        pieces = program(generator)
        try:
            return pieces, preprocessed(umpre, folder, {"main": b"".join(pieces)})
        except InputError:
            pass
    raise AssertionError("there is an error in every source")


def may_be_cut(umpre, folder, generator):
    """A source whose first part is moved to a file that it includes gives the same text."""
    pieces, whole = correct_program(umpre, folder, generator)
    cut = generator.randrange(len(pieces) + 1)
    files = {"part": b"".join(pieces[:cut]), "main": b'#include "part"\n' + b"".join(pieces[cut:])}
    parted = preprocessed(umpre, folder, files)
    if text_of(parted) != text_of(whole):
        raise AssertionError(f"{files!r} became {parted!r}, not {whole!r}")


PROPERTIES = {stays_itself: 150, words_keep_their_places: 150, may_be_cut: 150}


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--umpre", default="build/release/umpre", help="the program")
    parser.add_argument("--seed", type=int, default=1, help="where the random numbers begin")
    parser.add_argument("--times", type=int, default=1, help="multiplies the number of inputs")
    options = parser.parse_args()
    umpre = os.path.abspath(options.umpre)
    failed = 0
    for check, count in PROPERTIES.items():
        for seed in range(options.seed, options.seed + count * options.times):
            with tempfile.TemporaryDirectory() as folder:
                try:
                    check(umpre, pathlib.Path(folder), random.Random(seed))
                except (AssertionError, InputError) as wrong:
                    print(f"{check.__name__}, seed {seed}: {wrong}")
                    failed += 1
    print(f"{sum(PROPERTIES.values()) * options.times - failed} passed, {failed} failed")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
