#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""./orv mutate: its operators on small sources, and whole runs on a small program."""

import contextlib
import io
import json
import os
import pathlib
import shlex
import subprocess
import sys
import tempfile
import textwrap
import time
import unittest

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
JAVA_HOME = pathlib.Path(os.environ["ORV_JAVA_HOME"])
sys.path.insert(0, str(SOURCE / "tools/mutate"))
try:
    import cpp
except ModuleNotFoundError:
    print("skipped: clang's Python module is not installed; ./orv mutate installs it")
    sys.exit(77)
import jvm  # noqa: E402
import mutate  # noqa: E402
import processes  # noqa: E402
from areas import Area  # noqa: E402
from equivalents import Equivalents  # noqa: E402
from mutant import Failed, Mutant, numbered  # noqa: E402
from native import NativeArea, output_of  # noqa: E402


class Folder(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name).resolve()

    def write(self, name, text):
        path = self.folder / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text(textwrap.dedent(text), encoding="utf-8")
        return path


class CppTest(Folder):
    def find(self, text):
        path = self.write("own/small.cpp", text)

        def wanted(file):
            own = pathlib.Path(file).resolve()
            return ("product", own.name) if own.parent == path.parent else None
        return numbered(cpp.find(str(path), ["-std=c++17"], wanted))

    def changes(self, text, operator):
        return [(m.text, m.becomes) for m in self.find(text) if m.operator == operator]

    def test_conditions_are_negated_but_not_those_of_for(self):
        self.assertEqual(self.changes("""\
            int f(int a) {
                if (a == 3) return 1;
                while (a > 4) --a;
                do ++a; while (a < 9);
                for (; a < 20;) a += 2;
                return a ? 5 : 6;
            }
            """, "negate-condition"), [
                ("a == 3", "!(a == 3)"), ("a > 4", "!(a > 4)"), ("a < 9", "!(a < 9)"),
                ("a", "!(a)")])

    def test_operators_change_where_they_stand_and_not_in_comments(self):
        text = """\
            int f(int a, int b) {
                a += b /* + */ * 2;  // a < b
                a <<= 1;
                ++a;
                b--;
                return a <= b && a != b ? a % b : -b;
            }
            """
        self.assertEqual(self.changes(text, "arithmetic"), [
            ("+=", "-="), ("*", "/"), ("<<=", ">>="), ("++", "--"), ("--", "++"), ("%", "*")])
        self.assertEqual(self.changes(text, "relational"), [("<=", "<"), ("!=", "==")])
        self.assertEqual(self.changes(text, "logical"), [("&&", "||")])

    def test_constants_move_by_one_and_truths_change(self):
        self.assertEqual(self.changes("""\
            #define TEN 10
            const int kOutside = 7;
            bool f(long a) {
                double b = 2.5;
                return a == 0 || a == 1L || a == 0x10u || b > TEN || true;
            }
            """, "constant"), [
                ("2.5", "(2.5 + 1)"), ("0", "1"), ("1L", "0L"), ("0x10u", "15u"),
                ("0x10u", "17u"), ("true", "false")])

    def test_what_is_returned_changes_by_its_type(self):
        self.assertEqual(self.changes("""\
            typedef unsigned char jboolean;
            #define JNI_FALSE 0
            #define OK 0
            struct S { int a; };
            bool a(int x) { return x > 1; }
            int b(int x) { return x; }
            int c() { return OK; }
            char* d(char* x) { return x; }
            jboolean e() { return JNI_FALSE; }
            S f(S s) { return s; }
            int g() { return 4; }
            """, "return-value"), [
                ("x > 1", "!(x > 1)"), ("x", "0"), ("OK", "(OK) + 1"), ("x", "nullptr"),
                ("JNI_FALSE", "!(JNI_FALSE)"), ("s", "{}")])

    def test_statements_go_and_lines_stay(self):
        found = [m for m in self.find("""\
            void log(const char*, int);
            #define LOG(text) log(text, __LINE__)
            void f(int a) {
                LOG(
                    "text");
                if (a) log("a", 1); else a = 2;
                int b = a;
                switch (b) { case 1: log("b", 2); break; }
            }
            """) if m.operator == "remove-statement"]
        self.assertEqual([(m.text, m.becomes) for m in found], [
            ('LOG(\n        "text");', ";\n"), ('log("a", 1);', ";"), ("a = 2;", ";"),
            ('log("b", 2);', ";"), ("break", "")])
        self.assertEqual({m.function for m in found}, {"f"})

    def test_jumps_change_in_loops(self):
        self.assertEqual(self.changes("""\
            void f(int a) { while (a) { if (a == 1) break; if (a == 2) continue; } }
            """, "break-continue"), [("break", "continue"), ("continue", "break")])

    def test_locks_are_dropped(self):
        self.assertEqual(self.changes("""\
            struct Mutex { struct Autolock { Autolock(Mutex&); ~Autolock(); }; };
            struct Text { Text(int); };
            class C { void f() { Mutex::Autolock lock(m); Text text(1); } Mutex m; };
            """, "drop-lock"), [("Mutex::Autolock lock(m);", ";")])

    def test_neighbours_change_places_when_their_order_may_be_noticed(self):
        self.assertEqual(self.changes("""\
            int call(); void one(int); extern int shared;
            #define LOG(text) one(sizeof text)
            void f(int a) {
                LOG("enter");  // between
                int x = call();
                one(x);
                int y = 1;
                y = 2;
                shared = a;
                if (y) return;
                one(y);
                one(y);
                return;
            }
            """, "swap-statements"), [
                ('LOG("enter");  // between\n    int x = call();',
                 'int x = call();  // between\n    LOG("enter");'),
                ("shared = a;\n    if (y) return;", "if (y) return;\n    shared = a;"),
                ("if (y) return;\n    one(y);", "one(y);\n    if (y) return;")])

    def test_neighbours_stay_that_do_not_see_each_other(self):
        self.assertEqual(self.changes("""\
            struct Color { int r, g; }; void use(Color*); void call();
            struct Text { Text(); Text(int); };
            void f(Color* given) {
                call();
                Text text;
                call();
                Color own;
                own.r = 1;
                own.g = 2;
                call();
                given->r = own.r;
                use(&own);
                own.r = 3;
                own.g = own.r;
                int unused;
                call();
            }
            """, "swap-statements"), [
                ("call();\n    given->r = own.r;", "given->r = own.r;\n    call();"),
                ("given->r = own.r;\n    use(&own);", "use(&own);\n    given->r = own.r;"),
                ("use(&own);\n    own.r = 3;", "own.r = 3;\n    use(&own);"),
                ("own.r = 3;\n    own.g = own.r;", "own.g = own.r;\n    own.r = 3;")])

    def test_macros_and_headers_of_others_are_left_alone(self):
        self.write("other/other.h", "inline int other() { return 1 + 2; }\n")
        self.write("own/own.h", "#pragma once\nclass C { int own() { return 3 * a; } int a; };\n")
        self.write("other/c.h", "static inline int c() { return 1 + 2; }\n")
        found = self.find("""\
            #include "../other/other.h"
            #include "own.h"
            extern "C" {
            #include "../other/c.h"
            }
            #define TWICE(x) ((x) + (x))
            int f(int a) { return TWICE(a * 4); }
            """)
        self.assertEqual([(m.file, m.function, m.operator) for m in found], [
            ("own.h", "C::own", "constant"), ("own.h", "C::own", "constant"),
            ("own.h", "C::own", "return-value"), ("own.h", "C::own", "arithmetic"),
            ("small.cpp", "f", "return-value")])

    def test_a_source_that_clang_cannot_read_is_reported(self):
        with self.assertRaisesRegex(Failed, "^clang cannot read .*small.cpp: unknown type name"):
            self.find("nonsense f();")


