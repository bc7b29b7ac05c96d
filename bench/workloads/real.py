# SPDX-License-Identifier: MIT
"""Public headers of Debian packages, each included once.

The packages are fetched with apt-get and unpacked beside the inputs; nothing is installed. A header
that is included and is none of them, such as those of the system, is an empty stub.
"""

import functools
import os
import pathlib
import re
import subprocess
import sys

PACKAGES = pathlib.Path(__file__).resolve().parent.parent.parent / "build/bench/packages"
SYSTEM = "usr/include"
MACHINE = "usr/include/x86_64-linux-gnu"
# Packages with large headers in C, and the folders in which these are searched for.
SOURCES = {
    "libasound2-dev": [SYSTEM],
    "libcurl4-openssl-dev": [MACHINE],
    "libdrm-dev": [SYSTEM],
    "libevent-dev": [SYSTEM],
    "libgl-dev": [SYSTEM],
    "libglib2.0-dev": ["usr/include/glib-2.0", "usr/include/gio-unix-2.0"],
    "libgnutls28-dev": [SYSTEM],
    "libgsl-dev": [SYSTEM],
    "libpcre2-dev": [SYSTEM],
    "libpq-dev": ["usr/include/postgresql"],
    "libsqlite3-dev": [SYSTEM],
    "libssl-dev": [SYSTEM, MACHINE],
    "libvulkan-dev": [SYSTEM],
    "libx11-dev": [SYSTEM],
    "libxcb1-dev": [SYSTEM],
    "libxml2-dev": ["usr/include/libxml2"],
    "linux-libc-dev": [SYSTEM, MACHINE],
    "x11proto-dev": [SYSTEM],
}
# A header with one of these is left out: variadic macros, questions that a compiler answers, other
# directives, C++, and definitions of words that stand in the names of headers.
FOREIGN = re.compile(
    r"#\s*define\s+\w+\([^)]*\.\.\.|__VA_ARGS__|#\s*(?:el)?if.*\b__has_\w+|\?\?[=/'()!<>-]"
    r"|^\s*#\s*(?:define\s+(?:asm|stat)|elifn?def|error|ident|import|include_next"
    r"|include\s*<\w+(?=>)|pragma|warning)\b",
    re.MULTILINE,
)
# And so is one that says otherwise what another one has said, and one that continues text with a
# backslash, which umpre keeps.
EXCLUDED = re.compile(
    r"gnutls/(gnutlsxx|openssl)|libxml/globals|linux/byteorder/|asm/(unistd|posix_types_x?32)"
)
# Where a header is named, by #include itself or by a macro for it.
NAMED = re.compile(
    r"^([ \t]*#[ \t]*(?:include|define[ \t]+\w+)[ \t]*)([<\"])([^>\"\n]+\.h)([>\"])", re.MULTILINE
)


def unpacked(package):
    """Returns the folder that holds the package's files. Fetches it first if it is not there."""
    place = PACKAGES / package
    if not (place / "usr").exists():
        place.mkdir(parents=True, exist_ok=True)
        fetched = subprocess.run(["apt-get", "download", package], cwd=place, capture_output=True)
        if fetched.returncode:
            sys.exit(f"apt-get download {package}:\n{fetched.stderr.decode()}")
        archive = next(place.glob("*.deb"))
        subprocess.run(["dpkg-deb", "-x", archive, place], check=True)
    return place


def headers():
    """Returns the text of each header of the packages by its name."""
    found = {}
    for package, roots in SOURCES.items():
        for root in roots:
            base = unpacked(package) / root
            for path in sorted(base.rglob("*.h")):
                name = str(path.relative_to(base))
                if path.is_file() and not path.is_symlink() and not name.startswith("x86_64"):
                    found.setdefault(name, path.read_text(encoding="latin-1"))
    return found


def real(folder, rng, scale):
    """Public headers of Debian packages through stub system headers, each once."""
    every = headers()
    chosen = {
        name: text
        for name, text in every.items()
        if not FOREIGN.search(text) and not EXCLUDED.match(name) and rng.random() < scale
    }
    stubs = {}

    def named(header, match):
        start, opening, other, closing = match.groups()
        # umpre does not look beside the header that includes: the name is made a full one.
        beside = os.path.normpath(os.path.join(os.path.dirname(header), other))
        other = beside if opening == '"' and beside in every else os.path.normpath(other)
        if other not in chosen:
            stubs[other] = ""
        return start + opening + other + closing

    for name, text in chosen.items():
        folder.write(f"inc/{name}", NAMED.sub(functools.partial(named, name), text))
    for name, text in stubs.items():
        folder.write(f"inc_stubs/{name}", text)
    folder.write("main.c", "".join(f'#include "inc/{name}"\n' for name in sorted(chosen)))
