#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""docs/porting.md explains each error text of the product once, and no other."""

import collections
import os
import pathlib
import re
import unittest

import error_texts

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
FEWEST = 120  # texts that a reader of the sources must find


def product():
    files = [path for path in (SOURCE / "frameworks").rglob("*") if path.suffix in (".cpp", ".h")]
    return error_texts.Sources(
        {str(path.relative_to(SOURCE)): path.read_text("utf-8") for path in files}).read()


def rows(page):
    """(texts, meaning, what to do) of each row of the tables whose first
    column is headed "Text"."""
    table = False
    for line in page.splitlines():
        if not line.startswith("|"):
            table = False
        elif line.startswith("| Text |"):
            table = True
        elif table and not line.startswith("|---"):
            first, meaning, action = re.fullmatch(r"\| (.*) \| (.*) \| (.*) \|", line).groups()
            yield re.findall(r"`([^`]+)`", first), meaning, action


class PageTest(unittest.TestCase):
    def test_each_error_text_of_the_product_has_its_row(self):
        found = product()
        self.assertEqual(found.unresolved, [])
        self.assertGreater(len(found.logged), FEWEST)
        page = (SOURCE / "docs/porting.md").read_text("utf-8")
        texts = collections.Counter(text for row in rows(page) for text in row[0])
        expected = found.logged | found.thrown
        self.assertEqual(sorted(expected - texts.keys()), [], "without a row")
        self.assertEqual(sorted(texts.keys() - expected), [], "not of the product")
        self.assertEqual([text for text, count in texts.items() if count > 1], [], "twice")

    def test_each_row_says_what_to_do(self):
        for texts, meaning, action in rows((SOURCE / "docs/porting.md").read_text("utf-8")):
            self.assertTrue(texts and meaning.strip() and action.strip(), texts)


def read(source):
    return error_texts.Sources({"one.cpp": source}).read()


class ExtractionTest(unittest.TestCase):
    def test_literals_side_by_side_are_one_text(self):
        found = read('void f() {\n    ALOGE(\n        "one %s, "\n        "two\\n", "no");\n}\n')
        self.assertEqual((found.logged, found.unresolved), ({"one %s, two"}, []))

    def test_other_priorities_and_comments_are_left_out(self):
        found = read('void f() {\n    ALOGI("i");\n    ALOGD("d");  // ALOGE("comment")\n'
                     '    ALOGW("ALOGE(w), \\"q\\"");\n'
                     '    __android_log_print(ANDROID_LOG_INFO, TAG, "j");\n'
                     '    __android_log_print(ANDROID_LOG_ERROR, TAG, "k %d", 1);\n}\n')
        self.assertEqual((found.logged, found.unresolved), ({'ALOGE(w), "q"', "k %d"}, []))

    def test_parameters_are_followed_to_the_callers(self):
        found = read('void inner(int n, const char* text) { ALOGE(text, n); }\n'
                     'void outer(const char* text) { ALOGE("%s", text); inner(1, text); }\n'
                     'void f() { outer("a"); inner(2, "b %d"); }\n')
        self.assertEqual((found.logged, found.unresolved), ({"a", "b %d"}, []))

    def test_columns_of_tables_are_followed_to_their_values(self):
        found = read('struct Row { int ClientFields::* member; const char* failure; };\n'
                     'const Row kOne = {&F::one, "one, failed"};\n'
                     'const Row kTwo = {&F::two, "two failed"};\n'
                     'void f(const Row& row) { ALOGE(row.failure, 1); }\n')
        self.assertEqual((found.logged, found.unresolved), ({"one, failed", "two failed"}, []))

    def test_exceptions_are_messages_or_else_classes(self):
        found = read(
            'void raise(JNIEnv* e, const char* type, const char* message) {\n'
            '    char text[9];\n    snprintf(text, sizeof(text), "%s: 0x%X", message, 1);\n'
            '    if (message == nullptr) jniThrowException(e, "a/B", nullptr);\n'
            '    jniThrowException(e, type, message);\n    jniThrowException(e, type, text);\n}\n'
            'void f(JNIEnv* e) { raise(e, "a/C", "c failed."); raise(e, "a/D", nullptr); }\n')
        self.assertEqual((found.thrown, found.unresolved),
                         ({"a.B", "c failed.", "a.D", "%s: 0x%X"}, []))

    def test_what_leads_nowhere_is_reported(self):
        for source in ('void f() { ALOGE(gText); }', 'void f() { ALOGE(row.failure); }',
                       'ALOGE("outside");', 'void f(JNIEnv* e) { e->ThrowNew(c, "text"); }',
                       'void f() { jniThrowException(e, "a/B", gText); }',
                       'void f() { LOG_ALWAYS_FATAL("text"); }'):
            found = read(source)
            self.assertEqual(len(found.unresolved), 1, source)


if __name__ == "__main__":
    unittest.main()
