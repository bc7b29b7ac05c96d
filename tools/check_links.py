#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Checks that the links of the documentation lead somewhere: to a file, and to a heading in it.

Addresses that begin with a scheme, as https:, are left alone.
"""

import collections
import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent
FENCE = re.compile(r"^(```+|~~~+).*?^\1[ \t]*$", re.MULTILINE | re.DOTALL)
CODE = re.compile(r"(`+)(?:(?!\1).)+\1")
LINK = re.compile(r"\[(?:[^\[\]]|\[[^\]]*\])*\]\(([^()\s]+)\)|^\[[^\]]+\]: +(\S+)", re.MULTILINE)
HEADING = re.compile(r"^#+ +(.+?) *#*$", re.MULTILINE)


def anchors(page):
    """Returns the names of a page's headings, as they stand behind the # of a link."""
    found, times = set(), collections.Counter()
    for heading in HEADING.findall(FENCE.sub("", page.read_text(encoding="utf-8"))):
        name = re.sub(r"[^\w\- ]", "", heading.lower()).replace(" ", "-")
        found.add(f"{name}-{times[name]}" if times[name] else name)
        times[name] += 1
    return found


def broken_links(page):
    """Yields a sentence for each link of a page that leads nowhere."""
    text = CODE.sub("", FENCE.sub("", page.read_text(encoding="utf-8")))
    for inline, reference in LINK.findall(text):
        target = inline or reference
        if re.match(r"[a-z]+:", target):
            continue
        path, _, anchor = target.partition("#")
        file = (page.parent / path).resolve() if path else page
        if not file.exists():
            yield f"{page.relative_to(ROOT)}: there is no {path}"
        elif anchor and file.suffix == ".md" and anchor not in anchors(file):
            yield f"{page.relative_to(ROOT)}: {path or 'the page'} has no heading #{anchor}"


def main():
    pages = sorted(ROOT.glob("*.md")) + sorted(ROOT.glob("docs/**/*.md"))
    broken = [complaint for page in pages for complaint in broken_links(page)]
    print("\n".join(broken + [f"links: {len(pages)} pages, {len(broken)} broken links"]))
    return 1 if broken else 0


if __name__ == "__main__":
    sys.exit(main())
