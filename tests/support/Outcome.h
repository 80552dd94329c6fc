// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gmock/gmock.h>

#include <optional>
#include <string>
#include <vector>

#include "FakeJni/Vm.h"
#include "LogCapture.h"

namespace orvtest {

// Everything that can be seen of one native call.
struct Outcome {
    std::string returned;  // as Java would write it; "void" for none
    std::optional<fakejni::Thrown> thrown;
    std::vector<LogLine> log;             // of the calling thread
    std::vector<std::string> engine;      // calls of the newest engine player
    std::vector<std::string> java;        // Java methods that ran
    std::vector<std::string> unreleased;  // buffers of strings and arrays
    int globals = 0;                      // global references more than before
    size_t locals = 0;                    // local references left to the machine
};
void PrintTo(const Outcome& outcome, std::ostream* out);

// The numbers behind "Line:" in these lines, in order.
std::vector<int> lineNumbers(const std::vector<LogLine>& log);

// What a test expects of an Outcome, for EXPECT_THAT. What is not named must
// not have happened, except that local references are not counted. Where a
// text has "Line:%d", the number must be positive.
class Expected {
public:
    using is_gtest_matcher = void;

    explicit Expected(const std::string& returned) : mReturned(returned) {}

    Expected& logs(std::vector<ExpectedLine> lines);
    Expected& throws(const std::string& type);  // without a message
    Expected& throws(const std::string& type, const std::string& message);
    Expected& engine(std::vector<std::string> calls);
    Expected& java(std::vector<std::string> calls);
    Expected& leavesUnreleased(std::vector<std::string> functions);
    Expected& makesGlobals(int count);

    bool MatchAndExplain(const Outcome& outcome, std::ostream* out) const;
    void DescribeTo(std::ostream* out) const { *out << "is the expected outcome"; }
    void DescribeNegationTo(std::ostream* out) const { *out << "is another outcome"; }

private:
    std::string mReturned;
    std::optional<fakejni::Thrown> mThrown;
    std::vector<ExpectedLine> mLog;
    std::vector<std::string> mEngine;
    std::vector<std::string> mJava;
    std::vector<std::string> mUnreleased;
    int mGlobals = 0;
};

inline Expected Returns(const std::string& value) { return Expected(value); }
inline Expected ReturnsNothing() { return Expected("void"); }

// Lines of the native bridge.
ExpectedLine bridgeInfo(const std::string& text);
ExpectedLine bridgeWarning(const std::string& text);
ExpectedLine bridgeError(const std::string& text);
ExpectedLine enter(const std::string& function);  // "function(): Enter\n"
ExpectedLine leave(const std::string& function);
ExpectedLine occur(const std::string& function);
// Lines of the media service.
ExpectedLine serviceInfo(const std::string& text);
ExpectedLine serviceError(const std::string& text);

constexpr char kIllegalState[] = "java/lang/IllegalStateException";
constexpr char kIllegalArgument[] = "java/lang/IllegalArgumentException";
constexpr char kIo[] = "java/io/IOException";
constexpr char kRuntime[] = "java/lang/RuntimeException";
constexpr char kSecurity[] = "java/lang/SecurityException";
constexpr char kOutOfMemory[] = "java/lang/OutOfMemoryError";

}  // namespace orvtest
