# SPDX-License-Identifier: Apache-2.0
"""The operators: what a piece of C++ source becomes."""

import re

SYMBOLS = {
    "<": ("relational", "<="), "<=": ("relational", "<"),
    ">": ("relational", ">="), ">=": ("relational", ">"),
    "==": ("relational", "!="), "!=": ("relational", "=="),
    "&&": ("logical", "||"), "||": ("logical", "&&"),
    "+": ("arithmetic", "-"), "-": ("arithmetic", "+"),
    "*": ("arithmetic", "/"), "/": ("arithmetic", "*"), "%": ("arithmetic", "*"),
    "<<": ("arithmetic", ">>"), ">>": ("arithmetic", "<<"),
    "&": ("arithmetic", "|"), "|": ("arithmetic", "&"), "^": ("arithmetic", "&"),
    "+=": ("arithmetic", "-="), "-=": ("arithmetic", "+="),
    "*=": ("arithmetic", "/="), "/=": ("arithmetic", "*="), "%=": ("arithmetic", "*="),
    "&=": ("arithmetic", "|="), "|=": ("arithmetic", "&="), "^=": ("arithmetic", "&="),
    "<<=": ("arithmetic", ">>="), ">>=": ("arithmetic", "<<="),
    "++": ("arithmetic", "--"), "--": ("arithmetic", "++"),
}
NAMES = ("arithmetic", "break-continue", "constant", "drop-lock", "logical", "negate-condition",
         "relational", "remove-statement", "return-value", "swap-statements")
NUMBER = re.compile(r"(0[xX][0-9a-fA-F']+|[0-9][0-9']*)([uUlL]*)$")
NAMED = re.compile(r"[A-Z][A-Z0-9_]*$")
REAL = re.compile(r"[0-9.][0-9.eE+-]*[fFlL]?$")


def constants(literal):
    """Of a literal as it is written: 0 and 1 change places, others move by one."""
    if literal in ("true", "false"):
        return ["false" if literal == "true" else "true"]
    number = NUMBER.match(literal)
    if number:
        digits = number[1].replace("'", "")
        octal = len(digits) > 1 and digits.isdigit() and digits[0] == "0"
        value = int(digits, 8 if octal else 0)
        values = {0: [1], 1: [0]}.get(value, [value + 1, value - 1])
        return [f"{changed}{number[2]}" for changed in values]
    return [f"({literal} + 1)"] if REAL.match(literal) else []


def returned(expression, kind):
    """What is returned in an expression's place; kind is bool, pointer, number or other."""
    bare = expression.strip()
    if kind == "bool":
        return [] if bare in ("true", "false") else [f"!({expression})"]
    if kind == "pointer":
        return [] if bare in ("nullptr", "0", "NULL") else ["nullptr"]
    if kind == "number":
        if NAMED.match(bare):
            return [f"({expression}) + 1"]  # it may be 0
        return [] if NUMBER.match(bare) else ["0"]
    return [] if bare in ("{}", "nullptr") else ["{}"]


def keeping_lines(text, becomes):
    """With the line breaks that the text has: other lines keep their numbers."""
    return becomes + "\n" * (text.count("\n") - becomes.count("\n"))
