# SPDX-License-Identifier: Apache-2.0
"""Which neighbouring C++ statements are worth changing places: those whose order
something may notice."""

import re

from clang.cindex import CursorKind as Kind

CALLS = {Kind.CALL_EXPR, Kind.CXX_NEW_EXPR, Kind.CXX_DELETE_EXPR}
CONTROL = {Kind.IF_STMT, Kind.FOR_STMT, Kind.WHILE_STMT, Kind.DO_STMT, Kind.SWITCH_STMT,
           Kind.CXX_FOR_RANGE_STMT, Kind.COMPOUND_STMT, Kind.CXX_TRY_STMT}
LABELS = {Kind.CASE_STMT, Kind.DEFAULT_STMT, Kind.LABEL_STMT}
NAME = re.compile(r"[A-Za-z_]\w*")


class Statement:
    """One with its semicolon; of a label, what is behind it."""

    def __init__(self, finder, cursor):
        while cursor.kind in LABELS:
            cursor = list(cursor.get_children())[-1]
        self.cursor = cursor
        self.start = cursor.extent.start.offset
        self.end = cursor.extent.end.offset
        self.is_macro = finder.is_in_macro(cursor)
        semicolon = re.compile(rb"\s*;").match(finder.source, self.end)
        ends_with_block = self.is_control() and finder.source[self.end - 1:self.end] == b"}"
        if semicolon and not ends_with_block:
            self.end = semicolon.end()
        self.text = finder.source[self.start:self.end].decode()

    def is_declaration(self):
        return self.cursor.kind == Kind.DECL_STMT

    def is_control(self):
        return self.cursor.kind in CONTROL and not self.is_macro

    def is_expression(self):
        return self.is_macro or self.cursor.kind.is_expression()

    def has_call(self):
        return self.is_macro or any(c.kind in CALLS for c in self.cursor.walk_preorder())

    def names(self):
        """Without what stands in texts."""
        return set(NAME.findall(re.sub(r'"(\\.|[^"\\])*"', '""', self.text)))

    def declared(self):
        if not self.is_declaration():
            return set()
        return {c.spelling for c in self.cursor.get_children()}

    def declared_type(self):
        return " ".join(c.type.spelling for c in self.cursor.get_children())

    def changes_local_alone(self):
        """An assignment without a call, to what the function itself declares."""
        children = list(self.cursor.get_children())
        if self.has_call() or not children or self.is_control():
            return False
        target = children[0].referenced
        return target is not None and target.kind in (Kind.VAR_DECL, Kind.PARM_DECL) \
            and children[0].kind in (Kind.DECL_REF_EXPR, Kind.UNEXPOSED_EXPR)


def is_worth_swapping(first, second):
    for statement in (first, second):
        if not (statement.is_expression() or statement.is_declaration() or statement.is_control()):
            return False
    # What a second statement needs of the first's declarations is not there before them.
    if first.declared() & second.names() or first.text == second.text:
        return False
    if first.has_call() and second.has_call():
        return True
    shared = first.names() & second.names()
    if not (first.has_call() or second.has_call()):
        return bool(shared) and not (first.is_declaration() or second.is_declaration())
    silent = second if first.has_call() else first
    return not silent.is_declaration() and (bool(shared) or not silent.changes_local_alone())
