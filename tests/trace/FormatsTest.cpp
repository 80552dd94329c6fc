// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <string>

#include "Formats.h"

namespace orvtrace {
namespace {

using Result = FormatReader::Result;

struct Row {
    const char* line;
    Format format;
    int pid;
    int tid;
    char priority;
    const char* tag;
    const char* text;
    const char* time;
};

class FormatsTest : public testing::TestWithParam<Row> {};

TEST_P(FormatsTest, LinesAreTakenApart) {
    FormatReader formats;
    LogLine line;
    ASSERT_EQ(formats.read(GetParam().line, line), Result::kEntry);
    EXPECT_EQ(formats.format(), GetParam().format);
    EXPECT_EQ(line.pid, GetParam().pid);
    EXPECT_EQ(line.tid, GetParam().tid);
    EXPECT_EQ(line.priority, GetParam().priority);
    EXPECT_EQ(line.tag, GetParam().tag);
    EXPECT_EQ(line.text, GetParam().text);
    EXPECT_EQ(line.time.text, GetParam().time);
    EXPECT_EQ(line.time.known, *GetParam().time != '\0');
}

const Row kRows[] = {
    {"11-22 10:00:01.123  1  2 I A: x", Format::kThreadtime, 1, 2, 'I', "A", "x",
     "11-22 10:00:01.123"},
    {"11-22 10:00:01.123   100   200 W ORV::SyncToAsync: a: b: c ", Format::kThreadtime, 100, 200,
     'W', "ORV::SyncToAsync", "a: b: c", "11-22 10:00:01.123"},
    {"11-22 10:00:01.123 1 2 E A       :  x", Format::kThreadtime, 1, 2, 'E', "A", " x",
     "11-22 10:00:01.123"},
    {"11-22 10:00:01.123 1 2 I A:", Format::kThreadtime, 1, 2, 'I', "A", "", "11-22 10:00:01.123"},
    {"2026-11-22 10:00:01.123456 -0330 1 2 I A: x", Format::kThreadtime, 1, 2, 'I', "A", "x",
     "2026-11-22 10:00:01.123456"},
    {"11-22 10:00:01.123 system 1 2 I A: x", Format::kThreadtime, 1, 2, 'I', "A", "x",
     "11-22 10:00:01.123"},
    {"11-22 10:00:01.123 I/A( 12): x", Format::kTime, 12, 12, 'I', "A", "x", "11-22 10:00:01.123"},
    {"E/A(b)(12): x", Format::kBrief, 12, 12, 'E', "A(b)", "x", ""},
    {"A I 11-22 10:00:01 1 2 x y", Format::kStderr, 1, 2, 'I', "A", "x y", "11-22 10:00:01"},
};

INSTANTIATE_TEST_SUITE_P(All, FormatsTest, testing::ValuesIn(kRows));

TEST(ForeignLinesTest, AreNoEntries) {
    for (const char* text :
         {"x", "hello world", "11-22 10:00:01.123", "11-22 10:00:01.123 1 2 I",
          "11-22 10:00:01.123 1 2 I A", "11-22 25:00:01.123 1 2 I A: x",
          "13-22 10:00:01.123 1 2 I A: x", "11-32 10:00:01.123 1 2 I A: x", "I/A(x): y",
          "12 34 I A: x", "[ 11-22 10:00:01.123 1:2 I/A", "1969-11-22 10:00:01.123 1 2 I A: x",
          "2201-11-22 10:00:01.123 1 2 I A: x", "8000000001.123 1 2 I A: x"}) {
        FormatReader formats;
        LogLine line;
        EXPECT_EQ(formats.read(text, line), Result::kForeign) << text;
    }
}

TEST(LongFormatTest, ItsTextsHaveTheirHeadersDataEachLine) {
    FormatReader formats;
    LogLine line;
    std::string header = "[ 11-22 10:00:01.123  1: 2 I/OrvMediaService ]";
    EXPECT_EQ(formats.read(header, line), Result::kSeparator);
    header.assign(header.size(), '#');
    for (const char* text : {"one", "two"}) {
        EXPECT_EQ(formats.read(text, line), Result::kEntry);
        EXPECT_EQ(line.text, text);
        EXPECT_EQ(line.tag, "OrvMediaService");
        EXPECT_EQ(line.time.text, "11-22 10:00:01.123");
        EXPECT_EQ(line.tid, 2);
    }
    EXPECT_EQ(formats.read("", line), Result::kSeparator);
    EXPECT_EQ(formats.read("three", line), Result::kForeign);
}

TEST(LongFormatTest, AHeaderEndsAnEntryWithoutItsEmptyLine) {
    FormatReader formats;
    LogLine line;
    formats.read("[ 11-22 10:00:01.123  1: 2 I/A ]", line);
    EXPECT_EQ(formats.read("[ 11-22 10:00:01.123  1: 2 I/B ]", line), Result::kSeparator);
    formats.read("x", line);
    EXPECT_EQ(line.tag, "B");
    formats.restart();
    EXPECT_EQ(formats.read("x", line), Result::kForeign);
}

}  // namespace
}  // namespace orvtrace
