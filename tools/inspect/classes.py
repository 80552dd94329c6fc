#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""classes.py JAR LIST: what the classes in JAR lack of LIST.

LIST is abi/java.txt. Ends with 0 when nothing is lacking, 1 when something
is, 2 when the input is unfit."""

import collections
import re
import shutil
import subprocess
import sys
import zipfile

import refusal
from refusal import Refusal

Member = collections.namedtuple("Member", "name type static native")
Class = collections.namedtuple("Class", "path parent fields methods")
Need = collections.namedtuple("Need", "kind name type static")


def read_needs(path):
    """{class: [Need]}; a class's own parent is the Need of kind extends."""
    needs = {}
    with open(path, encoding="utf-8") as file:
        for line in file:
            words = line.split("#")[0].split()
            if not words:
                continue
            if words[0] == "class":
                members = needs.setdefault(words[1], [])
                continue
            static = words[0] == "static"
            kind, name, *rest = words[static:]
            members.append(Need(kind, name, rest[0] if rest else "", static))
    return needs


def open_jar(path):
    """The paths of the classes in a JAR."""
    try:
        with zipfile.ZipFile(path) as jar:
            names = jar.namelist()
    except OSError as error:
        raise Refusal(f"{path}: {error.strerror}") from None
    except zipfile.BadZipFile:
        raise Refusal(f"{path}: not a JAR") from None
    classes = {name[:-len(".class")] for name in names if name.endswith(".class")}
    if not classes:
        what = "Android's bytecode (.dex); give the JAR it was made from" \
            if any(name.endswith(".dex") for name in names) else "no classes"
        raise Refusal(f"{path}: holds {what}")
    return classes


def disassemble(jar, paths):
    """javap's text about those classes."""
    if shutil.which("javap") is None:
        raise Refusal("javap is not installed; it comes with a JDK (openjdk-17-jdk-headless)")
    done = subprocess.run(["javap", "-s", "-p", "-cp", jar,
                           *(path.replace("/", ".") for path in paths)],
                          text=True, capture_output=True)
    if done.returncode != 0:
        said = (done.stderr + done.stdout).strip().splitlines()
        raise Refusal(f"{jar}: a class in it cannot be read: {said[0] if said else 'javap failed'}")
    return done.stdout


def parse(text):
    """The classes in javap's text. A class is a head line and, up to a brace,
    each member's declaration and its descriptor on the line behind it."""
    for head, body in re.findall(r"^(\S[^\n]*) \{\n(.*?)^\}", text, re.MULTILINE | re.DOTALL):
        # Of a generic class only the name counts.
        head = re.sub(r"<.*?>(?=[ {]|$)", "", head)
        path = re.search(r"\b(?:class|interface) ([\w.$]+)", head).group(1)
        parent = re.search(r" extends ([\w.$]+)", head)
        found = Class(path.replace(".", "/"),
                      parent.group(1).replace(".", "/") if parent else None, [], [])
        for declared, type_ in re.findall(r"^ +(\S.*);\n +descriptor: (\S+)$", body, re.MULTILINE):
            words = declared.split("(")[0].split()
            member = Member(words[-1], type_, "static" in words, "native" in words)
            (found.methods if type_.startswith("(") else found.fields).append(member)
        yield found


class Jar:
    def __init__(self, path, wanted):
        self.path = path
        self.names = open_jar(path)
        self._parsed = {}
        self._read([name for name in wanted if name in self.names])

    def _read(self, paths):
        if paths:
            self._parsed.update((found.path, found)
                                for found in parse(disassemble(self.path, paths)))

    def find(self, path):
        """The class, or None when the JAR does not have it."""
        if path in self.names and path not in self._parsed:
            self._read([path])
        return self._parsed.get(path)

    def line(self, path):
        """The class and those it extends, as far as they are in the JAR."""
        found = self.find(path)
        while found is not None:
            yield found
            found = self.find(found.parent) if found.parent else None


def differences(need, candidates):
    """Why none of the members of that name will do, or None."""
    same_type = [member for member in candidates if member.type == need.type]
    if not candidates:
        return "is missing"
    if not same_type:
        types = " and ".join(member.type for member in candidates)
        return f"is {types} instead"
    member = same_type[0]
    if member.static != need.static:
        return "is static, which it must not be" if member.static else "is not static"
    if need.kind == "native" and not member.native:
        return "is not declared native"
    return None


def member_finding(jar, path, need):
    # Native methods are registered on the class itself; the rest is looked
    # up in the classes that it extends as well.
    places = [jar.find(path)] if need.kind == "native" else list(jar.line(path))
    candidates = [member for place in places
                  for member in (place.fields if need.kind == "field" else place.methods)
                  if member.name == need.name]
    found = differences(need, candidates)
    kind = "native method" if need.kind == "native" else need.kind
    static = "static " if need.static else ""
    return found and f"{path}: {static}{kind} {need.name} {need.type} {found}"


def class_findings(jar, path, needs):
    if jar.find(path) is None:
        yield f"{path}: the class is missing"
        return
    for need in needs:
        if need.kind == "extends":
            if need.name not in [place.path for place in jar.line(path)]:
                yield f"{path}: does not extend {need.name}, whose fields are read in it"
            continue
        finding = member_finding(jar, path, need)
        if finding:
            yield finding
    rows = {(need.name, need.type) for need in needs if need.kind == "native"}
    for member in jar.find(path).methods if rows else []:
        if member.native and (member.name, member.type) not in rows:
            yield f"{path}: native method {member.name} {member.type} has no function here"


def check(path, list_path):
    needs = read_needs(list_path)
    jar = Jar(path, needs)
    findings = [finding for name in needs for finding in class_findings(jar, name, needs[name])]
    for finding in findings:
        print(finding)
    if findings:
        print(f"{path}: {len(findings)} things do not fit the library")
        return 1
    members = sum(map(len, needs.values()))
    print(f"{path}: has the {len(needs)} classes and {members} members that the library needs")
    return 0


def main(arguments):
    if len(arguments) != 2:
        raise Refusal(__doc__)
    return check(*arguments)


if __name__ == "__main__":
    refusal.exit_with(main, sys.argv[1:])