class JavaTest(Folder):
    def find(self, text):
        path = self.write("Small.java", text)
        classes = self.folder / "tool"
        subprocess.run([JAVA_HOME / "bin/javac", "-Xlint:all", "-Werror", "-d", classes,
                        *jvm.TOOL.glob("*.java")], check=True)
        out = output_of([JAVA_HOME / "bin/java", "-cp", classes, "FindMutants", path], self.folder)
        area = jvm.JavaArea.__new__(jvm.JavaArea)
        area.root = self.folder
        sources = {str(path): path.read_bytes()}
        return numbered(area._mutant(line.split("\t"), sources) for line in out.splitlines())

    def test_every_operator(self):
        found = self.find("""\
            package small;
            /** Ünlaut, so that bytes and characters differ. */
            @Deprecated(forRemoval = false)
            class Small {
                private int a = 1;
                synchronized boolean f(int b) {
                    a = b + 2;
                    notifyAll();
                    while (b > 0 && a != 4) {
                        if (b == 3) {
                            break;
                        }
                        b--;
                    }
                    synchronized (this) {
                        System.out.println("a" + b);
                    }
                    return a < b;
                }
                Object g() {
                    Runnable r = () -> { return; };
                    return r;
                }
            }
            """)
        self.assertEqual([(m.line, m.function, m.operator, m.text, m.becomes) for m in found
                          if m.operator not in ("swap-statements", "remove-statement")], [
            (5, "Small", "constant", "1", "0"),
            (6, "Small.f", "drop-lock", "synchronized ", ""),
            (7, "Small.f", "arithmetic", "+", "-"),
            (7, "Small.f", "constant", "2", "(2 + 1)"),
            (7, "Small.f", "constant", "2", "(2 - 1)"),
            (9, "Small.f", "negate-condition", "(b > 0 && a != 4)", "(!(b > 0 && a != 4))"),
            (9, "Small.f", "relational", ">", ">="),
            (9, "Small.f", "constant", "0", "1"),
            (9, "Small.f", "logical", "&&", "||"),
            (9, "Small.f", "relational", "!=", "=="),
            (9, "Small.f", "constant", "4", "(4 + 1)"),
            (9, "Small.f", "constant", "4", "(4 - 1)"),
            (10, "Small.f", "negate-condition", "(b == 3)", "(!(b == 3))"),
            (10, "Small.f", "relational", "==", "!="),
            (10, "Small.f", "constant", "3", "(3 + 1)"),
            (10, "Small.f", "constant", "3", "(3 - 1)"),
            (11, "Small.f", "break-continue", "break;", "continue;"),
            (13, "Small.f", "arithmetic", "--", "++"),
            (15, "Small.f", "drop-lock", "synchronized (this) ", ""),
            (18, "Small.f", "return-value", "a < b", "!(a < b)"),
            (18, "Small.f", "relational", "<", "<="),
            (22, "Small.g", "return-value", "r", "null")])
        self.assertEqual([m.line for m in found if m.operator == "swap-statements"], [7, 8, 9, 10])
        self.assertEqual([m.text for m in found if m.operator == "remove-statement"], [
            "a = b + 2;", "notifyAll();", "b--;", 'System.out.println("a" + b);'])

    def test_constants_stay_that_other_classes_have_compiled_in(self):
        found = self.find("""\
            class Small {
                public static final int GIVEN = 1;
                static final String TEXT = "a".length() > 2 ? "b" : "c";
                static final long COMPUTED = System.nanoTime() + 3;
                private static final int OWN = 4;
                static int variable = 0;
                interface Named {
                    int VALUE = 0;
                    int[] VALUES = {0};
                }
                static final int SUM = GIVEN + 1;
            }
            """)
        self.assertEqual([(m.line, m.operator, m.text, m.becomes) for m in found], [
            (3, "negate-condition", '"a".length() > 2', '!("a".length() > 2)'),
            (3, "relational", ">", ">="),
            (3, "constant", "2", "(2 + 1)"), (3, "constant", "2", "(2 - 1)"),
            (4, "arithmetic", "+", "-"),
            (4, "constant", "3", "(3 + 1)"), (4, "constant", "3", "(3 - 1)"),
            (5, "constant", "4", "(4 + 1)"), (5, "constant", "4", "(4 - 1)"),
            (6, "constant", "0", "1"), (9, "constant", "0", "1")])

    def test_java_runs_by_itself_and_unchecked(self):
        test = ["/t/checked_java.py", "/t/expected.txt", "/jdk/bin/java", "-Xcheck:jni", "-ea",
                "-cp", "/a.jar", "Launcher", "--details=tree", "--select-class=a.FirstTest"]
        self.assertEqual(jvm.command_of(test, "/classes", ["a.FirstTest", "b.OtherTest"]), [
            *jvm.QUICK, "-Xmx1g", "-ea", "-cp", "/classes:/a.jar", "Launcher", "--details=none",
            "--select-class=a.FirstTest", "--select-class=b.OtherTest"])

    def test_a_constructor_assigns_in_any_order_what_nobody_sees_yet(self):
        found = self.find("""\
            class Small {
                private final Object a;
                private final Object b;
                private final Object c;
                Small(Object given) {
                    a = given;
                    b = new Object();
                    c = given;
                    given.equals(this);
                }
            }
            """)
        self.assertEqual([m.text.split() for m in found if m.operator == "swap-statements"],
                         [["c", "=", "given;", "given.equals(this);"]])


