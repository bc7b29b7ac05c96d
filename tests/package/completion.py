#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Asks a shell which options it offers, and holds them against what the programs say under -h.

bash and fish complete a real command line; of zsh the completion function itself is called, with
_arguments, which it hands its options to, replaced by one that prints them.
"""

import argparse
import pathlib
import re
import subprocess
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
FOLDER = ROOT / "completions"

BASH = """
compopt() { :; }
source "$1/umpre.bash"
COMP_WORDS=("$2" -) COMP_CWORD=1
function=$(complete -p "$2") && function=${function#*-F } && ${function%% *}
printf '%s\\n' "${COMPREPLY[@]}"
"""
ZSH = """
_arguments() { print -rl -- "$@" }
service=$2
source "$1/_umpre"
"""
FISH = """
source $argv[1]/$argv[2].fish
complete -C "$argv[2] -"
complete -C "$argv[2] --"
"""


def output_of(*command):
    done = subprocess.run(command, capture_output=True, text=True)
    if done.stderr:
        sys.exit(done.stderr)
    return done.stdout


def options_of(program):
    """Returns the options that the program explains."""
    lines = re.findall(r"^  (-.*?) +: ", output_of(program, "-h"), re.MULTILINE)
    return {re.match(r"-+[A-Za-z-]+", word)[0] for line in lines for word in line.split(", ")}


def offered(shell, program):
    """Returns the options that the shell offers."""
    if shell == "bash":
        return set(output_of("bash", "-c", BASH, "bash", FOLDER, program).split())
    if shell == "fish":
        lines = output_of("fish", "--no-config", "-c", FISH, FOLDER, program).splitlines()
        return {line.split("\t")[0] for line in lines}
    words = output_of("zsh", "-f", "-c", ZSH, "zsh", FOLDER, program).splitlines()
    found = {re.match(r"(?:\([^)]*\)|\*)*(-[A-Za-z-]*[A-Za-z])?", word)[1] for word in words}
    return found - {None}


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--programs", required=True, help="the folder that has the programs")
    parser.add_argument("shell", choices=["bash", "zsh", "fish"])
    arguments = parser.parse_args()
    wrong = []
    for program in ["umpre", "umpre-deps", "umpre-lines"]:
        options = options_of(pathlib.Path(arguments.programs) / program)
        completed = offered(arguments.shell, program)
        wrong += [f"{program}: {option} is not offered" for option in sorted(options - completed)]
        wrong += [f"{program}: there is no {option}" for option in sorted(completed - options)]
        if not options:
            wrong.append(f"{program}: -h names no options")
    sys.exit("\n".join(wrong) or 0)


if __name__ == "__main__":
    main()
