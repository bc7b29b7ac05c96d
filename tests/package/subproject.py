#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Makes the sources of umpre a part of examples/cmake, in the ways of docs/build-systems.md.

The project has the function and the library then, and neither tests nor anything to install from
umpre. With --build the example is built, which compiles what it needs, by the first way alone.
"""

import argparse
import pathlib
import shutil
import sys
import tempfile

from build_systems import EXAMPLE, ROOT, block
from installed import run

HEADING = "With the sources of umpre"
CHECKS = """
if(NOT TARGET umpre::libumpre)
    message(FATAL_ERROR "there is no library")
endif()
if(UMPRE_TESTS OR UMPRE_INSTALL OR CMAKE_RUNTIME_OUTPUT_DIRECTORY OR CMAKE_CXX_STANDARD)
    message(FATAL_ERROR "umpre changed the project's settings")
endif()
enable_testing()
set(outputs mine)
set(stamps mine)
"""
CHECKS_BEHIND = """
get_target_property(files texts UMPRE_OUTPUTS)
set(here ${CMAKE_CURRENT_BINARY_DIR})
if(NOT files STREQUAL "${here}/leds.txt;${here}/clock.txt")
    message(FATAL_ERROR "the texts are ${files}")
endif()
"""


def expect(what, good, output=""):
    print(f"{what}: {'yes' if good else 'no'}")
    if not good:
        sys.exit(output)


def project_with(way, folder):
    """Writes the example into a folder, with umpre brought along in this way."""
    shutil.copytree(EXAMPLE, folder)
    (folder / "third_party").mkdir()
    (folder / "third_party/umpre").symlink_to(ROOT)
    rules = block("CMake").replace("LANGUAGES NONE", "LANGUAGES CXX")
    find = "find_package(umpre 1.0 REQUIRED)\n"
    assert find in rules
    (folder / "CMakeLists.txt").write_text(rules.replace(find, way + CHECKS) + CHECKS_BEHIND)


def check(cmake, source, build):
    """Configures the project and looks at what came of it."""
    run(cmake, "-G", "Ninja", "-S", source, "-B", build)
    targets = run(cmake, "--build", build, "--target", "help")
    expect("has the texts", "/leds.txt: CUSTOM_COMMAND\n" in targets, targets)
    tests = run("ctest", "-N", cwd=build)
    expect("has no tests", "Total Tests: 0" in tests, tests)
    prefix = source.parent / "prefix"
    run(cmake, "--install", build, "--prefix", prefix)
    expect("installs nothing", not prefix.exists())


def check_build(cmake, build):
    output = run(cmake, "--build", build)
    expect("makes the text", (build / "leds.txt").read_text().endswith("= P7 on board 2;\n"), output)
    expect("makes no more", not list(build.rglob("umpre-lines")), output)
    expect("does nothing again", "no work to do" in run(cmake, "--build", build))


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--cmake", default="cmake")
    parser.add_argument("--build", action="store_true", help="build the example, too")
    arguments = parser.parse_args()
    with tempfile.TemporaryDirectory(prefix="umpre-subproject-") as name:
        for number, way in enumerate(["add_subdirectory", "FetchContent"]):
            print(f"== {way}")
            source = pathlib.Path(name) / way / "the sources"
            build = source.parent / "the build"
            source.parent.mkdir()
            project_with(block(HEADING, number), source)
            check(arguments.cmake, source, build)
            if arguments.build and number == 0:
                check_build(arguments.cmake, build)


if __name__ == "__main__":
    main()
