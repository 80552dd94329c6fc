// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gmock/gmock.h>

#include <condition_variable>
#include <functional>
#include <iosfwd>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace orvtest {

// One line of the platform log as it left the code under test.
struct LogLine {
    int priority;
    std::string tag;
    std::string text;
    std::thread::id thread;
};
void PrintTo(const LogLine& line, std::ostream* out);

// What a test expects of one line. In the text, %d stands for any integer and
// %p for any pointer; everything else must be there to the blank. An empty tag
// matches every tag.
struct ExpectedLine {
    int priority;
    std::string text;
    std::string tag;

    bool matches(const LogLine& line) const;
    // The same line, expected under that tag.
    ExpectedLine tagged(const std::string& newTag) const { return {priority, text, newTag}; }
};
void PrintTo(const ExpectedLine& line, std::ostream* out);

ExpectedLine debug(const std::string& text);
ExpectedLine info(const std::string& text);
ExpectedLine warning(const std::string& text);
ExpectedLine error(const std::string& text);

// Takes the process's log while it lives. There is one at a time; lines that
// come while there is none go to stderr, as usual. Safe from any thread.
class LogCapture {
public:
    LogCapture();
    ~LogCapture();
    LogCapture(const LogCapture&) = delete;
    LogCapture& operator=(const LogCapture&) = delete;

    std::vector<LogLine> lines() const;
    std::vector<LogLine> lines(const std::string& tag) const;
    // Returns what was there and starts afresh.
    std::vector<LogLine> take();
    void clear() { take(); }

    // Waits until that many matching lines are there; false after ten seconds.
    bool waitFor(const ExpectedLine& line, size_t count = 1) const;

    // Runs the action once, inside the next call that logs such a line, on the
    // thread of that call. The action may log.
    void whenLogged(const ExpectedLine& line, std::function<void()> action);

    // Takes a line; what the thread that logged it then has to run.
    std::function<void()> add(LogLine line);

private:
    mutable std::mutex mMutex;
    mutable std::condition_variable mArrived;
    std::vector<LogLine> mLines;
    ExpectedLine mActionLine;
    std::function<void()> mAction;
};

// Matches a list of lines that is exactly the expected one, in order. A
// failure shows both lists as one diff.
testing::Matcher<const std::vector<LogLine>&> LinesAre(std::vector<ExpectedLine> expected);

MATCHER_P(LineIs, expected, "is " + testing::PrintToString(expected)) {
    (void)result_listener;
    return expected.matches(arg);
}

}  // namespace orvtest
