# SPDX-License-Identifier: Apache-2.0
"""Finds the mutants of C++ sources in clang's syntax tree."""

import re

from clang import cindex
from clang.cindex import CursorKind as Kind
from clang.cindex import TypeKind

import operators
import swaps
from mutant import Failed, Mutant

FUNCTIONS = {Kind.FUNCTION_DECL, Kind.CXX_METHOD, Kind.CONSTRUCTOR, Kind.DESTRUCTOR,
             Kind.CONVERSION_FUNCTION, Kind.FUNCTION_TEMPLATE}
CONDITIONAL = {Kind.IF_STMT, Kind.WHILE_STMT, Kind.CONDITIONAL_OPERATOR}
LOOPS = {Kind.FOR_STMT, Kind.WHILE_STMT, Kind.DO_STMT, Kind.CXX_FOR_RANGE_STMT}
LITERALS = {Kind.INTEGER_LITERAL, Kind.FLOATING_LITERAL, Kind.CXX_BOOL_LITERAL_EXPR}
BINARY = {Kind.BINARY_OPERATOR, Kind.COMPOUND_ASSIGNMENT_OPERATOR}
POINTERS = {TypeKind.POINTER, TypeKind.MEMBERPOINTER, TypeKind.NULLPTR}
SYMBOL = re.compile(r"[-+*/%<>=!&|^]+")
LOCK = re.compile(r"lock|mutex", re.IGNORECASE)
COMMENT = re.compile(rb"//[^\n]*|/\*.*?\*/", re.DOTALL)


def find(path, arguments, wanted):
    """The mutants of a translation unit, in its own file and in headers.

    wanted(absolute path) gives (area, name of the file) or None for another's."""
    index = cindex.Index.create()
    unit = index.parse(path, args=arguments,
                       options=cindex.TranslationUnit.PARSE_DETAILED_PROCESSING_RECORD)
    errors = [d for d in unit.diagnostics if d.severity >= cindex.Diagnostic.Error]
    if errors:
        raise Failed(f"clang cannot read {path}: {errors[0].spelling}.")
    macros = {}
    for cursor in unit.cursor.get_children():
        if cursor.kind == Kind.MACRO_INSTANTIATION and cursor.location.file:
            macros.setdefault(cursor.location.file.name, set()).add(extent(cursor))
    files = {}
    for cursor in unit.cursor.get_children():
        file = cursor.location.file
        if file is None:
            continue
        if file.name not in files:
            place = wanted(file.name)
            files[file.name] = place and FileFinder(file.name, *place, macros.get(file.name, set()))
        if files[file.name]:
            files[file.name].look_for_functions(cursor)
    return [mutant for finder in files.values() if finder for mutant in finder.found]


def extent(cursor):
    """Its bytes in the file; a macro's are where it is used."""
    return cursor.extent.start.offset, cursor.extent.end.offset


def qualified_name(cursor):
    names = []
    while cursor is not None and cursor.kind != Kind.TRANSLATION_UNIT:
        if cursor.spelling and cursor.kind != Kind.NAMESPACE:
            names.append(re.sub(r"<.*", "", cursor.spelling))
        cursor = cursor.semantic_parent
    return "::".join(reversed(names))


