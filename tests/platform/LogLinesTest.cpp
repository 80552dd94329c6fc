// SPDX-License-Identifier: Apache-2.0
// The log on standard error has the format in which logcat prints it.

#include <android/log.h>
#include <errno.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/syscall.h>
#include <time.h>
#include <unistd.h>

#include <functional>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

using testing::MatchesRegex;
using testing::SizeIs;

namespace {

// The lines that an action logs.
std::vector<std::string> logged(const std::function<void()>& action) {
    __android_log_set_minimum_priority(ANDROID_LOG_VERBOSE);
    testing::internal::CaptureStderr();
    action();
    std::istringstream text(testing::internal::GetCapturedStderr());
    __android_log_set_minimum_priority(ANDROID_LOG_WARN);
    std::vector<std::string> lines;
    for (std::string line; std::getline(text, line);) lines.push_back(line);
    return lines;
}

std::string ids() {
    char text[32];
    snprintf(text, sizeof(text), "%5d %5ld", getpid(), syscall(SYS_gettid));
    return text;
}

constexpr char kTime[] =
    "[0-9][0-9]-[0-9][0-9] [0-9][0-9]:[0-9][0-9]:[0-9][0-9]\\.[0-9][0-9][0-9][0-9][0-9][0-9][0-9]"
    "[0-9][0-9] ";

TEST(LogLinesTest, HaveTimeProcessThreadPriorityTagAndText) {
    const auto lines =
        logged([] { __android_log_write(ANDROID_LOG_INFO, "OrvMediaService", "a text: 1"); });
    ASSERT_THAT(lines, SizeIs(1));
    EXPECT_THAT(lines[0], MatchesRegex(kTime + ids() + " I OrvMediaService: a text: 1"));
}

TEST(LogLinesTest, ShortTagsArePadded) {
    const auto lines = logged([] { __android_log_write(ANDROID_LOG_ERROR, "Tag", "x"); });
    ASSERT_THAT(lines, SizeIs(1));
    EXPECT_THAT(lines[0], MatchesRegex(std::string(kTime) + ".* E Tag     : x"));
}

TEST(LogLinesTest, EachPriorityHasItsLetter) {
    const auto lines = logged([] {
        for (int priority = ANDROID_LOG_VERBOSE; priority < ANDROID_LOG_FATAL; ++priority) {
            __android_log_write(priority, "Priorities", "x");
        }
    });
    std::string letters;
    for (const std::string& line : lines) letters += line.at(line.find(" Priorities") - 1);
    EXPECT_EQ(letters, "VDIWE");
}

TEST(LogLinesTest, LineEndsAtTheEndOfATextAreLeftOutAndOthersBeginALine) {
    const auto lines = logged(
        [] { __android_log_write(ANDROID_LOG_INFO, "OrvMediaService", "first\n\nthird\n\n"); });
    ASSERT_THAT(lines, SizeIs(3));
    EXPECT_THAT(lines[0], MatchesRegex(".* OrvMediaService: first"));
    EXPECT_THAT(lines[1], MatchesRegex(".* OrvMediaService: "));
    EXPECT_THAT(lines[2], MatchesRegex(".* OrvMediaService: third"));
    EXPECT_EQ(lines[0].substr(0, 32), lines[2].substr(0, 32));
}

TEST(LogLinesTest, ALongTextIsWhole) {
    const std::string text(100000, 'x');
    const auto lines =
        logged([&] { __android_log_write(ANDROID_LOG_INFO, "OrvMediaService", text.c_str()); });
    ASSERT_THAT(lines, SizeIs(1));
    EXPECT_EQ(lines[0].substr(lines[0].find('x')), text);
}

TEST(LogLinesTest, AnEmptyTextIsALine) {
    const auto lines = logged([] { __android_log_write(ANDROID_LOG_INFO, "Tag", ""); });
    ASSERT_THAT(lines, SizeIs(1));
    EXPECT_THAT(lines[0], MatchesRegex(std::string(kTime) + ".* I Tag     : "));
}

TEST(LogLinesTest, TimesAreThoseOfTheClockAndDoNotGoBack) {
    const time_t before = time(nullptr);
    const auto lines = logged([] {
        for (int i = 0; i < 100; ++i) __android_log_write(ANDROID_LOG_INFO, "Times", "x");
    });
    const time_t after = time(nullptr);
    ASSERT_THAT(lines, SizeIs(100));
    std::vector<std::string> seconds;
    for (time_t second = before; second <= after; ++second) {
        tm local{};
        localtime_r(&second, &local);
        char text[24];
        strftime(text, sizeof(text), "%m-%d %H:%M:%S", &local);
        seconds.emplace_back(text);
    }
    EXPECT_THAT(seconds, testing::Contains(lines[0].substr(0, 14)));
    for (size_t i = 1; i < lines.size(); ++i) {
        // Of one second the nanoseconds.
        if (lines[i].substr(0, 14) != lines[i - 1].substr(0, 14)) continue;
        EXPECT_LE(lines[i - 1].substr(15, 9), lines[i].substr(15, 9));
    }
}

TEST(LogLinesTest, LinesOfSeveralThreadsAreNotMixed) {
    constexpr int kThreads = 4;
    constexpr int kLines = 200;
    const auto lines = logged([] {
        std::vector<std::thread> threads;
        for (int t = 0; t < kThreads; ++t) {
            threads.emplace_back([t] {
                const std::string text(500, static_cast<char>('a' + t));
                for (int i = 0; i < kLines; ++i) {
                    __android_log_write(ANDROID_LOG_INFO, "Threads", text.c_str());
                }
            });
        }
        for (std::thread& thread : threads) thread.join();
    });
    ASSERT_THAT(lines, SizeIs(kThreads * kLines));
    for (const std::string& line : lines) {
        const std::string text = line.substr(line.find(": ") + 2);
        EXPECT_EQ(text, std::string(500, text[0]));
    }
}

TEST(LogLinesTest, LogsWithoutChangingErrno) {
    logged([] {
        errno = EXDEV;
        __android_log_write(ANDROID_LOG_INFO, "OrvMediaService", "x");
        EXPECT_EQ(errno, EXDEV);
    });
}

}  // namespace
