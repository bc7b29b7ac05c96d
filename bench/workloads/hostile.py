# SPDX-License-Identifier: MIT
"""What makes a careless reader slow: huge tokens, unclosed quotes, deeply nested calls."""

from .words import Writer

MB = 1_000_000


def hostile(folder, rng, scale):
    """Huge tokens, lines of unclosed quotes, nested calls."""
    writer = Writer(rng, 1000)
    text = ["#define f(x) x\n#define g(x) (x + 1)\n#define h(a, b) a b\n"]
    text += huge_tokens(writer, round(1.15 * MB * scale))
    text += unclosed_quotes(writer, round(1.6 * MB * scale))
    text += nested_calls(writer, round(0.5 * MB * scale))
    folder.write("main.c", "".join(text))


def huge_tokens(writer, size):
    """Yields tokens of so many bytes, each on a line: they grow with the input."""
    yield "int " + writer.fill(writer.names, size) + ";\n"
    yield "int a = " + "7" * size + ";\n"
    yield "int b = 0x" + "A5" * (size // 2) + ";\n"
    items = [writer.prose(3), "\\n", '\\"', "\\\\", "/*", "//"]
    yield 'char *c = "' + writer.fill(items, size) + '";\n'
    yield "int d; /*" + writer.fill([writer.prose(3), "* ", "/", "\n", '"'], size) + "*/\n"
    yield "int e; //" + writer.fill([writer.prose(3), "*", " ", '"'], size) + "\n"
    yield "#define CHAIN " + "a \\\n" * (size // 4) + "b\nCHAIN;\n"


def unclosed_quotes(writer, size):
    """Yields lines with quotes that nothing closes, long ones and many short ones."""
    yield '"' + '\\"' * (size // 2) + "\n"
    yield "'" + "\\'" * (size // 2) + "\n"
    yield "\" don't " + writer.fill(["it\\'s ", "isn\\'t ", "name ", "12 "], size) + "\n"
    lines = [f"    {writer.prose(4)} don't {writer.prose(3)}\n" for _ in range(500)]
    lines += [f'    "{writer.prose(4)} \\" {writer.prose(3)}\n' for _ in range(500)]
    yield writer.fill(lines, size)


def nested_calls(writer, size):
    """Yields calls of which each is the argument of the next, 100 deep, and long argument lists."""
    rng = writer.rng
    lines = []
    for _ in range(40):
        names = rng.choices("fg", k=100)
        lines.append("(".join(names) + f"({rng.choice(writer.names)}" + ")" * 100 + ";\n")
    for _ in range(40):
        line = rng.choice(writer.names)
        for _ in range(60):
            line = f"h({line}, {rng.choice(writer.names)})"
        lines.append(line + ";\n")
    yield writer.fill(lines, size)
