// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "Text.h"

namespace orvtrace {
namespace {

TEST(TextTest, WhatIsNoUtf8IsReplaced) {
    EXPECT_EQ(asUtf8("a\xc3\xa4z"), "a\xc3\xa4z");
    EXPECT_EQ(asUtf8("a\xffz"), "a\xef\xbf\xbdz");
    EXPECT_EQ(asUtf8("\xc3"), "\xef\xbf\xbd");
}

TEST(TextTest, TimesHaveThreeDigitsAndAUnit) {
    EXPECT_EQ(readableTime(0), "0.00 µs");
    EXPECT_EQ(readableTime(1), "0.00 µs");
    EXPECT_EQ(readableTime(4020), "4.02 µs");
    EXPECT_EQ(readableTime(9996), "10.0 µs");
    EXPECT_EQ(readableTime(999499), "999 µs");
    EXPECT_EQ(readableTime(999600), "1.00 ms");
    EXPECT_EQ(readableTime(61'700'000), "61.7 ms");
    EXPECT_EQ(readableTime(2'500'000'000), "2.50 s");
    EXPECT_EQ(readableTime(3'600'000'000'000), "3600 s");
}

TEST(TextTest, CountsAreInGroupsOfThree) {
    EXPECT_EQ(readableCount(0), "0");
    EXPECT_EQ(readableCount(999), "999");
    EXPECT_EQ(readableCount(1000), "1 000");
    EXPECT_EQ(readableCount(12345678), "12 345 678");
}

}  // namespace
}  // namespace orvtrace