class RunTest(Folder):
    """On a program of one source and a few tests."""

    SMALL = """\
        #include <cstdlib>
        int sum(int a, int b) { return a + b; }
        int nobodyAsks(int a) { return a * 3; }
        void wait(bool forever) { while (forever) {} }
        """
    TESTS = """\
        #include <gtest/gtest.h>
        int sum(int, int); int nobodyAsks(int); void wait(bool);
        TEST(Small, Sums) { EXPECT_EQ(sum(2, 3), 5); }
        TEST(Small, Waits) { wait(false); }
        """

    def setUp(self):
        super().setUp()
        self.equivalents = self.write("equivalents.toml", "")

    def build(self, tests=TESTS, equivalents=""):
        small = self.write("frameworks/small.cpp", self.SMALL)
        main = self.write("tests/small_tests.cpp", tests)
        build = self.folder / "build"
        (build / "bin").mkdir(parents=True)
        compiler = os.environ.get("CXX", "c++")
        self.write("build/build.ninja", f"""\
            rule compile
              command = {compiler} -std=c++17 -MD -MF $out.d -o $out -c $in
              depfile = $out.d
              deps = gcc
            rule link
              command = : && {compiler} -o $out $in -lgtest_main -lgtest -lpthread && :
            build small.o: compile {small}
            build small_tests.o: compile {main}
            build bin/small_tests: link small.o small_tests.o
            """)
        command = shlex.join([compiler, "-std=c++17", "-o", "small.o", "-c", str(small)])
        (build / "compile_commands.json").write_text(json.dumps(
            [{"directory": str(build), "command": command, "file": str(small)}]))
        subprocess.run(["ninja"], cwd=build, check=True, stdout=subprocess.DEVNULL)
        self.equivalents = self.write("equivalents.toml", equivalents)
        return build

    def mutate(self, build, *options):
        """(status, lines of its output, what it said besides)"""
        def area(name, given, say):
            return Area(NativeArea(name, "frameworks", "small_tests", given.root, given.build),
                        2, say)
        out, err = io.StringIO(), io.StringIO()
        with contextlib.redirect_stdout(out), contextlib.redirect_stderr(err):
            try:
                status = mutate.main(["--area", "product", "--root", str(self.folder), "--build",
                                      str(build), *options], area, self.equivalents)
            except SystemExit as end:
                status = end.code
        return status, out.getvalue().splitlines(), err.getvalue()

    def test_each_outcome_is_counted_as_what_it_is(self):
        status, lines, said = self.mutate(self.build(equivalents="""\
            [[equivalent]]
            file = "frameworks/small.cpp"
            function = "nobodyAsks"
            operator = "constant"
            text = "3"
            becomes = "2"
            reason = "the caller rounds"
            """))
        table = {tuple(line.split()[:2]): line.split()[2:] for line in lines
                 if line.startswith("product")}
        # Of each: made, noticed, timed out, unnoticed, did not compile, equivalent.
        self.assertEqual(table, {
            ("product", "arithmetic"): ["2", "1", "0", "1", "0", "0", "50.0", "%"],
            ("product", "constant"): ["2", "0", "0", "1", "0", "1", "0.0", "%"],
            ("product", "negate-condition"): ["1", "0", "1", "0", "0", "0", "100.0", "%"],
            ("product", "return-value"): ["2", "1", "0", "1", "0", "0", "50.0", "%"],
            ("product", "all"): ["7", "2", "1", "3", "0", "1", "50.0", "%"]})
        self.assertEqual(status, 1)
        at = lines.index("unnoticed: frameworks/small.cpp:3 nobodyAsks "
                         "(arithmetic; 2 tests ran)")
        self.assertEqual(lines[at + 1:at + 5], [
            "     int sum(int a, int b) { return a + b; }",
            "    -int nobodyAsks(int a) { return a * 3; }",
            "    +int nobodyAsks(int a) { return a / 3; }",
            "     void wait(bool forever) { while (forever) {} }"])
        self.assertIn("product: 7 mutants, 2 at a time", said)
        self.assertEqual((self.folder / "frameworks/small.cpp").read_text(),
                         textwrap.dedent(self.SMALL))

    def test_what_meets_the_goal_ends_with_success(self):
        status, lines, _ = self.mutate(self.build(), "--filter", "sum ")
        self.assertEqual(status, 0)
        self.assertRegex(lines[-2], r"^product +all +2 +2 .* 100.0 %$")

    def test_a_test_that_fails_without_a_mutant_is_reported_first(self):
        status, lines, said = self.mutate(self.build(
            self.TESTS + "TEST(Small, Fails) { EXPECT_EQ(sum(1, 1), 3); }\n"))
        self.assertEqual(status, 1)
        self.assertIn("orv: Small.Fails of small_tests fails without a mutant.", said)
        self.assertNotIn("unnoticed:", "\n".join(lines))

    def test_a_sample_is_the_same_for_the_same_seed(self):
        build = self.build()

        def sample(*options):
            return self.mutate(build, "--list", "--sample", "3", *options)
        first, second = sample("--seed", "5"), sample("--seed", "5")
        self.assertEqual(first, second)
        self.assertEqual(sum(line.startswith("frameworks/") for line in first[1]), 3)
        samples = {tuple(sample("--seed", str(seed))[1]) for seed in range(10)}
        self.assertGreater(len(samples), 1)
        # Without a seed there is one, too, and it is said.
        said = sample()[2]
        self.assertRegex(said, r"orv: product: --sample 3 --seed \d+")
        seed = said.split()[-1]
        self.assertEqual(sample("--seed", seed)[2], said)

    def test_a_run_goes_on_where_another_ended(self):
        build, journal = self.build(), self.folder / "journal"
        options = ("--resume", str(journal), "--filter", "sum |nobodyAsks")
        self.mutate(build, "--resume", str(journal), "--filter", "sum ")
        kept = journal.read_text().splitlines()
        self.assertEqual(sorted(json.loads(line)[1] for line in kept), ["noticed", "noticed"])
        lines = self.mutate(build, *options)[1]
        self.assertRegex(lines[-2], r"^product +all +6 +2 +0 +4 ")
        self.assertEqual(len(journal.read_text().splitlines()), 6)
        # What nothing noticed is tried again, and all of a source that has changed.
        self.mutate(build, *options)
        self.assertEqual(len(journal.read_text().splitlines()), 10)
        journal.write_text("[[1], 2, 3]\nnonsense\n")
        status, _, said = self.mutate(build, *options)
        self.assertEqual(status, 1)
        self.assertIn("journal is not a file of ./orv mutate --resume.", said)
        status, _, said = self.mutate(build, "--resume", str(self.folder))
        self.assertIn(f"{self.folder} cannot be written: Is a directory.", said)

    LOOP = """\
        #include <condition_variable>
        #include <mutex>
        #include <thread>
        std::mutex& mutex = *new std::mutex;  // the loop goes on till the end
        std::condition_variable& changed = *new std::condition_variable;
        int asked = 0, done = 0;
        void work() {}
        void loop() {
            for (;;) {
                std::unique_lock<std::mutex> lock(mutex);
                changed.wait(lock, [] { return asked > done; });
                work();
                done = asked;
                changed.notify_all();
            }
        }
        int ask() {
            static const bool begun = [] { std::thread(loop).detach(); return true; }();
            std::unique_lock<std::mutex> lock(mutex);
            asked += begun;
            changed.notify_all();
            changed.wait(lock, [] { return asked == done; });
            return done;
        }
        """

    def test_a_loop_is_of_each_test_that_has_its_thread_do_something(self):
        self.SMALL = self.LOOP
        build = self.build("""\
            #include <gtest/gtest.h>
            int ask();
            TEST(Loop, Begins) { ask(); }
            TEST(Loop, GoesOn) { const int before = ask(); EXPECT_EQ(ask(), before + 1); }
            """)
        lines = self.mutate(build, "--filter", "loop relational")[1]
        reach = json.loads((build / "mutate/reach-product.json").read_text())["calls"]
        found = {line: sorted(names) for line, names in reach["frameworks/small.cpp"].items()}
        self.assertEqual(found["8"], ["Loop.Begins", "Loop.GoesOn"], found)
        self.assertTrue(lines[-1])

    def test_only_what_has_changed_since_a_revision(self):
        build = self.build()
        git = ["git", "-C", str(self.folder), "-c", "user.name=n", "-c", "user.email=e"]
        for words in (["init", "-q"], ["add", "frameworks"], ["commit", "-qm", "m"]):
            subprocess.run([*git, *words], check=True)
        self.assertEqual(self.mutate(build, "--list", "--since", "HEAD")[:2], (0, []))
        with open(self.folder / "frameworks/small.cpp", "a", encoding="ascii") as file:
            file.write("// changed\n")
        lines = self.mutate(build, "--list", "--since", "HEAD")[1]
        self.assertEqual(sum(line.startswith("frameworks/") for line in lines), 7)
        status, _, said = self.mutate(build, "--list", "--since", "nowhere")
        self.assertEqual((status, said), (1, "orv: git knows no revision 'nowhere'.\n"))

    def test_an_entry_that_fits_nothing_any_more_is_reported(self):
        status, _, said = self.mutate(self.build(equivalents="""\
            [[equivalent]]
            file = "frameworks/small.cpp"
            function = "sum"
            operator = "arithmetic"
            text = "*"
            reason = "it was once"
            """), "--list")
        self.assertEqual(status, 1)
        self.assertIn("nothing in frameworks/small.cpp is '*' for arithmetic in sum any more", said)

    def test_wrong_arguments_are_named(self):
        for options, text in ((["--sample", "0"], "invalid positive value: '0'"),
                              (["--seed", "1"], "--seed needs --sample"),
                              (["--area", "moon"], "invalid choice: 'moon'")):
            status, _, said = self.mutate(self.folder, *options)
            self.assertEqual(status, 2, options)
            self.assertIn(text, said)


