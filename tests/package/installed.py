#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Installs a build into an empty folder and uses what is there, as a user does.

The programs run, every installed file is one that is listed here, and the embedding example is built
against the library, by CMake and by what pkg-config says, and prints what its folder says. The
folder has a blank in its name.
"""

import argparse
import os
import pathlib
import shlex
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
EXAMPLE = ROOT / "examples/embed"
FILES = """
bin/umpre
bin/umpre-deps
bin/umpre-lines
include/umpre/diagnostic.h
include/umpre/event.h
include/umpre/export.h
include/umpre/preprocessing.h
include/umpre/version.h
lib/libumpre.a
lib/pkgconfig/umpre.pc
share/bash-completion/completions/umpre
share/bash-completion/completions/umpre-deps
share/bash-completion/completions/umpre-lines
share/cmake/umpre/umpreConfig.cmake
share/cmake/umpre/umpreConfigVersion.cmake
share/cmake/umpre/umpreLibraryTargets-release.cmake
share/cmake/umpre/umpreLibraryTargets.cmake
share/cmake/umpre/umpreProgramTargets-release.cmake
share/cmake/umpre/umpreProgramTargets.cmake
share/cmake/umpre/umpre_preprocess.cmake
share/doc/umpre/CHANGELOG.md
share/doc/umpre/CONTRIBUTING.md
share/doc/umpre/LICENSE
share/doc/umpre/README.md
share/doc/umpre/SECURITY.md
share/fish/vendor_completions.d/umpre-deps.fish
share/fish/vendor_completions.d/umpre-lines.fish
share/fish/vendor_completions.d/umpre.fish
share/man/man1/umpre-deps.1
share/man/man1/umpre-lines.1
share/man/man1/umpre.1
share/zsh/site-functions/_umpre
""".split()
FILES += [f"share/doc/umpre/docs/{page.name}" for kind in ("*.md", "*.svg")
          for page in (ROOT / "docs").glob(kind)]


def run(*command, **options):
    """Runs a command that must succeed. Returns what it printed."""
    done = subprocess.run(command, capture_output=True, text=True, **options)
    if done.returncode != 0:
        sys.exit(f"{shlex.join(map(str, command))}\n{done.stdout}{done.stderr}")
    return done.stdout


def expect(what, actual, expected):
    if actual != expected:
        sys.exit(f"{what}:\n{actual}\nexpected:\n{expected}")


def check_programs(prefix):
    for program in ["umpre", "umpre-deps", "umpre-lines"]:
        version = subprocess.run([prefix / "bin" / program, "-v"], capture_output=True, text=True)
        expect(f"the first words of {program} -v", version.stdout.split()[:2], [program, "version"])


def check_with_cmake(arguments, prefix, folder):
    """Builds the example with find_package()."""
    build = folder / "with cmake"
    run(arguments.cmake, "-S", EXAMPLE, "-B", build, f"-DCMAKE_PREFIX_PATH={prefix}",
        f"-DCMAKE_CXX_COMPILER={arguments.compiler}", "-DCMAKE_BUILD_TYPE=Release")
    run(arguments.cmake, "--build", build)
    expect("embed", run(build / "embed"), (EXAMPLE / "expected.txt").read_text())


def check_with_pkg_config(arguments, prefix, folder):
    """Builds the example in C++17, with the flags that pkg-config gives."""
    folders = {**os.environ, "PKG_CONFIG_PATH": str(prefix / "lib/pkgconfig")}
    flags = shlex.split(run("pkg-config", "--cflags", "--libs", "umpre", env=folders))
    program = folder / "with-pkg-config"
    run(arguments.compiler, "-std=c++17", "-Wall", "-Wextra", "-Wpedantic", "-Werror",
        EXAMPLE / "main.cc", "-o", program, *flags)
    expect("embed", run(program), (EXAMPLE / "expected.txt").read_text())


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--build", required=True, help="the folder of the build")
    parser.add_argument("--cmake", default="cmake")
    parser.add_argument("--compiler", default="c++")
    arguments = parser.parse_args()
    with tempfile.TemporaryDirectory(prefix="umpre-installed-") as name:
        folder = pathlib.Path(name)
        prefix = folder / "a prefix"
        run(arguments.cmake, "--install", arguments.build, "--prefix", prefix)
        found = [str(path.relative_to(prefix)) for path in prefix.rglob("*") if path.is_file()]
        expect("installed files", sorted(found), sorted(FILES))
        check_programs(prefix)
        check_with_cmake(arguments, prefix, folder)
        check_with_pkg_config(arguments, prefix, folder)


if __name__ == "__main__":
    main()
