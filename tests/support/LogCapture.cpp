// SPDX-License-Identifier: Apache-2.0
#include "LogCapture.h"

#include <android/log.h>
#include <ctype.h>

#include <algorithm>
#include <chrono>
#include <ostream>

#include "LogSink.h"
#include "Trace.h"

namespace orvtest {
namespace {

std::mutex sCurrentMutex;
LogCapture* sCurrent = nullptr;

bool takeLine(const SinkLine& line) {
    std::function<void()> action;
    {
        std::lock_guard<std::mutex> lock(sCurrentMutex);
        if (sCurrent == nullptr) return false;
        action = sCurrent->add({line.priority, line.tag == nullptr ? "" : line.tag, line.text,
                                std::this_thread::get_id()});
    }
    if (action) action();  // it may log
    return true;
}

// Both return the character behind what they matched, or null.
const char* skipNumber(const char* text) {
    if (*text == '-') text++;
    if (!isdigit(static_cast<unsigned char>(*text))) return nullptr;
    while (isdigit(static_cast<unsigned char>(*text))) text++;
    return text;
}

const char* skipPointer(const char* text) {
    if (std::string_view(text).substr(0, 5) == "(nil)") return text + 5;
    if (text[0] != '0' || text[1] != 'x') return nullptr;
    text += 2;
    while (isxdigit(static_cast<unsigned char>(*text))) text++;
    return text;
}

bool textMatches(const char* pattern, const char* text) {
    while (*pattern != '\0') {
        const std::string_view token = std::string_view(pattern).substr(0, 2);
        if (token == "%d" || token == "%p") {
            text = token == "%d" ? skipNumber(text) : skipPointer(text);
            if (text == nullptr) return false;
            pattern += 2;
        } else if (*pattern++ != *text++) {
            return false;
        }
    }
    return *text == '\0';
}

char letterOf(int priority) {
    static const char letters[] = "??VDIWEF";
    return priority >= 2 && priority <= 7 ? letters[priority] : '?';
}

void print(std::ostream& out, int priority, const std::string& tag, const std::string& text) {
    out << letterOf(priority) << ' ';
    if (!tag.empty()) out << tag << ' ';
    out << testing::PrintToString(text);
}

// The longest common subsequence, written out as a diff.
class LineDiff {
public:
    LineDiff(const std::vector<ExpectedLine>& expected, const std::vector<LogLine>& actual)
        : mExpected(expected),
          mActual(actual),
          mLength(expected.size() + 1, std::vector<size_t>(actual.size() + 1, 0)) {
        for (size_t i = expected.size(); i-- > 0;) {
            for (size_t j = actual.size(); j-- > 0;) {
                mLength[i][j] = expected[i].matches(actual[j])
                                    ? mLength[i + 1][j + 1] + 1
                                    : std::max(mLength[i + 1][j], mLength[i][j + 1]);
            }
        }
    }

    void write(std::ostream& out) const {
        out << "\n  (- expected, + logged)";
        size_t i = 0;
        size_t j = 0;
        while (i < mExpected.size() || j < mActual.size()) {
            const bool both = i < mExpected.size() && j < mActual.size();
            if (both && mExpected[i].matches(mActual[j])) {
                out << "\n    " << testing::PrintToString(mActual[j++]);
                i++;
            } else if (j == mActual.size() || (both && mLength[i + 1][j] >= mLength[i][j + 1])) {
                out << "\n  - " << testing::PrintToString(mExpected[i++]);
            } else {
                out << "\n  + " << testing::PrintToString(mActual[j++]);
            }
        }
    }

private:
    const std::vector<ExpectedLine>& mExpected;
    const std::vector<LogLine>& mActual;
    std::vector<std::vector<size_t>> mLength;
};

class LinesAreMatcher : public testing::MatcherInterface<const std::vector<LogLine>&> {
public:
    explicit LinesAreMatcher(std::vector<ExpectedLine> expected) : mExpected(std::move(expected)) {}

