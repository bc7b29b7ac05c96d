# SPDX-License-Identifier: MIT
"""Workloads that are mostly text to copy or to skip."""

from .conditions import Expressions
from .words import Pool, Writer

MB = 1_000_000


def plain(folder, rng, scale):
    """C text in which one name of a hundred is a macro."""
    writer = Writer(rng)
    head = [f"#define {macro}" for macro in macros_of_plain(rng)]
    uses = [f"MACRO_{n}" for n in range(180)] + [f"CALL_{n}({n}, x + 1)" for n in range(20)]

    def name():
        return rng.choice(uses) if rng.random() < 0.01 else rng.choice(writer.names)

    pool = writer.code_lines(10000, name)
    folder.write("main.c", "\n".join(head) + "\n" + writer.fill(pool, 24 * MB * scale))


def macros_of_plain(rng):
    """Yields the definitions that `plain` uses."""
    for n in range(180):
        yield f"MACRO_{n} " + rng.choice((f"{n}", f"(base + {n})", f"name_{n}", f'"text {n}"'))
    for n in range(20):
        yield f"CALL_{n}(a, b) ((a) + (b) * {n})"


def items(writer, count):
    """Returns so many initialisers: numbers, literals, and lists of them in braces."""
    rng = writer.rng

    def value():
        kind = rng.random()
        if kind < 0.65:
            return rng.choice(("", "", "-")) + writer.number()
        if kind < 0.75:
            return f"{rng.randrange(100)}.{rng.randrange(1000)}f"
        if kind < 0.9:
            return writer.quoted()
        return writer.character() if kind < 0.95 else rng.choice(writer.names)

    def item():
        if rng.random() < 0.5:
            return value()
        return "{ " + ", ".join(value() for _ in range(rng.randint(2, 6))) + " }"

    return [item() for _ in range(count)]


def data(folder, rng, scale):
    """Initialisers on many lines, numbers and strings."""
    writer = Writer(rng, 500)
    every = items(writer, 20000)
    lines = ["    " + ", ".join(rng.sample(every, 3)) + ",\n" for _ in range(10000)]
    text = writer.fill(lines, 24 * MB * scale)
    folder.write("main.c", "static const struct row table[] = {\n" + text + "};\n")


def oneline(folder, rng, scale):
    """The same in one line."""
    writer = Writer(rng, 500)
    text = writer.fill([item + ", " for item in items(writer, 20000)], 16 * MB * scale)
    folder.write("main.c", "static const struct row table[] = { " + text + "};\n")


def block_comment(writer):
    """Returns a block comment of several lines."""
    rng = writer.rng
    stars = rng.random() < 0.7
    lines = [
        ("     * " if stars else "       ")
        + writer.prose(rng.randint(2, 12))
        + rng.choice(("", "", ".", ", don't", ' "', " //", " *", " #if"))
        for _ in range(rng.randint(2, 14))
    ]
    return "    /*\n" + "\n".join(lines) + "\n     */\n"


def line_comment(writer):
    """Returns a line comment."""
    return f"    // {writer.prose(writer.rng.randint(2, 12))}\n"


def comments(folder, rng, scale):
    """Block and line comments, 85 % of the bytes, among code."""
    writer = Writer(rng)
    blocks = [block_comment(writer) for _ in range(2000)]
    single = ["".join(line_comment(writer) for _ in range(rng.randint(1, 6))) for _ in range(2000)]
    code = Pool(rng, [line for line in writer.code_lines(4000) if "/*" not in line])
    comment = sum(map(len, blocks + single)) / 4000
    # So many bytes of code behind a comment that 85 % are comment.
    behind = comment * 15 / 85
    runs = [code.text(behind * rng.uniform(0.5, 1.5)) for _ in range(4000)]
    pool = [text + run for text, run in zip(blocks + single, runs)]
    folder.write("main.c", writer.fill(pool, 64 * MB * scale))


def nested_group(writer, lines, depth=0):
    """Returns a group of a few lines, some with groups in them."""
    rng = writer.rng

    def some():
        inner = rng.choices(lines, k=rng.randint(1, 8))
        if depth < 3 and rng.random() < 0.3:
            inner.append(nested_group(writer, lines, depth + 1))
        return "".join(inner)

    name = rng.choice(writer.names)
    text = rng.choice((f"#ifdef {name}\n", f"# ifndef {name}\n", f"#if {name} > 3\n")) + some()
    if rng.random() < 0.3:
        text += f"#elif defined({name})\n" + some()
    if rng.random() < 0.5:
        text += "#else\n" + some()
    return text + f"#endif /* {name} */\n"


def skipped(folder, rng, scale):
    """One false group, with nested groups, strings and comments in it."""
    writer = Writer(rng)
    lines = writer.code_lines(10000)
    lines += [f"    {rng.choice(writer.names)}({writer.quoted()}, {n});\n" for n in range(2000)]
    lines += [f"#define {name} {n}\n" for n, name in enumerate(rng.sample(writer.names, 300))]
    lines += [f"#include <{name}.h>\n" for name in rng.sample(writer.names, 100)]
    others = [nested_group(writer, lines) for _ in range(600)]
    others += [block_comment(writer) for _ in range(300)]
    others += [line_comment(writer) for _ in range(600)]
    text = writer.fill(lines + others, 96 * MB * scale)
    folder.write("main.c", "#if 0\n" + text + "#endif\nint end;\n")


def conditions(folder, rng, scale):
    """Chains of #if and #elif with arithmetic and `defined`; 95 % of the text is skipped."""
    writer = Writer(rng)
    expressions = Expressions(rng)
    true, false = expressions.sorted_by_value(max(20, round(2000 * scale)))
    lines = Pool(rng, writer.code_lines(5000))
    bodies = [lines.text(rng.uniform(180, 540)) for _ in range(2000)]
    text = [expressions.definitions()]
    count = 0
    while count < 80000 * scale:
        branches = rng.randint(1, 6)
        taken = rng.randrange(branches) if rng.random() < 0.14 else branches
        for number in range(branches):
            condition = rng.choice(true if number >= taken else false)
            text += ("#elif " if number else "#if ", condition, "\n", rng.choice(bodies))
        if taken < branches and rng.random() < 0.3:
            text += ("#else\n", rng.choice(bodies))
        text.append("#endif\n")
        count += branches
    folder.write("main.c", "".join(text))
