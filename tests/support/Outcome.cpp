// SPDX-License-Identifier: Apache-2.0
#include "Outcome.h"

#include <stdlib.h>

#include <algorithm>
#include <ostream>

namespace orvtest {

namespace {

constexpr char kBridgeTag[] = "OrvMediaClient-JNI";
constexpr char kServiceTag[] = "OrvMediaService";

std::string describe(const std::optional<fakejni::Thrown>& thrown) {
    if (!thrown) return "nothing";
    return thrown->type + (thrown->message ? " \"" + *thrown->message + '"' : " (no message)");
}

std::string describe(const std::vector<std::string>& items) {
    std::string text = "{";
    for (const std::string& item : items) text += (text.size() == 1 ? "" : ", ") + item;
    return text + "}";
}

std::string describe(const std::string& text) { return text; }
std::string describe(int number) { return std::to_string(number); }

template <typename T>
bool same(const char* what, const T& expected, const T& actual, std::ostream* out) {
    if (expected == actual) return true;
    if (out != nullptr)
        *out << "\n  " << what << ": " << describe(actual)
             << "\n    expected: " << describe(expected);
    return false;
}

bool linesAre(const std::vector<ExpectedLine>& expected, const std::vector<LogLine>& actual,
              std::ostream* out) {
    testing::StringMatchResultListener listener;
    if (LinesAre(expected).MatchAndExplain(actual, &listener)) return true;
    if (out != nullptr) *out << listener.str();
    return false;
}

int lineNumber(const std::string& text) {
    const size_t at = text.find("Line:");
    return at == std::string::npos ? -1 : atoi(text.c_str() + at + 5);
}

bool lineNumbersArePositive(const std::vector<ExpectedLine>& expected,
                            const std::vector<LogLine>& actual, std::ostream* out) {
    for (size_t i = 0; i < std::min(expected.size(), actual.size()); ++i) {
        if (expected[i].text.find("Line:%d") == std::string::npos) continue;
        if (lineNumber(actual[i].text) > 0) continue;
        if (out != nullptr) *out << "\n  not a source line: " << actual[i].text;
        return false;
    }
    return true;
}

}  // namespace

void PrintTo(const Outcome& outcome, std::ostream* out) {
    *out << "returned " << outcome.returned << ", threw " << describe(outcome.thrown) << ", engine "
         << describe(outcome.engine) << ", Java " << describe(outcome.java);
    for (const LogLine& line : outcome.log) *out << "\n    " << testing::PrintToString(line);
}

std::vector<int> lineNumbers(const std::vector<LogLine>& log) {
    std::vector<int> numbers;
    for (const LogLine& line : log) {
        if (line.text.find("Line:") != std::string::npos) numbers.push_back(lineNumber(line.text));
    }
    return numbers;
}

Expected& Expected::logs(std::vector<ExpectedLine> lines) {
    mLog = std::move(lines);
    return *this;
}

Expected& Expected::throws(const std::string& type) {
    mThrown = fakejni::Thrown{type, {}};
    return *this;
}

Expected& Expected::throws(const std::string& type, const std::string& message) {
    mThrown = fakejni::Thrown{type, message};
    return *this;
}

Expected& Expected::engine(std::vector<std::string> calls) {
    mEngine = std::move(calls);
    return *this;
}

Expected& Expected::java(std::vector<std::string> calls) {
    mJava = std::move(calls);
    return *this;
}

Expected& Expected::leavesUnreleased(std::vector<std::string> functions) {
    mUnreleased = std::move(functions);
    return *this;
}

Expected& Expected::makesGlobals(int count) {
    mGlobals = count;
    return *this;
}

bool Expected::MatchAndExplain(const Outcome& outcome, std::ostream* out) const {
    bool good = same("returned", mReturned, outcome.returned, out);
    good &= same("threw", mThrown, outcome.thrown, out);
    good &= same("called the engine", mEngine, outcome.engine, out);
    good &= same("called Java", mJava, outcome.java, out);
    good &= same("left unreleased", mUnreleased, outcome.unreleased, out);
    good &= same("made global references", mGlobals, outcome.globals, out);
    good &= linesAre(mLog, outcome.log, out);
    good &= lineNumbersArePositive(mLog, outcome.log, out);
    return good;
}

ExpectedLine bridgeInfo(const std::string& text) { return info(text).tagged(kBridgeTag); }
ExpectedLine bridgeWarning(const std::string& text) { return warning(text).tagged(kBridgeTag); }
ExpectedLine bridgeError(const std::string& text) { return error(text).tagged(kBridgeTag); }
ExpectedLine enter(const std::string& function) { return bridgeInfo(function + "(): Enter\n"); }
ExpectedLine leave(const std::string& function) { return bridgeInfo(function + "(): Leave\n"); }
ExpectedLine occur(const std::string& function) { return bridgeInfo(function + "(): occur\n"); }
ExpectedLine serviceInfo(const std::string& text) { return info(text).tagged(kServiceTag); }
ExpectedLine serviceError(const std::string& text) { return error(text).tagged(kServiceTag); }

}  // namespace orvtest
