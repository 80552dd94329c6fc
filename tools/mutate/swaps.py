# SPDX-License-Identifier: Apache-2.0
"""Which neighbouring C++ statements are worth changing places: those whose order
something may notice."""

import re

from clang.cindex import CursorKind as Kind
from clang.cindex import TypeKind

EFFECTS = {Kind.CALL_EXPR, Kind.CXX_NEW_EXPR, Kind.CXX_DELETE_EXPR, Kind.RETURN_STMT,
           Kind.BREAK_STMT, Kind.CONTINUE_STMT, Kind.GOTO_STMT, Kind.CXX_THROW_EXPR}
PARTS = {Kind.MEMBER_REF_EXPR, Kind.ARRAY_SUBSCRIPT_EXPR, Kind.PAREN_EXPR, Kind.UNEXPOSED_EXPR}
REFERENCES = {TypeKind.POINTER, TypeKind.LVALUEREFERENCE, TypeKind.RVALUEREFERENCE}
CONTROL = {Kind.IF_STMT, Kind.FOR_STMT, Kind.WHILE_STMT, Kind.DO_STMT, Kind.SWITCH_STMT,
           Kind.CXX_FOR_RANGE_STMT, Kind.COMPOUND_STMT, Kind.CXX_TRY_STMT}
LABELS = {Kind.CASE_STMT, Kind.DEFAULT_STMT, Kind.LABEL_STMT}
NAME = re.compile(r"[A-Za-z_]\w*")
PLAIN = re.compile(r"^[^(){}=]*[\w>&*\s]\s*;$")


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

    def is_plain_declaration(self):
        """Of a variable that is made of nothing: what stands around it is not seen by it."""
        return self.is_declaration() and PLAIN.search(self.text) is not None

    def has_effect(self):
        """A call, or a way out."""
        if self.is_plain_declaration():
            return False
        return self.is_macro or any(c.kind in EFFECTS for c in self.cursor.walk_preorder())

    def names(self):
        """Without what stands in texts."""
        return set(NAME.findall(re.sub(r'"(\\.|[^"\\])*"', '""', self.text)))

    def declared(self):
        if not self.is_declaration():
            return set()
        return {c.spelling for c in self.cursor.get_children()}

    def declared_type(self):
        return " ".join(c.type.spelling for c in self.cursor.get_children())

    def target(self):
        """What an assignment changes, as it is written; empty for another statement."""
        children = list(self.cursor.get_children())
        if not self.is_expression() or self.is_macro or len(children) not in (1, 2):
            return ""
        start, end = children[0].extent.start.offset, children[0].extent.end.offset
        return self.text[start - self.start:end - self.start]

    def changes_local_alone(self):
        """An assignment to what the function itself declares."""
        cursor = next(self.cursor.get_children(), None)
        while cursor is not None and cursor.kind in PARTS:
            inner = next(cursor.get_children(), None)
            if inner is None or inner.type.kind in REFERENCES:
                return False
            cursor = inner
        target = cursor and cursor.referenced
        return target is not None and target.kind in (Kind.VAR_DECL, Kind.PARM_DECL) \
            and target.type.kind not in REFERENCES and target.semantic_parent is not None \
            and target.semantic_parent.kind not in (Kind.TRANSLATION_UNIT, Kind.NAMESPACE)


def is_worth_swapping(first, second):
    for statement in (first, second):
        if not (statement.is_expression() or statement.is_declaration() or statement.is_control()):
            return False
    # What a second statement needs of the first's declarations is not there before them.
    if first.declared() & second.names() or first.text == second.text:
        return False
    if first.has_effect() and second.has_effect():
        return True
    if is_used(first.target(), second) or is_used(second.target(), first):
        return True
    if not (first.has_effect() or second.has_effect()):
        return False
    silent, other = (second, first) if first.has_effect() else (first, second)
    if silent.is_declaration():
        return False
    return bool(silent.names() & other.names()) or not silent.changes_local_alone()


def is_used(target, statement):
    pattern = rf"(?<!\w){re.escape(target)}(?!\w)"
    return bool(target) and re.search(pattern, statement.text) is not None
