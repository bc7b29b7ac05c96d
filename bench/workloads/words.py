# SPDX-License-Identifier: MIT
"""Names, numbers, prose and lines of C text, all from one random generator that is passed in."""

import string

PARTS = (
    "alloc array base begin bit block buffer byte cache call case channel check child clear clock"
    " close code color config copy core count create current data delete depth device dirty domain"
    " edge empty enable end entry error event field file filter find first flag flush format frame"
    " free global group handle hash head height hook index init input insert item iter key kind"
    " label last layer length level limit link list local lock loop main map mask match max memory"
    " message min mode mutex name next node notify number object offset open option order output"
    " owner packet page parent parse path peer pixel pool port position prev probe process queue"
    " range read record region register release remove reset result root route sample scale scan"
    " schedule scope search section select send sequence set shift signal size slot socket sort"
    " source stack start state status step stop stream string style sync system table tag target"
    " task text thread time token total trace tree type unit update user value vector version view"
    " visit wait width window word write zone"
).split()
TYPES = ("int", "unsigned", "char", "long", "size_t", "uint32_t", "const char", "void")
# What a line of code looks like: a, b, c are variables, f, g functions, n, m numbers, t a type,
# w prose, q a character.
CODE = (
    "{a} = {b};",
    "{a} = {b} + {c} * {n};",
    "{a}->{b} = {f}({c}, {n});",
    "if ({a} != {b} && {c}->{a} > {n}) {{",
    "if (!{f}({a}, &{b})) {{",
    "}}",
    "}}",
    "}} else {{",
    "return {f}({a}, {b}->{c});",
    "return {n};",
    "static {t} *{f}({t} *{a}, {t} {b})",
    "{{",
    "for ({a} = 0; {a} < {b}; {a}++) {{",
    "while ({a}->{b} != NULL && *{c}++ == {q}) {{",
    "case {n}:",
    "break;",
    "{t} {a}[{n}];",
    "{a}[{b} >> {n}] |= {m} << ({c} & 7);",
    '{f}({a}, "{w}: %d\\n", {b});',
    "struct {a} *{b} = container({c}, struct {a}, {g});",
    "{a} = {b} ? {f}({c}) : ({t})({a} - {n});",
    "/* {w} {w}. */",
    "",
)


class Writer:
    """Makes text. What it makes depends on the random generator and the order of calls alone."""

    def __init__(self, rng, name_count=4000):
        self.rng = rng
        self.names = self.make_names(name_count)

    def make_names(self, count, prefix=""):
        """Returns so many different names, of one to three words, in snake or camel case."""
        names = {}
        while len(names) < count:
            words = self.rng.choices(PARTS, k=self.rng.choice((1, 2, 2, 2, 3)))
            if self.rng.random() < 0.3:
                words = words[:1] + [word.capitalize() for word in words[1:]]
                name = prefix + "".join(words)
            else:
                name = prefix + "_".join(words)
            if name in names:
                name += str(self.rng.randrange(1000))
            names[name] = None
        return list(names)

    def number(self):
        """Returns a decimal, hexadecimal or octal number, few of them with a suffix."""
        value = self.rng.choice((self.rng.randrange(10), self.rng.randrange(100000)))
        form = self.rng.choice(("{}", "{}", "{}", "0x{:X}", "0x{:04x}", "{}u", "0{:o}"))
        return form.format(value)

    def prose(self, count):
        """Returns so many words."""
        return " ".join(self.rng.choices(PARTS, k=count))

    def quoted(self):
        """Returns a string literal, some with escapes and comment signs in it."""
        inner = self.prose(self.rng.randint(1, 5))
        ending = self.rng.choice(("", "", "", "\\n", ": %d", " \\\"x\\\"", " /* no */", " // no"))
        return f'"{inner}{ending}"'

    def character(self):
        """Returns a character literal."""
        return self.rng.choice(("'\\n'", "'\\''", "'\"'", "'\\0'", f"'{self.letter()}'"))

    def letter(self):
        return self.rng.choice(string.ascii_letters)

    def code_line(self, name):
        """Returns an indented line of code; name() gives each name in it."""
        text = self.rng.choice(CODE)
        values = {
            **{key: name() for key in "abcfg" if "{" + key + "}" in text},
            "n": self.number(),
            "m": self.number(),
            "t": self.rng.choice(TYPES),
            "q": self.character(),
            "w": self.prose(2),
        }
        return "    " * self.rng.randint(0, 3) + text.format(**values) + "\n"

    def code_lines(self, count, name=None):
        """Returns so many different lines of code."""
        name = name or (lambda: self.rng.choice(self.names))
        return [self.code_line(name) for _ in range(count)]

    def fill(self, members, size):
        """Returns a text of about so many bytes, made of these members."""
        return Pool(self.rng, members).text(size)


class Pool:
    """Texts of which larger ones are made."""

    def __init__(self, rng, members):
        self.rng = rng
        self.members = members
        self.mean = sum(map(len, members)) / len(members)

    def text(self, size):
        """Returns a text of about so many bytes, made of the pool's members."""
        return "".join(self.rng.choices(self.members, k=max(1, round(size / self.mean))))
