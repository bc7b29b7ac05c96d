#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Draws docs/example.svg: the example of README.md, as the program carries it out.

Files on the left, what comes out on the right. With --check nothing is written; it fails if the
picture is not what would be drawn now.
"""

import argparse
import pathlib
import re
import sys
from xml.sax.saxutils import escape

ROOT = pathlib.Path(__file__).resolve().parent.parent
sys.path.insert(0, str(ROOT / "tests"))

import run_cases  # noqa: E402

PICTURE = ROOT / "docs/example.svg"
CASE = "readme/1"
# The picture has a ground of its own, so that either set of colours can be read on every page.
STYLE = """
text { font: 15px ui-monospace, SFMono-Regular, Menlo, Consolas, "DejaVu Sans Mono", monospace;
  fill: #1f2328; white-space: pre }
.ground { fill: #f6f8fa; stroke: #d0d7de }
.sheet { fill: #ffffff; stroke: #d0d7de }
.caption, .marker { fill: #59636e }
.caption { font-size: 13px }
.directive { fill: #8250df }
.macro { fill: #0550ae }
.made { fill: #0550ae; font-weight: bold }
.arrow { stroke: #59636e; stroke-width: 2; fill: none }
@media (prefers-color-scheme: dark) {
  text { fill: #e6edf3 }
  .ground { fill: #161b22; stroke: #30363d }
  .sheet { fill: #0d1117; stroke: #30363d }
  .caption, .marker { fill: #9198a1 }
  .directive { fill: #d2a8ff }
  .macro, .made { fill: #79c0ff }
  .arrow { stroke: #9198a1 }
}
"""
CHARACTER, LINE, PAD, GAP, MIDDLE = 9.1, 22, 14, 20, 160


def sheet(left, top, width, caption, lines):
    """Returns a sheet with lines, which are marked up, and how far down it reaches."""
    bottom = top + LINE + len(lines) * LINE + PAD
    parts = [f'<text class="caption" x="{left}" y="{top + 14}">{escape(caption)}</text>',
             f'<rect class="sheet" x="{left}" y="{top + LINE}" width="{width}"'
             f' height="{bottom - top - LINE}" rx="6"/>']
    for number, line in enumerate(lines):
        place = top + 2 * LINE + 2 + number * LINE
        parts.append(f'<text x="{left + PAD}" y="{place}" xml:space="preserve">{line}</text>')
    return "\n".join(parts), bottom


def span(kind, text):
    return f'<tspan class="{kind}">{text}</tspan>'


def painted(line, names, kind):
    """Returns a line with those words marked up that are among the names."""
    return re.sub(r"\w+", lambda word: span(kind, word[0]) if word[0] in names else word[0],
                  escape(line))


def painted_source(line, macros):
    directive = re.match(r"#\w+", line)
    begin = directive[0] if directive else ""
    return (span("directive", begin) if begin else "") + painted(line[len(begin):], macros, "macro")


def painted_output(line, known):
    if line.startswith("#line"):
        return span("marker", escape(line))
    return painted(line, set(re.findall(r"\w+", line)) - known, "made")


def width_of(lines):
    return round(max(map(len, lines)) * CHARACTER) + 2 * PAD


def drawn(command, files, output):
    """Returns the picture. A file is its name and its lines."""
    sources = [line for _, lines in files for line in lines]
    macros = set(re.findall(r"#define (\w+)", "\n".join(sources)))
    known = set(re.findall(r"\w+", "\n".join(sources)))
    parts, top, wide = [], GAP, width_of(sources)
    for name, lines in files:
        text, bottom = sheet(GAP, top, wide, name, [painted_source(it, macros) for it in lines])
        parts.append(text)
        top = bottom + PAD
    right = GAP + wide + MIDDLE
    lines = [painted_output(line, known) for line in output]
    height = (len(lines) + 1) * LINE + PAD
    text, _ = sheet(right, GAP + (bottom - GAP - height) // 2, width_of(output), "output", lines)
    middle, begin, end = (GAP + bottom + LINE) // 2, GAP + wide + 14, right - 14
    width, height = right + width_of(output) + GAP, bottom + GAP
    parts += [text,
              f'<text class="caption" x="{(begin + end) // 2}" y="{middle - 12}"'
              f' text-anchor="middle">{escape(command)}</text>',
              f'<path class="arrow" d="M{begin} {middle}H{end}m-8 -6l8 6l-8 6"/>']
    return "\n".join([
        f'<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 {width} {height}" width="{width}"'
        f' height="{height}" role="img">',
        "<!-- Drawn by tools/draw_example.py. -->",
        f"<title>{escape(command)}</title>", f"<style>{STYLE}</style>",
        f'<rect class="ground" x="0.5" y="0.5" width="{width - 1}" height="{height - 1}" rx="8"/>',
        *parts, "</svg>", ""])


def picture(umpre):
    """Returns the picture of what the program makes of the example."""
    (case,) = (case for case in run_cases.find_cases() if case.name == CASE)
    _, sections = run_cases.parse(case)
    result = run_cases.outcome(sections, [umpre])
    command = next(header for header in result if header.startswith("run"))[5:]
    files = [(header[5:-1], lines) for header, lines in result.items() if header.startswith("file")]
    output = result["output:"]
    while not output[-1]:
        output.pop()
    return drawn(command, files, output)


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n", 1)[0])
    parser.add_argument("--umpre", default=str(ROOT / "build/release/umpre"), help="the program")
    parser.add_argument("--check", action="store_true", help="compare the picture that is there")
    arguments = parser.parse_args()
    text = picture(arguments.umpre)
    if not arguments.check:
        PICTURE.write_text(text, "utf-8")
    elif PICTURE.read_text("utf-8") != text:
        sys.exit(f"tools/draw_example.py would draw another {PICTURE.relative_to(ROOT)}")


if __name__ == "__main__":
    main()
