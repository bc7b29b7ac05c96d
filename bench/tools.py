# SPDX-License-Identifier: MIT
"""Runs preprocessors on a workload: their CPU time, their memory, the tokens they make."""

import hashlib
import os
import re
import resource
import signal
import subprocess
import tempfile

# What two of the peers predefine although told not to, and headers ask for.
PLATFORM = "__unix__ __unix unix __linux__ __linux __x86_64__ __amd64__ __LP64__ __SIZEOF_LONG__"
UNDEFINED = [f"-U{name}" for name in PLATFORM.split()]
# Each peer without predefined macros, system folders and warnings.
PEERS = {
    "gcc": ["gcc", "-E", "-undef", "-nostdinc", "-w"],
    "clang": ["clang", "-E", "-undef", "-nostdinc", "-w"],
    "tcc": ["tcc", "-E", "-nostdinc", "-w", *UNDEFINED],
    "mcpp": ["mcpp", "-N", "-I-", "-W0", *UNDEFINED],
    "ucpp": ["ucpp", "-Z", "-zI", "-w0"],
}
ENVIRONMENT = {**os.environ, "LC_ALL": "C"}
SECONDS = 30  # of CPU time; the clock would count the neighbours' too
SOURCE = "main.c"
CHUNK = 1 << 22
MARKER = re.compile(rb"^[ \t]*#(?:[ \t]*line)?[ \t]+[0-9][^\n]*$", re.MULTILINE)
WORD = b"abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789_"
# Keeps the bytes of words and makes all others blanks.
WORDS_ALONE = bytes(byte if byte in WORD else ord(" ") for byte in range(256))


class Failed(Exception):
    """A program did not end well; the text says how."""


def command_for(words, folder):
    """Returns the command for the source in this folder, with the folders it is to search."""
    searched = sorted(path.name for path in folder.glob("inc*") if path.is_dir())
    return [*words, *(f"-I{name}" for name in searched), SOURCE]


def run(command, folder, output=subprocess.DEVNULL):
    """Runs a command in a folder. Returns the user and system time that it took, in seconds."""
    child = subprocess.Popen(
        command,
        cwd=folder,
        env=ENVIRONMENT,
        stdin=subprocess.DEVNULL,
        stdout=output,
        stderr=subprocess.DEVNULL,
    )
    resource.prlimit(child.pid, resource.RLIMIT_CPU, (SECONDS, SECONDS + 1))
    _, status, usage = os.wait4(child.pid, 0)
    child.returncode = os.waitstatus_to_exitcode(status)
    if child.returncode == -signal.SIGXCPU:
        raise Failed(f"over {SECONDS} s")
    if child.returncode < 0:
        raise Failed(signal.Signals(-child.returncode).name)
    return usage.ru_utime + usage.ru_stime


def peak_memory(command, folder):
    """Returns the most memory that a command had at a time, in bytes."""
    # A process that this one started would count this one's memory as its own.
    with tempfile.NamedTemporaryFile() as file:
        run(["time", "-q", "-f", "%M", "-o", file.name, *command], folder)
        return int(file.read()) * 1024


def tokens(command, folder):
    """Returns what stands for the tokens that a command writes.

    Line markers do not count, and white space only where it parts two words: there is one sum over
    the text without white space and one over the words in it.
    """
    text, words = hashlib.sha256(), hashlib.sha256()
    with tempfile.TemporaryFile() as file:
        run(command, folder, file)
        file.seek(0)
        rest = b""
        while chunk := file.read(CHUNK):
            lines, end, rest = (rest + chunk).rpartition(b"\n")
            add_lines(lines + end, text, words)
        add_lines(rest, text, words)
    return text.hexdigest() + words.hexdigest()


def add_lines(lines, text, words):
    """Adds whole lines of output to the sums over text and words."""
    lines = MARKER.sub(b"", lines)
    text.update(lines.translate(None, b" \t\n\v\f\r"))
    words.update(b"".join(word + b" " for word in lines.translate(WORDS_ALONE).split()))
