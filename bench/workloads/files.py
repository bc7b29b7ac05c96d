# SPDX-License-Identifier: MIT
"""Workloads that include many files. A folder whose name begins with `inc` is searched with -I."""

from .words import Writer

MB = 1_000_000


def includes(folder, rng, scale):
    """Inclusions of 600 small guarded headers in three search folders, deep and wide."""
    writer = Writer(rng, 2000)
    levels, wide = 20, max(1, round(30 * scale))
    names = [f"part{n:03}.h" for n in range(levels * wide)]
    places = {name: f"inc{rng.randrange(3)}" for name in names}
    for n, name in enumerate(names):
        below = names[(n // wide + 1) * wide :]
        # The first one leads to the next level, so nesting reaches the last level; others jump.
        inner = [below[n % wide]] + rng.choices(below, k=rng.randint(0, 6)) if below else []
        lines = [f"#include <{other}>\n" for other in inner]
        folder.write(f"{places[name]}/{name}", small_header(writer, n, "".join(lines)))
    lines = []
    for number in range(round(374000 * scale)):
        name = rng.choice(names)
        full = f'"{places[name]}/{name}"'
        lines.append(f"#include {full if rng.random() < 0.3 else f'<{name}>'}\n")
        if number % 16 == 0:
            lines.append(f"int use_{number};\n")
    folder.write("main.c", "".join(lines))


def small_header(writer, number, inclusions):
    """Returns a guarded header of a few lines."""
    rng = writer.rng
    a, b, c = rng.sample(writer.names, 3)
    comment = f"/* Part {number}: {writer.prose(5)}. */\n" if rng.random() < 0.5 else ""
    return (
        f"{comment}#ifndef PART_{number}_H\n#define PART_{number}_H\n{inclusions}"
        f"#define PART_{number}_LIMIT {number + 7}\n"
        f"struct part{number} {{\n    int {a};\n    char *{b};\n}};\n"
        f"int part{number}_{c}(struct part{number} *{a}, int {b});\n#endif\n"
    )


def distinct(folder, rng, scale):
    """Different headers in four search folders, each read once."""
    writer = Writer(rng)
    count = max(10, round(7000 * scale))
    names = [f"module{rng.randrange(20):02}/unit{n:04}.h" for n in range(count)]
    code = [line for line in writer.code_lines(4000) if not line.lstrip().startswith("/*")]
    roots = []
    for number, name in enumerate(names):
        inner = []
        if number % 10 == 0:
            roots.append(f"#include <{name}>\n")
            inner = [f"#include <{other}>\n" for other in names[number + 1 : number + 10]]
        text = large_header(writer, code, number, "".join(inner))
        folder.write(f"inc{rng.randrange(4)}/{name}", text)
    folder.write("main.c", "".join(roots))


def large_header(writer, code, number, inclusions):
    """Returns a guarded header of about 2300 bytes, as libraries have them."""
    rng = writer.rng
    lines = [f" * {writer.prose(9)}" for _ in range(7)]
    text = ["/*\n", "\n".join(lines), "\n */\n"]
    text += (f"#ifndef UNIT_{number}_H\n#define UNIT_{number}_H\n", inclusions)
    for n, name in enumerate(rng.sample(writer.names, 10)):
        value = f"(0x{rng.randrange(1 << 16):04x} + {n})"
        text.append(f"#define UNIT_{number}_{name.upper()} {value}\n")
    first, second = rng.sample(writer.names, 2)
    text.append(f"#define unit{number}_{first}(a, b) ((a) * UNIT_{number}_SIZE + (b))\n")
    text.append(f"/** {writer.prose(10)}. */\nstruct unit{number}_{second} {{\n")
    text += [f"    int {name};\n" for name in rng.sample(writer.names, 6)]
    text.append("};\n#ifdef UNIT_EXTRA\n")
    text += rng.choices(code, k=6)
    text.append("#endif\n")
    for name in rng.sample(writer.names, 8):
        a, b = rng.sample(writer.names, 2)
        text.append(f"/* {writer.prose(6)}. */\n")
        text.append(f"extern int unit{number}_{name}(int {a}, char *{b});\n")
    text.append(f"#endif /* UNIT_{number}_H */\n")
    return "".join(text)


# What the lists of `reinclude` are read with: each ITEM has a name, a value and a text.
READINGS = (
    "ITEM(name, value, text) name = value,",
    "ITEM(name, value, text) case name: return text;",
    "ITEM(name, value, text) { #name, value, text },",
    "ITEM(name, value, text) extern int get_##name(void);",
    "ITEM(name, value, text) + (value)",
    "ITEM(name, value, text) KIND_##name = (value) << SHIFT,",
    "ITEM(name, value, text)",
)


def reinclude(folder, rng, scale):
    """Definition lists included again and again, each time with other macros."""
    writer = Writer(rng)
    lists = [f"list{n:02}.def" for n in range(max(1, round(40 * scale)))]
    size = 0
    for number, name in enumerate(lists):
        text = definition_list(writer, number)
        size += len(text)
        folder.write(f"inc/{name}", text)
    passes = 16 * MB * scale / (size / len(lists))
    lines = ["#define SHIFT 3\n"]
    for number in range(max(1, round(passes))):
        kind = rng.randrange(len(lists))
        lines.append(f"#define {rng.choice(READINGS)}\n")
        if rng.random() < 0.3:
            lines.append("#define SPECIAL_ITEM(name, value, text) special_##name,\n")
        lines.append(f"enum pass_{number} {{\n#include <{lists[kind]}>\n}};\n")
    folder.write("main.c", "".join(lines))


def definition_list(writer, number):
    """Returns a list of ITEMs that takes the reader's macros, and takes their definitions away."""
    rng = writer.rng
    lines = [
        f"/* List {number}: {writer.prose(6)}. */\n",
        "#ifndef ITEM\n#define ITEM(name, value, text)\n#endif\n",
        "#ifndef SPECIAL_ITEM\n",
        "#define SPECIAL_ITEM(name, value, text) ITEM(name, value, text)\n#endif\n",
    ]
    for name in rng.sample(writer.names, rng.randint(25, 55)):
        kind = "SPECIAL_ITEM" if rng.random() < 0.2 else "ITEM"
        lines.append(f"{kind}({name}, {writer.number()}, {writer.quoted()})\n")
        if rng.random() < 0.1:
            lines.append(f"// {writer.prose(6)}\n")
    return "".join(lines) + "#undef ITEM\n#undef SPECIAL_ITEM\n"
