#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The public Java API is that of abi/java-api.txt, and no change of it goes unnoticed."""

import os
import pathlib
import shutil
import subprocess
import tempfile
import unittest

import environment

JAVA = os.environ["ORV_JAVA"]
JAVAC = os.environ["ORV_JAVAC"]
JAR = os.environ["ORV_JAR"]
MODULES = environment.BINARY / "java/modules.txt"
DESCRIPTION = environment.SOURCE / "abi/java-api.txt"
ADVICE = ("orv: the public Java API is not that of abi/java-api.txt; if the change is meant, "
          "./orv abi --accept records it.")

BOX = """package shown;

public abstract class Box<T extends Comparable<? super T> & java.io.Closeable>
        extends java.util.AbstractList<T[]> implements java.io.Serializable {
    public static final String NAME = "a \\"box\\"";
    protected static final long SIZE = 7;
    @Deprecated public int count;
    int hidden = 1;
    private static final long serialVersionUID = 1;

    protected Box(int... sizes) throws java.io.IOException {}
    public <E extends Exception> java.util.List<? extends T> open(
            java.util.Map<String, byte[]> map, boolean fast) throws E {
        return null;
    }
    void hide() {}
    public sealed interface Shape {
        default int sides() {
            return 0;
        }
    }
    public record Circle(java.util.List<String> names, int radius) implements Shape {}
    public enum Kind { SMALL, LARGE }
    interface Hidden {}
}
"""
DESCRIBED = """module one exports shown
module one requires transitive java.logging
shown.Box = public abstract class<T extends java.lang.Comparable<? super T> & java.io.Closeable> \
extends java.util.AbstractList<T[]> implements java.io.Serializable
shown.Box.<init>(int[]) = protected constructor varargs throws java.io.IOException
shown.Box.Circle = public static final record(java.util.List<java.lang.String> names, int radius) \
extends java.lang.Record implements shown.Box.Shape
shown.Box.Circle.<init>(java.util.List<java.lang.String>, int) = public constructor
shown.Box.Circle.equals(java.lang.Object) = public final boolean
shown.Box.Circle.hashCode() = public final int
shown.Box.Circle.names() = public java.util.List<java.lang.String>
shown.Box.Circle.radius() = public int
shown.Box.Circle.toString() = public final java.lang.String
shown.Box.Kind = public static final enum extends java.lang.Enum<shown.Box.Kind>
shown.Box.Kind.LARGE = public static final enum constant
shown.Box.Kind.SMALL = public static final enum constant
shown.Box.Kind.valueOf(java.lang.String) = public static shown.Box.Kind
shown.Box.Kind.values() = public static shown.Box.Kind[]
shown.Box.NAME = public static final java.lang.String "a \\"box\\""
shown.Box.SIZE = protected static final long 7L
shown.Box.Shape = public abstract static sealed interface permits shown.Box.Circle
shown.Box.Shape.sides() = public default int
shown.Box.count = @Deprecated public int
shown.Box.open(java.util.Map<java.lang.String, byte[]>, boolean) = public <E extends \
java.lang.Exception> java.util.List<? extends T> throws E
"""


def run(*command):
    subprocess.run([*map(str, command)], check=True, capture_output=True, text=True)


class JavaApiTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def tool(self, mode, modules, description):
        return environment.run("java_api.py", mode, modules, description, "--java", JAVA)

    def test_the_api_is_that_of_the_description(self):
        self.assertEqual(self.tool("check", MODULES, DESCRIPTION), (0, [], []))

    def test_a_change_of_it_is_noticed(self):
        changed = self.folder / "java-api.txt"
        lines = DESCRIPTION.read_text("utf-8").splitlines()
        start = "com.quintora.mmp.MediaPlayer.start() = public abstract void"
        lines[lines.index(start)] = start.replace("void", "int")
        changed.write_text("\n".join(lines), "utf-8")
        self.assertEqual(
            self.tool("check", MODULES, changed),
            (1, ["gone: " + start.replace("void", "int"), "new:  " + start], [ADVICE]))

    def test_what_may_be_null_is_described(self):
        self.assertIn(
            "com.quintora.mmp.MediaPlayer.setSurface(@Nullable android.view.Surface)"
            " = public abstract void",
            DESCRIPTION.read_text("utf-8").splitlines())

    def build(self, **sources):
        """A module's JAR, of sources by their names; the file that names it."""
        where = self.folder / "one"
        shutil.rmtree(where, ignore_errors=True)
        (where / "shown").mkdir(parents=True)
        (where / "module-info.java").write_text(
            "module one { requires transitive java.logging; exports shown; }\n", "utf-8")
        for name, text in sources.items():
            (where / f"shown/{name}.java").write_text(text, "utf-8")
        run(JAVAC, "--release", "17", "-d", where / "classes", *where.rglob("*.java"))
        run(JAR, "--create", "--file", self.folder / "one.jar", "-C", where / "classes", ".")
        modules = self.folder / "modules.txt"
        modules.write_text(f"described {self.folder / 'one.jar'}\n", "utf-8")
        return modules

    def test_every_kind_of_element_is_described(self):
        description = self.folder / "api.txt"
        modules = self.build(Box=BOX)
        self.assertEqual(self.tool("accept", modules, description), (0, [], []))
        lines = description.read_text("utf-8").splitlines(keepends=True)
        self.assertEqual("".join(line for line in lines if not line.startswith("#")), DESCRIBED)
        self.assertEqual(self.tool("check", modules, description), (0, [], []))
        self.build(Box=BOX.replace("SIZE = 7", "SIZE = 8").replace("int hidden", "int covered"))
        self.assertEqual(
            self.tool("check", modules, description),
            (1, ["gone: shown.Box.SIZE = protected static final long 7L",
                 "new:  shown.Box.SIZE = protected static final long 8L"], [ADVICE]))

    def test_unfit_input_is_refused_in_a_sentence(self):
        modules = self.folder / "modules.txt"
        modules.write_text("described /no/such.jar\n", "utf-8")
        self.assertEqual(self.tool("check", modules, DESCRIPTION),
                         (2, [], ["orv: /no/such.jar: not built yet"]))
        modules.write_text("jar\n", "utf-8")
        self.assertEqual(self.tool("check", modules, DESCRIPTION),
                         (2, [], [f"orv: {modules}:1: not 'described JAR' or 'needed JAR'"]))


if __name__ == "__main__":
    unittest.main()
