// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <string>

#include "Clock.h"
#include "Formats.h"

namespace orvtrace {
namespace {

constexpr int64_t kSecond = 1000000000;
constexpr int64_t kDay = 86400 * kSecond;

LogTime timeOf(const std::string& written) {
    const std::string line = written + " 1 1 I Tag: text";
    FormatReader formats;
    LogLine out;
    EXPECT_EQ(formats.read(line, out), FormatReader::Result::kEntry) << written;
    out.time.text = {};
    return out.time;
}

// Nanoseconds from the first time to the last of those given.
template <typename... Times>
int64_t passed(const std::string& first, const Times&... others) {
    Clock clock;
    const int64_t begin = clock.at(timeOf(first));
    int64_t end = begin;
    for (const std::string& other : {std::string(others)...}) end = clock.at(timeOf(other));
    return end - begin;
}

TEST(ClockTest, DigitsBehindThePointAreAFraction) {
    EXPECT_EQ(passed("11-22 10:00:00.0", "11-22 10:00:00.25"), kSecond / 4);
    EXPECT_EQ(passed("11-22 10:00:00", "11-22 10:00:00.000000001"), 1);
}

TEST(ClockTest, MonthsHaveTheirDays) {
    EXPECT_EQ(passed("01-31 00:00:00", "02-01 00:00:00"), kDay);
    EXPECT_EQ(passed("04-30 23:59:59", "05-01 00:00:00"), kSecond);
    EXPECT_EQ(passed("03-01 00:00:00", "08-01 00:00:00"), 153 * kDay);
}

TEST(ClockTest, ALeapDayIsOneWhereTheLogHasIt) {
    EXPECT_EQ(passed("02-28 12:00:00", "03-01 12:00:00"), kDay);
    EXPECT_EQ(passed("02-28 12:00:00", "02-29 12:00:00", "03-01 12:00:00"), 2 * kDay);
    EXPECT_EQ(passed("2028-02-28 12:00:00", "2028-03-01 12:00:00"), 2 * kDay);
    EXPECT_EQ(passed("2027-02-28 12:00:00", "2027-03-01 12:00:00"), kDay);
}

TEST(ClockTest, TheYearAfterTheLastDayIsTheNext) {
    EXPECT_EQ(passed("12-31 23:59:59.9", "01-01 00:00:00.1"), kSecond / 5);
    EXPECT_EQ(passed("2026-12-31 23:59:59.9", "2027-01-01 00:00:00.1"), kSecond / 5);
    EXPECT_EQ(passed("12-31 00:00:00", "01-01 00:00:00", "06-01 00:00:00", "10-01 00:00:00",
                     "12-31 00:00:00", "01-01 00:00:00"),
              366 * kDay);
    EXPECT_EQ(passed("02-29 00:00:00", "08-01 00:00:00", "01-01 00:00:00"), (366 - 59) * kDay);
}

TEST(ClockTest, AThreadMayBeLateOverNewYearAndMidnight) {
    EXPECT_EQ(passed("01-01 00:00:00.1", "12-31 23:59:59.9"), -kSecond / 5);
    EXPECT_EQ(passed("12-31 23:59:59.8", "01-01 00:00:00.1", "12-31 23:59:59.9"), kSecond / 10);
    EXPECT_EQ(passed("11-23 00:00:00.1", "11-22 23:59:59.9"), -kSecond / 5);
}

TEST(ClockTest, CountsThatItWasSetBackAndNotThatLinesAreOutOfOrder) {
    Clock clock;
    for (const char* time : {"11-22 10:00:05.5", "11-22 10:00:05.1", "11-22 10:00:06.0"}) {
        clock.at(timeOf(time));
    }
    EXPECT_EQ(clock.setBack(), 0u);
    clock.at(timeOf("11-22 09:00:00.0"));
    clock.at(timeOf("11-22 09:00:01.0"));
    EXPECT_EQ(clock.setBack(), 1u);
}

TEST(ClockTest, HasAllTimesThatALogMayHave) {
    const int64_t years = 2200 - 1970;
    const int64_t leapDays = 56;  // 1972 to 2196, without 2100
    EXPECT_EQ(passed("1970-01-01 00:00:00", "2200-01-01 00:00:00"),
              (years * 365 + leapDays) * kDay);
    EXPECT_EQ(passed("1970-01-01 00:00:00.5", "8000000000.5"), 8000000000 * kSecond);
}

TEST(ClockTest, EndsTheYearsOfALogThatDoesNot) {
    Clock clock;
    int64_t last = 0;
    for (int year = 0; year < 400; ++year) {
        for (const char* day : {"01-01 00:00:00", "06-01 00:00:00", "12-01 00:00:00"}) {
            last = clock.at(timeOf(day));
        }
    }
    EXPECT_LT(last, kMostSeconds * kSecond);
    EXPECT_GT(clock.setBack(), 0U);
}

TEST(ClockTest, SecondsSinceAStartNeedNoDate) {
    EXPECT_EQ(passed("1700000000.5", "1700000001.25"), kSecond * 3 / 4);
}

TEST(ClockTest, KnowsTheFewestDigits) {
    Clock clock;
    clock.at(timeOf("11-22 10:00:05.123456"));
    EXPECT_EQ(clock.digits(), 6);
    clock.at(timeOf("11-22 10:00:05.123"));
    EXPECT_EQ(clock.digits(), 3);
}

}  // namespace
}  // namespace orvtrace
