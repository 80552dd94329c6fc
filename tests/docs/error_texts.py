# SPDX-License-Identifier: Apache-2.0
"""The error texts of C++ sources: what they log as errors or warnings, and what
they throw into Java. A text that is a function's parameter, a member of a table
or a formatted buffer is followed to the literals that get there; one that leads
nowhere is an error, so no text is passed over."""

import re

LOG_SINKS = ("ALOGE", "ALOGW")
LOG_FUNCTION = "__android_log_print"
PRIORITIES = ("ANDROID_LOG_WARN", "ANDROID_LOG_ERROR", "ANDROID_LOG_FATAL")
THROW = "jniThrowException"
OTHER_SINKS = re.compile(r"\b(?:ALOGF|ALOG_ASSERT|LOG_ALWAYS_FATAL\w*|LOG_FATAL\w*|ALOGE_IF|"
                         r"ALOGW_IF|LOG_PRI|__android_log_(?!print\b)\w+|"
                         r"jniThrow(?!Exception\b)\w+|"
                         r"Throw|ThrowNew|FatalError)\s*\(")
COMMENT = re.compile(r'("(?:\\.|[^"\\\n])*"|\'(?:\\.|[^\'\\\n])*\')|//[^\n]*|/\*.*?\*/', re.S)
LITERALS = re.compile(r'(?:"(?:\\.|[^"\\])*"\s*)+')


def without_comments(source):
    return COMMENT.sub(lambda match: match[1] or " ", source)


def split(text, start):
    """The parts between the bracket before start and the one that closes it,
    at its commas; and where that ends."""
    parts, part, depth, at = [], start, 0, start
    while True:
        character = text[at]
        if character in "\"'":
            while True:
                at += 1
                if text[at] == "\\":
                    at += 1
                elif text[at] == character:
                    break
        elif character in "([{":
            depth += 1
        elif character in ")]}":
            if depth == 0:
                return [*parts, text[part:at].strip()], at
            depth -= 1
        elif character == "," and depth == 0:
            parts.append(text[part:at].strip())
            part = at + 1
        at += 1


def literal(expression):
    """The text of string literals side by side; None for anything else."""
    if not LITERALS.fullmatch(expression):
        return None
    pieces = re.findall(r'"((?:\\.|[^"\\])*)"', expression)
    return "".join(pieces).replace(r"\n", "\n").replace(r"\"", '"').strip()


class Function:
    """One definition: its name, its parameters' names and its body."""

    HEAD = re.compile(r"\b((?:\w+::)*~?\w+)\s*\(")
    KEYWORDS = {"if", "for", "while", "switch", "return", "sizeof", "catch", "static_assert"}

    def __init__(self, name, parameters, body):
        self.name = name.split("::")[-1]
        self.parameters = [re.sub(r"\s*=.*", "", parameter).split(" ")[-1].strip("*&")
                           for parameter in parameters]
        self.body = body

    @staticmethod
    def all_of(text):
        """Those at any depth of namespaces and classes, none inside another."""
        at = 0
        while match := Function.HEAD.search(text, at):
            parameters, end = split(text, match.end())
            after = re.compile(r"\)\s*(?:const|override|noexcept|\s)*(?::[^;{}]*(?:\{[^{}]*\}"
                               r"[^;{}]*)*)?\{").match(text, end)
            if not after or match[1] in Function.KEYWORDS:
                at = match.end()
                continue
            _, closed = split(text, after.end())
            yield Function(match[1], parameters, text[after.end():closed])
            at = closed


def calls(text, name):
    """The arguments of each call or declaration of that name."""
    without_texts = re.sub(r'"((?:\\.|[^"\\])*)"', lambda match: f'"{" " * len(match[1])}"', text)
    for match in re.finditer(rf"\b{name}\s*\(", without_texts):
        yield split(text, match.end())[0]


class Sources:
    """Some sources, given as a dictionary from names to contents."""

    def __init__(self, contents):
        self.texts = {name: without_comments(text) for name, text in contents.items()}
        self.functions = {name: list(Function.all_of(text)) for name, text in self.texts.items()}
        self.logged, self.thrown = set(), set()
        self.unresolved = []
        self.seen = set()
        for file, text in self.texts.items():
            self.unresolved += [f"{file}: {match[0].strip('( ')} is not known here"
                                for match in OTHER_SINKS.finditer(text)]
            outside = text
            for function in self.functions[file]:
                outside = outside.replace(function.body, "")
            self.unresolved += [f"{file}: {name} is called outside of the functions found"
                                for name in (*LOG_SINKS, LOG_FUNCTION, THROW)
                                if next(calls(outside, name), None) is not None]

    def read(self):
        for name in LOG_SINKS:
            self.follow_calls(name, lambda arguments: [arguments], self.log)
        self.follow_calls(LOG_FUNCTION, lambda arguments: [arguments[2:]] if arguments[0]
                          in PRIORITIES else [], self.log)
        self.follow_calls(THROW, lambda arguments: [arguments[1:3]], self.throw)
        return self

    def follow_calls(self, name, choose, sink):
        """Gives the sink what each call of that name passes."""
        for file, functions in self.functions.items():
            for function in functions:
                for arguments in calls(function.body, name):
                    for chosen in choose(arguments):
                        sink(file, function, chosen)

    def log(self, file, function, arguments):
        text = literal(arguments[0])
        if text == "%s":
            self.log(file, function, arguments[1:])
        elif text is not None:
            self.logged.add(text)
        elif arguments[0] in function.parameters:
            at = function.parameters.index(arguments[0])
            self.once(("log", function.name, at), lambda: self.follow_calls(
                function.name, lambda passed: [passed[at:at + 1]], self.log))
        elif match := re.fullmatch(r"\w+[.](\w+)", arguments[0]):
            self.log_member(file, match[1])
        else:
            self.unresolved.append(f"{file}: {function.name} logs {arguments[0]}")

    def log_member(self, file, member):
        """A table's column: the struct's member in every value of that type."""
        tables = 0
        for match in re.finditer(r"\bstruct (\w+) \{([^{}]*)\}", self.texts[file]):
            names = re.findall(r"(\w+);", match[2])
            if member not in names:
                continue
            tables += 1
            for value in re.finditer(rf"\b{match[1]} \w+ = \{{", self.texts[file]):
                text = literal(split(self.texts[file], value.end())[0][names.index(member)])
                if text is None:
                    self.unresolved.append(f"{file}: {value[0]} has no literal as {member}")
                else:
                    self.logged.add(text)
        if tables == 0:
            self.unresolved.append(f"{file}: no struct has the member {member}")

    def throw(self, file, function, arguments):
        """(exception, message), either of which may be a parameter. What is kept
        is the message, or the exception's name where there is none."""
        exception, message = arguments
        if exception in function.parameters:
            at = function.parameters.index(exception)
            text = function.parameters.index(message) if message in function.parameters else None
            self.once(("throw", function.name, at, message), lambda: self.follow_calls(
                function.name, lambda passed: [[passed[at], passed[text] if text is not None
                                                else self.filled(function, message)]],
                self.throw))
            return
        if message == "nullptr":
            message = exception
        text = literal(self.filled(function, message))
        if text is None:
            self.unresolved.append(f"{file}: {function.name} throws {exception}, {message}")
        else:
            self.thrown.add(text.replace("/", ".") if message == exception else text)

    @staticmethod
    def filled(function, buffer):
        """What a function formats into that buffer of its own."""
        for arguments in calls(function.body, "snprintf"):
            if arguments[0] == buffer:
                return arguments[2]
        return buffer

    def once(self, key, do):
        if key not in self.seen:
            self.seen.add(key)
            do()
