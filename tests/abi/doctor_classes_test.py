#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The doctor's look at the Java classes: classes are made from the list of
what the library needs, whole and with faults."""

import pathlib
import re
import subprocess
import tempfile
import unittest
import zipfile

import environment
import classes

LIST = environment.SOURCE / "abi/java.txt"
PLAYER = "com/quintora/mmp/OrvMediaPlayer"
PRIMITIVES = {"V": "void", "Z": "boolean", "B": "byte", "S": "short", "I": "int", "J": "long",
              "F": "float"}


def java_types(descriptors):
    """Java's words for a row of type descriptors."""
    types = []
    for array, letter, path in re.findall(r"(\[*)(?:([VZBSIJF])|L([^;]+);)", descriptors):
        name = PRIMITIVES[letter] if letter else path.replace("/", ".").replace("$", ".")
        types.append(name + "[]" * len(array))
    return types


def declaration(need):
    if need.kind == "extends":
        return ""
    static = "static " if need.static else ""
    if need.kind == "field":
        return f"{static}{java_types(need.type)[0]} {need.name};"
    arguments, result = need.type[1:].split(")")
    result = java_types(result)[0]
    parameters = ", ".join(f"{t} p{i}" for i, t in enumerate(java_types(arguments)))
    head = f"{result} {need.name}({parameters})"
    if need.kind == "native":
        return f"{static}native {head};"
    body = "" if result == "void" else "return 0;"
    return f"{static}{head} {{ {body} }}"


def named_classes(needs):
    """The classes of the list, and those that its descriptors name."""
    words = " ".join(need.type for members in needs.values() for need in members)
    return set(needs) | {p for p in re.findall(r"L([^;]+);", words) if not p.startswith("java/")}


def write_sources(needs, folder):
    paths = named_classes(needs)
    files = []
    for path in sorted(path for path in paths if "$" not in path):
        package, name = path.rsplit("/", 1)
        nested = "".join(class_text(inner, needs, "static ") for inner in sorted(paths)
                         if inner.startswith(path + "$"))
        file = folder / (path + ".java")
        file.parent.mkdir(parents=True, exist_ok=True)
        file.write_text(f"package {package.replace('/', '.')};\n"
                        + class_text(path, needs, "", nested))
        files.append(file)
    return files


def class_text(path, needs, static, nested=""):
    members = needs.get(path, [])
    parent = "".join(f" extends {need.name.replace('/', '.')}"
                     for need in members if need.kind == "extends")
    body = "\n".join(map(declaration, members))
    return f"public {static}class {re.split('[/$]', path)[-1]}{parent} {{\n{body}\n{nested}}}\n"


class DoctorClassesTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.needs = classes.read_needs(LIST)

    def make_jar(self, *, without=()):
        out = self.folder / "classes"
        files = write_sources(self.needs, self.folder / "sources")
        subprocess.run(["javac", "-proc:none", "-nowarn", "-d", out, *files], check=True)
        jar = self.folder / "made.jar"
        with zipfile.ZipFile(jar, "w") as archive:
            for file in out.rglob("*.class"):
                path = str(file.relative_to(out))
                if path[:-len(".class")] not in without:
                    archive.write(file, path)
        return jar

    def change(self, path, name, **changes):
        members = self.needs[path]
        place = next(i for i, need in enumerate(members) if need.name == name)
        members[place] = members[place]._replace(**changes)

    def remove(self, path, name):
        self.needs[path] = [need for need in self.needs[path] if need.name != name]

    def test_the_listed_classes_are_clean(self):
        status, lines, _ = environment.run("classes.py", self.make_jar(), LIST)
        self.assertEqual((status, len(lines)), (0, 1), lines)

    def test_every_kind_of_fault_is_named(self):
        util = "com/quintora/mmp/util/"
        self.remove(PLAYER, "native_start")
        self.change(PLAYER, "native_seekTo", type="(J)V")
        self.change(PLAYER, "native_init", static=False)
        self.change(PLAYER, "native_stop", static=True)
        self.change(PLAYER, "native_pause", kind="method")
        self.change(PLAYER, "mStreamSize", type="I")
        self.remove(PLAYER, "mStreamCurPos")
        self.change(PLAYER, "mDataSourceType", static=True)
        self.change(PLAYER, "postEventFromNative", static=False)
        self.change(PLAYER, "readStream", type="(J)I")
        self.remove(PLAYER, "setAllAudioTrackInfo")
        self.change(util + "SubtitleAttr$Subtitle_Color", "mG", type="I")
        self.remove("com/quintora/SubtitleAttr", util + "SubtitleAttr")
        self.needs[PLAYER].append(classes.Need("native", "native_extra", "()V", False))
        jar = self.make_jar(without=[util + "ThumbnailInfo"])
        status, lines, _ = environment.run("classes.py", jar, LIST)
        audio = next(need.type for need in classes.read_needs(LIST)[PLAYER]
                     if need.name == "setAllAudioTrackInfo")
        self.assertEqual(status, 1)
        self.assertEqual(lines[:-1], [
            f"{PLAYER}: native method native_start ()V is missing",
            f"{PLAYER}: native method native_stop ()V is static, which it must not be",
            f"{PLAYER}: native method native_seekTo (I)V is (J)V instead",
            f"{PLAYER}: native method native_pause ()V is not declared native",
            f"{PLAYER}: static native method native_init ()V is not static",
            f"{PLAYER}: static method postEventFromNative "
            "(Ljava/lang/Object;IIILjava/lang/Object;)V is not static",
            f"{PLAYER}: method readStream (I)I is (J)I instead",
            f"{PLAYER}: field mStreamSize J is I instead",
            f"{PLAYER}: field mStreamCurPos J is missing",
            f"{PLAYER}: field mDataSourceType I is static, which it must not be",
            f"{PLAYER}: method setAllAudioTrackInfo {audio} is missing",
            f"{PLAYER}: native method native_seekTo (J)V has no function here",
            f"{PLAYER}: native method native_extra ()V has no function here",
            "com/quintora/SubtitleAttr: does not extend com/quintora/mmp/util/SubtitleAttr, "
            "whose fields are read in it",
            f"{util}SubtitleAttr$Subtitle_Color: field mG B is I instead",
            f"{util}ThumbnailInfo: the class is missing"])

    def refused(self, jar, why):
        self.assertEqual(environment.run("classes.py", jar, LIST),
                         (2, [], [f"orv: {jar}: {why}"]))

    def test_what_is_no_jar_is_refused(self):
        self.refused(self.folder / "none.jar", "No such file or directory")
        text = self.folder / "text.jar"
        text.write_text("not a jar")
        self.refused(text, "not a JAR")
        empty = self.folder / "empty.jar"
        zipfile.ZipFile(empty, "w").close()
        self.refused(empty, "holds no classes")
        dex = self.folder / "dex.jar"
        with zipfile.ZipFile(dex, "w") as archive:
            archive.writestr("classes.dex", b"dex\n")
        self.refused(dex, "holds Android's bytecode (.dex); give the JAR it was made from")

    def test_a_damaged_class_is_refused(self):
        jar = self.folder / "damaged.jar"
        with zipfile.ZipFile(jar, "w") as archive:
            archive.writestr(PLAYER + ".class", b"not a class")
        status, lines, errors = environment.run("classes.py", jar, LIST)
        self.assertEqual((status, lines, len(errors)), (2, [], 1), errors)


if __name__ == "__main__":
    unittest.main()
