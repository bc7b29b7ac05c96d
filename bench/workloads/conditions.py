# SPDX-License-Identifier: MIT
"""Conditions whose value is known while they are made."""


class Expressions:
    """Makes conditions over macros with known values.

    Values stay small and are never negative, and nothing is divided by zero, so that arithmetic of
    any width gives the same.
    """

    LIMIT = 1 << 20

    def __init__(self, rng):
        self.rng = rng
        self.values = {f"CONFIG_OPTION_{n}": rng.randrange(1000) for n in range(300)}
        self.names = list(self.values)
        self.absent = [f"CONFIG_ABSENT_{n}" for n in range(300)]

    def definitions(self):
        """Returns the definitions of the macros."""
        return "".join(f"#define {name} {value}\n" for name, value in self.values.items())

    def sorted_by_value(self, count):
        """Returns so many true conditions and so many false ones."""
        found = {True: [], False: []}
        while min(map(len, found.values())) < count:
            text, value = self.condition(2)
            found[bool(value)].append(text)
        return found[True][:count], found[False][:count]

    def operand(self):
        """Returns a number or a name, with its value."""
        kind = self.rng.random()
        if kind < 0.4:
            name = self.rng.choice(self.names)
            return name, self.values[name]
        if kind < 0.5:
            return self.rng.choice(self.absent), 0
        value = self.rng.randrange(1000)
        return self.rng.choice(("{}", "{}", "0x{:x}", "{}L")).format(value), value

    def arithmetic(self, depth):
        """Returns an expression without blanks in doubt, with its value."""
        if depth == 0:
            return self.operand()
        (left, a), (right, b) = self.arithmetic(depth - 1), self.arithmetic(depth - 1)
        small = self.rng.randrange(1, 9)
        text, value = self.rng.choice(
            (
                (f"({left} + {right})", a + b),
                (f"({left} * {small})", a * small),
                (f"({left} / {small})", a // small),
                (f"({left} % {small * 3})", a % (small * 3)),
                (f"({left} & {right})", a & b),
                (f"({left} | {right})", a | b),
                (f"({left} ^ {right})", a ^ b),
                (f"({left} << {small})", a << small),
                (f"({left} >> {small})", a >> small),
                (f"({left} > {right} ? {left} : {right})", max(a, b)),
            )
        )
        return (text, value) if value < self.LIMIT else self.operand()

    def comparison(self):
        """Returns two expressions compared, with the value."""
        (left, a), (right, b) = self.arithmetic(self.rng.randint(0, 2)), self.operand()
        return self.rng.choice(
            (
                (f"{left} > {right}", a > b),
                (f"{left} < {right}", a < b),
                (f"{left} >= {right}", a >= b),
                (f"{left} <= {right}", a <= b),
                (f"{left} == {right}", a == b),
                (f"{left} != {right}", a != b),
                (f"{left}", a != 0),
            )
        )

    def condition(self, depth):
        """Returns a condition, with its value."""
        kind = self.rng.random()
        if kind < 0.15:
            name = self.rng.choice(self.names)
            return self.rng.choice((f"defined({name})", f"defined {name}")), True
        if kind < 0.35:
            name = self.rng.choice(self.absent)
            return self.rng.choice((f"defined({name})", f"defined {name}")), False
        if depth == 0 or kind < 0.55:
            return self.comparison()
        left, a = self.condition(depth - 1)
        right, b = self.condition(depth - 1)
        if kind < 0.75:
            return f"({left}) && ({right})", a and b
        if kind < 0.9:
            return f"({left}) || ({right})", a or b
        return f"!({left})", not a