class EquivalentsTest(Folder):
    def test_white_space_and_lines_do_not_count_but_the_reason_does(self):
        path = self.write("e.toml", """\
            [[equivalent]]
            file = "a.cpp"
            function = "f"
            operator = "swap-statements"
            text = "one();  two();"
            reason = "neither sees the other"
            """)
        mutant = Mutant("product", "a.cpp", "f", "swap-statements", 9, 0, 0, "one();\n   two();",
                        "two();\n   one();", 1, 20)
        self.assertTrue(Equivalents(path).matches(mutant))
        entry = path.read_text()
        path.write_text(entry.replace('"one();  two();"', '["two(); one();", "one(); two();"]'))
        self.assertTrue(Equivalents(path).matches(mutant))
        self.assertRegex("".join(Equivalents(path).stale([mutant], {"a.cpp"})),
                         "^e.toml: nothing in a.cpp is 'two[^.]*any more.$")
        path.write_text(entry)
        path.write_text(path.read_text().replace("neither sees the other", " "))
        with self.assertRaisesRegex(Failed, "an entry of a.cpp lacks 'reason'"):
            Equivalents(path)


class ProcessesTest(Folder):
    def test_what_a_program_leaves_behind_is_ended(self):
        script = self.folder / "leaves"
        script.write_text("#!/bin/sh\nsleep 1000 & echo $! >pid; sleep 1000\n")
        script.chmod(0o755)
        with self.assertRaises(processes.TimedOut):
            processes.run([str(script)], self.folder, None, 1)
        pid = (self.folder / "pid").read_text().strip()
        state = pathlib.Path(f"/proc/{pid}/stat")
        end = time.monotonic() + 60
        # Nobody may wait for it here, so it may stay a zombie.
        while state.exists() and state.read_text().split()[2] != "Z":
            self.assertLess(time.monotonic(), end, "it still runs")
            time.sleep(0.01)


if __name__ == "__main__":
    unittest.main()
