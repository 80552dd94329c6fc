// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

#include "LogLine.h"
#include "Meaning.h"
#include "Sink.h"

namespace orvtrace {

// Pairs the lines of each thread that enter with those that leave. The native half returns
// from many failures without a line: such a call ends where the thread's next one begins,
// or with the call that it was part of.
class Calls {
public:
    explicit Calls(Sink& sink) : mSink(sink) {}

    void line(const LogLine& line, const Meaning& meaning, int64_t ns);
    // The log is at its end: what is open has no line that leaves.
    void finish();

    // Lines that leave what no line before them has entered.
    uint64_t strayLeaves() const { return mStrayLeaves; }

    // The least time between two lines of a thread, in nanoseconds: what writing one takes at
    // least. INT64_MAX if there was none.
    int64_t shortestStep() const { return mShortestStep; }

    // More threads than this are not followed at a time: those that do nothing are forgotten
    // first.
    static constexpr size_t kMaxThreads = 1 << 16;

private:
    struct Open {
        std::string name;
        const NativeMethod* method;
        Moment begin;
        bool awaitsLeave;
        bool failed = false;
        std::string failure;
    };
    struct Thread {
        Track track;
        std::vector<Open> open;
        int64_t last = INT64_MAX;  // of its last line
        bool timed = true;
    };

    static void rename(Open& open, std::string_view name);
    static bool isOpenAgain(const Open& open, std::string_view name);
    Thread& threadOf(const LogLine& line);
    void enter(Thread& thread, const LogLine& line, const Meaning& meaning, int64_t ns);
    void enterNative(Thread& thread, const NativeMethod& method, const Moment& now);
    void leave(Thread& thread, std::string_view name, int64_t ns);
    void fail(Thread& thread, std::string_view text);
    void closeDownTo(Thread& thread, size_t depth);
    void close(Thread& thread, int64_t end, bool leaveMissing);
    void closeProcess(int pid);
    void forgetThreads();

    Sink& mSink;
    std::unordered_map<uint64_t, Thread> mThreads;
    uint64_t mStrayLeaves = 0;
    int64_t mShortestStep = INT64_MAX;
};

}  // namespace orvtrace
