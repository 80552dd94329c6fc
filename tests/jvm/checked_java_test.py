#!/usr/bin/env python3
# SPDX-License-Identifier: Apache-2.0
"""checked_java.py fails for planted mistakes, and for those alone."""
import os
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

CHECKER = Path(__file__).with_name("checked_java.py")
FOLDER = os.environ["ORV_PLANTED"]
JAVA = os.environ["ORV_JAVA_COMMAND"].split("|")
VERSION = subprocess.run(
    [*JAVA, "-version"], stderr=subprocess.PIPE, check=True, encoding="utf-8"
).stderr
# Later virtual machines say nothing of references.
COUNTS_REFERENCES = ' version "17' in VERSION


def check(*names, expected=""):
    with tempfile.NamedTemporaryFile("w", suffix=".txt") as rules:
        rules.write(expected)
        rules.flush()
        return run(rules.name, *names)


def run(rules, *names):
    command = [CHECKER, rules, *JAVA, "-Xcheck:jni", f"-Djava.library.path={FOLDER}"]
    command += ["-XX:+UseSerialGC", "--enable-native-access=ALL-UNNAMED"]
    command += ["-cp", f"{FOLDER}/orv_planted_mistakes_java.jar", "PlantedMistakes", *names]
    done = subprocess.run(command, stdout=subprocess.PIPE, check=False, encoding="utf-8")
    return done.returncode, done.stdout.splitlines()


class CheckedJavaTest(unittest.TestCase):
    def test_correct_native_code_passes(self):
        status, _ = check("deleteReferences", "callChecked")
        self.assertEqual(0, status)

    @unittest.skipUnless(COUNTS_REFERENCES, "only Java 17 counts references")
    def test_references_that_are_kept_fail(self):
        status, lines = check("keepReferences")
        self.assertEqual(1, status)
        self.assertIn(
            "not expected of -Xcheck:jni: 1 times in PlantedMistakes.keepReferences:"
            " JNI local refs: 33, exceeds capacity: 32",
            lines,
        )

    def test_a_call_without_a_check_fails(self):
        status, lines = check("callUnchecked")
        self.assertEqual(1, status)
        self.assertIn(
            "not expected of -Xcheck:jni: 1 times in PlantedMistakes.callUnchecked:"
            " JNI call made without checking exceptions when required to"
            " from CallStaticVoidMethodV",
            lines,
        )

    def test_what_is_listed_passes_at_its_place_alone(self):
        listed = "*Call*VoidMethodV | {} | on purpose\n"
        here, elsewhere = listed.format("Planted*.callUnchecked"), listed.format("Other.method")
        self.assertEqual(0, check("callUnchecked", expected=here)[0])
        self.assertEqual(1, check("callUnchecked", expected=elsewhere)[0])

    @unittest.skipUnless(COUNTS_REFERENCES, "only Java 17 counts references")
    def test_what_is_listed_covers_nothing_else(self):
        listed = "*Call*VoidMethodV | Planted*.callUnchecked | on purpose\n"
        self.assertEqual(1, check("callUnchecked", "keepReferences", expected=listed)[0])

    def test_the_projects_own_list_does_not_cover_them(self):
        own = CHECKER.with_name("xcheck-expected.txt")
        self.assertEqual(1, run(own, "callUnchecked")[0])
        if COUNTS_REFERENCES:
            self.assertEqual(1, run(own, "keepReferences")[0])

    def test_the_stack_of_another_thread_is_no_place(self):
        written = (
            "WARNING in native method: a mistake\n"
            "\tat java.util.List.of(java.base@17/List.java:1)\n"
            "\tat Torn.apart(java.desktop@17/Native Method)\n"
        )
        with tempfile.NamedTemporaryFile("w", suffix=".txt") as rules:
            command = [CHECKER, rules.name, "printf", "%s", written]
            done = subprocess.run(command, stdout=subprocess.PIPE, check=False, encoding="utf-8")
        self.assertEqual(1, done.returncode)
        self.assertIn(
            "not expected of -Xcheck:jni: 1 times in Torn.apart: a mistake",
            done.stdout.splitlines(),
        )

    def test_the_status_of_java_is_kept(self):
        status, _ = check("noSuchMethod")
        self.assertEqual(1, status)

    def test_a_list_that_lacks_a_reason_is_refused(self):
        self.assertEqual(1, check("callChecked", expected="* | *\n")[0])


if __name__ == "__main__":
    sys.exit(unittest.main())
