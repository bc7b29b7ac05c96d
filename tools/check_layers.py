#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks who includes whom under src/ and include/ against docs/architecture.md.

A component is a file without its suffix: lex/token is lex/token.h with lex/token.cc. The page has a
heading for each folder (### `lex/`) and below it a table that lists the folder's components in its
first column, each below what it includes. The rules:

- every component is listed, and everything listed exists;
- a folder includes itself and folders further left in the order umpre (the public headers), lex,
  macros, expr, directives, driver, api, deps, lines;
- inside a folder a component includes only what stands above it, which makes cycles impossible.
"""

import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent
FOLDERS = ["umpre", "lex", "macros", "expr", "directives", "driver", "api", "deps", "lines"]
SUFFIXES = {".h", ".in", ".cc", ".l"}
HEADING = re.compile(r"#+ `([a-z]+)/`")
ROW = re.compile(r"\| *`([a-z_]+)`")
INCLUDE = re.compile(r'^ *# *include +"([^"]+)"', re.MULTILINE)


def listed_components(page):
    """Returns the page's components in their order, as "folder/name"."""
    folder, found = None, []
    for line in page.read_text(encoding="utf-8").splitlines():
        if line.startswith("#"):
            heading = HEADING.match(line)
            folder = heading.group(1) if heading else None
        elif folder in FOLDERS and (row := ROW.match(line)):
            found.append(f"{folder}/{row.group(1)}")
    return found


def included_components(*sources):
    """Returns, for each component under `sources`, the components that it includes."""
    found = {}
    for source, path in sorted((source, path) for source in sources for path in source.rglob("*")):
        if path.suffix in SUFFIXES:
            name = path.relative_to(source).as_posix().partition(".")[0]
            for target in INCLUDE.findall(path.read_text(encoding="utf-8")):
                found.setdefault(name, set()).add(target.rpartition(".")[0])
            found.setdefault(name, set()).discard(name)
    return found


def complaints(listed, included):
    """Yields a sentence for each breach of the rules."""
    place = {name: (FOLDERS.index(name.split("/")[0]), at) for at, name in enumerate(listed)}
    for name in sorted(set(listed) - included.keys()):
        yield f"{name} is listed but does not exist"
    for name in sorted(included.keys() - set(listed)):
        yield f"{name} is not listed"
    for name in sorted(included.keys() & place.keys()):
        for target in sorted(included[name]):
            if target not in included:
                yield f"{name} includes {target}, which is no component"
            elif target in place and place[target][0] > place[name][0]:
                yield f"{name} includes {target}, which lies to its right"
            elif target in place and place[target] > place[name]:
                yield f"{name} includes {target}, which stands below it"


def main():
    listed = listed_components(ROOT / "docs" / "architecture.md")
    included = included_components(ROOT / "include", ROOT / "src")
    breaches = list(complaints(listed, included))
    print("\n".join(breaches + [f"layers: {len(included)} components, {len(breaches)} breaches"]))
    return 1 if breaches or not included else 0


if __name__ == "__main__":
    sys.exit(main())
