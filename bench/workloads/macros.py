# SPDX-License-Identifier: MIT
"""Workloads that define and use macros."""

from .words import Writer


def register_macros(writer, count):
    """Returns so many definitions as headers of chips have them, and the names to use.

    A field of a register has three: position, mask and the short name of the mask.
    """
    rng = writer.rng
    definitions, uses = [], []
    registers = [name.upper() for name in writer.make_names(count // 30 + 1, "dev_")]
    fields = [name.upper() for name in writer.make_names(400)]
    while len(definitions) + 4 <= count:
        number = len(definitions)
        register = registers[number // 30]
        name = f"{register}_{fields[number % 397]}_{number}"
        mask = f"(0x{rng.choice(('1', '1', '3', '7', 'FF'))}UL << {name}_Pos)"
        definitions += (
            f"#define {name}_Pos ({rng.randrange(32)}U)\n",
            f"#define {name}_Msk {mask} /*!< 0x{rng.randrange(1 << 16):08X} */\n",
            f"#define {name} {name}_Msk\n",
            f"#define {name}_REG (*(volatile uint32_t *)(DEVICE_BASE + 0x{number:04X}))\n",
        )
        uses += (f"{name}_Msk", name, name, f"{name}_REG", f"{name}_REG")
    return definitions, uses


def objects(folder, rng, scale):
    """Object-like register macros, and uses of them in code."""
    writer = Writer(rng)
    definitions, uses = register_macros(writer, max(8, round(60000 * scale)))
    folder.write("inc/registers.h", "#define DEVICE_BASE 0x40000000UL\n" + "".join(definitions))
    lines = writer.code_lines(5000)
    text = ["#include <registers.h>\n"]
    for _ in range(round(165000 * scale)):
        one, two = rng.choice(uses), rng.choice(uses)
        form = rng.choice(("    {} |= {};\n", "    if ({} & {})\n", "    {} = ({}) << 2;\n"))
        text += (form.format(one, two), rng.choice(lines))
    folder.write("main.c", "".join(text))


def defines(folder, rng, scale):
    """Definitions that nothing uses."""
    writer = Writer(rng)
    names = [name.upper() for name in writer.names]
    numbers = [writer.number() for _ in range(5000)]
    text = []
    for number in range(round(370000 * scale)):
        name, other = f"{rng.choice(names)}_{number:x}", rng.choice(names)
        kind, value = rng.random(), rng.choice(numbers)
        if kind < 0.50:
            text.append(f"#define HW_REGISTER_{name:<24} ({other}_BASE + {value})\n")
        elif kind < 0.75:
            text.append(f"#define {name}_DEFAULT_VALUE {value}\n")
        elif kind < 0.85:
            text.append(f"#define {name}_GET(reg, n) (((reg) >> {value}) & ({other} << (n)))\n")
        elif kind < 0.90:
            text.append(f'#define {name}_NAME "{other}: %d\\n"\n')
        elif kind < 0.97:
            text.append(f"#define {name} {value} /* {writer.prose(3)} */\n")
        else:
            text.append(f"#define {name}(a) do {{ \\\n    {other}(a); \\\n  }} while (0)\n")
    folder.write("main.c", "".join(text))


CALLS = """\
#define MIN(a, b) ((a) < (b) ? (a) : (b))
#define MAX(a, b) ((a) > (b) ? (a) : (b))
#define CLAMP(x, lo, hi) MAX(lo, MIN(x, hi))
#define ABS(x) ((x) < 0 ? -(x) : (x))
#define BIT(n) (1u << (n))
#define FIELD(word, pos, len) (((word) >> (pos)) & (BIT(len) - 1))
#define JOIN_(a, b) a##b
#define JOIN(a, b) JOIN_(a, b)
#define TEXT_(x) #x
#define TEXT(x) TEXT_(x)
#define CHECK(x) do { if (!(x)) fail(#x, TEXT(SEVEN)); } while (0)
#define GETTER(type, name) type JOIN(get_, name)(void) { return JOIN(name, _); }
#define SEVEN 7
#define AS_ENUM(name, value) JOIN(KIND_, name) = value,
#define AS_CASE(name, value) case value: return TEXT(name);
#define AS_SUM(name, value) + (value)
#define AS_FIELD(name, value) int name##_##value;
"""
# A line of calls, and how many function-like macros are replaced for it.
LINES = (
    ("{a} = MAX(MIN({b}, {c}), {n});", 2),
    ("{a} = CLAMP({b}, 0, {n});", 3),
    ("{a} = CLAMP(ABS({b}), {c}, {n});", 4),
    ("{a} |= FIELD({b}, 3, {n}) | BIT(SEVEN);", 3),
    ("CHECK({a} > ABS({c}));", 4),
    ("GETTER(int, {a})", 5),
    ("puts(TEXT(JOIN({a}, {b})));", 4),
    ("JOIN({a}, JOIN(_, {n})) = BIT(FIELD({c}, 1, 2));", 7),
)
ROWS = 24


def functions(folder, rng, scale):
    """Nested calls of function-like macros, with # and ##, and X-macro tables."""
    writer = Writer(rng)
    text = [CALLS]
    for number in range(20):
        rows = [f"X({name}, {n + 1})" for n, name in enumerate(rng.sample(writer.names, ROWS))]
        text.append(f"#define TABLE_{number}(X) \\\n    " + " \\\n    ".join(rows) + "\n")
    # A row read as enumeration or case stands for two calls more than the one of the table.
    tables = (("AS_ENUM", 1 + 3 * ROWS), ("AS_CASE", 1 + 3 * ROWS))
    tables += (("AS_SUM", 1 + ROWS), ("AS_FIELD", 1 + ROWS))
    count = 0
    while count < 700000 * scale:
        if rng.random() < 0.07:
            reading, calls = rng.choice(tables)
            text.append(f"TABLE_{rng.randrange(20)}({reading})\n")
        else:
            form, calls = rng.choice(LINES)
            a, b, c = rng.sample(writer.names, 3)
            text.append("    " + form.format(a=a, b=b, c=c, n=rng.randrange(1, 100)) + "\n")
        count += calls
    folder.write("main.c", "".join(text))


def bigmacro(folder, rng, scale):
    """Bodies and arguments of 40 KB."""
    writer = Writer(rng, 1000)
    size = 40000
    code = [line.strip() + " " for line in writer.code_lines(4000) if "/*" not in line]
    code = [line for line in code if line.strip()]
    uses = [f"SMALL_{n} + " for n in range(20)] + ["TWICE(SMALL_3) - ", "TWICE(x) * "] * 5
    # Without commas and with parentheses that match: fit for an argument. Without quotes in quotes,
    # which # treats in its own way.
    flat = [line.replace(",", " +") for line in code if line.count("(") == line.count(")")]
    flat = [line for line in flat if "'" not in line]
    text = [f"#define SMALL_{n} ({n} + value)\n" for n in range(20)]
    text.append("#define TWICE(x) ((x) + (x))\n#define SAME(x) x\n#define TEXT(x) #x\n")
    text.append("#define FIRST(a, b) a\n")
    for number in range(max(1, round(8 * scale))):
        body = writer.fill(code * 3 + uses * 40, size)
        text.append(f"#define OBJECT_{number} {body}\n")
        body = writer.fill(code * 3 + uses * 40 + ["a + b; "] * 400, size)
        text.append(f"#define CALL_{number}(a, b) {body}\n")
        parts = [writer.fill(code, 2000) for _ in range(size // 2000)]
        text.append(f"#define LINES_{number}(a) a \\\n  " + " \\\n  ".join(parts) + "\n")
        text.append(f"OBJECT_{number};\nCALL_{number}(one, SMALL_1);\nOBJECT_{number};\n")
        text.append(f"LINES_{number}(SMALL_2);\nCALL_{number}(CALL_{number}(1, 2), 3);\n")
        text.append(f"SAME({writer.fill(flat + uses, size)});\n")
        text.append(f"SAME(SAME({writer.fill(flat + uses, size)}));\n")
        text.append(f"TEXT({writer.fill(flat, size)});\n")
    folder.write("main.c", "".join(text))