    bool MatchAndExplain(const std::vector<LogLine>& lines,
                         testing::MatchResultListener* listener) const override {
        const auto matches = [](const ExpectedLine& e, const LogLine& l) { return e.matches(l); };
        const bool same =
            std::equal(mExpected.begin(), mExpected.end(), lines.begin(), lines.end(), matches);
        if (!same && listener->stream() != nullptr) {
            LineDiff(mExpected, lines).write(*listener->stream());
        }
        return same;
    }

    void DescribeTo(std::ostream* out) const override {
        *out << "is exactly " << mExpected.size() << " line(s), in order";
        for (const ExpectedLine& line : mExpected) {
            *out << "\n    " << testing::PrintToString(line);
        }
    }

private:
    const std::vector<ExpectedLine> mExpected;
};

}  // namespace

void PrintTo(const LogLine& line, std::ostream* out) {
    print(*out, line.priority, line.tag, line.text);
}

void PrintTo(const ExpectedLine& line, std::ostream* out) {
    print(*out, line.priority, line.tag, line.text);
}

bool ExpectedLine::matches(const LogLine& line) const {
    return priority == line.priority && (tag.empty() || tag == line.tag) &&
           textMatches(text.c_str(), line.text.c_str());
}

ExpectedLine debug(const std::string& text) { return {ANDROID_LOG_DEBUG, text, ""}; }
ExpectedLine info(const std::string& text) { return {ANDROID_LOG_INFO, text, ""}; }
ExpectedLine warning(const std::string& text) { return {ANDROID_LOG_WARN, text, ""}; }
ExpectedLine error(const std::string& text) { return {ANDROID_LOG_ERROR, text, ""}; }

LogCapture::LogCapture() {
    // Not under the lock: the log holds one of its own when it calls the sink.
    installLogSink<takeLine>();
    __android_log_set_minimum_priority(ANDROID_LOG_VERBOSE);
    std::lock_guard<std::mutex> lock(sCurrentMutex);
    if (sCurrent != nullptr) ADD_FAILURE() << "a log capture lives already";
    sCurrent = this;
}

LogCapture::~LogCapture() {
    std::lock_guard<std::mutex> lock(sCurrentMutex);
    sCurrent = nullptr;
}

std::vector<LogLine> LogCapture::lines() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mLines;
}

std::vector<LogLine> LogCapture::lines(const std::string& tag) const {
    std::vector<LogLine> selected = lines();
    const auto other = [&](const LogLine& line) { return line.tag != tag; };
    selected.erase(std::remove_if(selected.begin(), selected.end(), other), selected.end());
    return selected;
}

std::vector<LogLine> LogCapture::take() {
    std::lock_guard<std::mutex> lock(mMutex);
    return std::exchange(mLines, {});
}

bool LogCapture::waitFor(const ExpectedLine& line, size_t count) const {
    std::unique_lock<std::mutex> lock(mMutex);
    const auto matches = [&](const LogLine& l) { return line.matches(l); };
    return mArrived.wait_for(lock, std::chrono::seconds(10), [&] {
        const auto found = std::count_if(mLines.begin(), mLines.end(), matches);
        return static_cast<size_t>(found) >= count;
    });
}

void LogCapture::whenLogged(const ExpectedLine& line, std::function<void()> action) {
    std::lock_guard<std::mutex> lock(mMutex);
    mActionLine = line;
    mAction = std::move(action);
}

std::function<void()> LogCapture::add(LogLine line) {
    std::lock_guard<std::mutex> lock(mMutex);
    Trace::add("log", std::string(1, letterOf(line.priority)) + " " + line.tag + " " + line.text);
    mLines.push_back(std::move(line));
    mArrived.notify_all();
    if (mAction && mActionLine.matches(mLines.back())) return std::exchange(mAction, nullptr);
    return nullptr;
}

testing::Matcher<const std::vector<LogLine>&> LinesAre(std::vector<ExpectedLine> expected) {
    return testing::Matcher<const std::vector<LogLine>&>(new LinesAreMatcher(std::move(expected)));
}

}  // namespace orvtest