class FileFinder:
    """Finds those of one file."""

    def __init__(self, path, area, name, macros):
        with open(path, "rb") as file:
            self.source = file.read()
        self.path = path
        self.area = area
        self.name = name
        self.macros = macros
        self.found = []
        self.function = None
        self.loops = []  # of the loops and switches around, whether each is a loop

    def look_for_functions(self, cursor):
        # A file may be included within what another one opens.
        if cursor.location.file is None or cursor.location.file.name != self.path:
            return
        if cursor.kind in FUNCTIONS:
            if cursor.is_definition():
                self.function = cursor
                self.look_into(cursor)
        elif cursor.kind in (Kind.NAMESPACE, Kind.CLASS_DECL, Kind.STRUCT_DECL, Kind.CLASS_TEMPLATE,
                             Kind.LINKAGE_SPEC, Kind.UNEXPOSED_DECL):
            for child in cursor.get_children():
                self.look_for_functions(child)

    # What a macro makes of its arguments is left as it is.
    def is_in_macro(self, cursor):
        start, end = extent(cursor)
        return any(first <= start and end <= last for first, last in self.macros)

    def look_into(self, cursor):
        children = list(cursor.get_children())
        if self.is_in_macro(cursor):
            return
        self.examine(cursor, children)
        enclosing = cursor.kind in LOOPS or cursor.kind == Kind.SWITCH_STMT
        if enclosing:
            self.loops.append(cursor.kind in LOOPS)
        for child in children:
            self.look_into(child)
        if enclosing:
            self.loops.pop()

    def examine(self, cursor, children):
        kind = cursor.kind
        if kind in CONDITIONAL:
            self.negate(children, kind == Kind.CONDITIONAL_OPERATOR)
        elif kind == Kind.DO_STMT:
            self.negate(children[-1:], True)
        elif kind in BINARY and len(children) == 2:
            self.change_symbol(extent(children[0])[1], extent(children[1])[0])
        elif kind == Kind.UNARY_OPERATOR and children:
            self.change_step(cursor, children[0])
        elif kind in LITERALS:
            self.change_constant(cursor)
        elif kind == Kind.RETURN_STMT and children:
            self.change_returned(children[0])
        elif kind in (Kind.BREAK_STMT, Kind.CONTINUE_STMT):
            self.change_jump(cursor)
        elif kind == Kind.COMPOUND_STMT:
            self.change_statements(children)
        if kind in CONDITIONAL - {Kind.CONDITIONAL_OPERATOR} or kind in LOOPS:
            self.change_bodies(kind, children)

    def add(self, operator, start, end, becomes):
        text = self.source[start:end].decode()
        self.found.append(Mutant(
            self.area, self.name, qualified_name(self.function), operator,
            self.source.count(b"\n", 0, start) + 1, start, end, text, becomes,
            self.function.extent.start.line, self.function.extent.end.line))

    def text(self, cursor):
        start, end = extent(cursor)
        return self.source[start:end].decode()

    def negate(self, children, is_expression):
        condition = next((c for c in children if c.kind.is_expression()), None)
        if condition is None or (not is_expression and condition is children[-1]):
            return
        self.add("negate-condition", *extent(condition), f"!({self.text(condition)})")

    # Comments are blanked so that what they hold is not taken for an operator.
    def change_symbol(self, start, end):
        between = COMMENT.sub(lambda m: b" " * len(m[0]), self.source[start:end]).decode("latin-1")
        symbol = SYMBOL.search(between)
        if symbol and symbol[0] in operators.SYMBOLS:
            operator, becomes = operators.SYMBOLS[symbol[0]]
            self.add(operator, start + symbol.start(), start + symbol.end(), becomes)

    def change_step(self, cursor, operand):
        (start, end), (first, last) = extent(cursor), extent(operand)
        for left, right in ((start, first), (last, end)):
            if self.source[left:right].strip() in (b"++", b"--"):
                self.change_symbol(left, right)

    def change_constant(self, cursor):
        for becomes in operators.constants(self.text(cursor)):
            self.add("constant", *extent(cursor), becomes)

    def change_returned(self, expression):
        result = self.function.result_type.get_canonical()
        kind = "other"
        if result.kind == TypeKind.BOOL or self.function.result_type.spelling == "jboolean":
            kind = "bool"
        elif result.kind in POINTERS:
            kind = "pointer"
        elif TypeKind.CHAR_U.value <= result.kind.value <= TypeKind.LONGDOUBLE.value:
            kind = "number"
        for becomes in operators.returned(self.text(expression), kind):
            self.add("return-value", *extent(expression), becomes)

    def change_jump(self, cursor):
        start, end = extent(cursor)
        if cursor.kind == Kind.CONTINUE_STMT:
            self.add("break-continue", start, end, "break")
        elif self.loops and self.loops[-1]:
            self.add("break-continue", start, end, "continue")
        else:
            self.add("remove-statement", start, end, "")

    def change_bodies(self, kind, children):
        """The statements that stand alone, without braces."""
        bodies = children[1:] if kind == Kind.IF_STMT else children[-1:]
        if kind == Kind.DO_STMT:
            bodies = children[:1]
        for body in bodies:
            statement = swaps.Statement(self, body)
            if statement.is_expression():
                self.remove(statement, "remove-statement")

    def change_statements(self, children):
        statements = [swaps.Statement(self, child) for child in children]
        for statement in statements:
            if statement.is_expression():
                self.remove(statement, "remove-statement")
            elif statement.is_declaration() and LOCK.search(statement.declared_type()):
                self.remove(statement, "drop-lock")
        for first, second in zip(statements, statements[1:]):
            if swaps.is_worth_swapping(first, second):
                between = self.source[first.end:second.start].decode()
                self.add("swap-statements", first.start, second.end,
                         second.text + between + first.text)

    def remove(self, statement, operator):
        self.add(operator, statement.start, statement.end,
                 operators.keeping_lines(statement.text, ";"))
