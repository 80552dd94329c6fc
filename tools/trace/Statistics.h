// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "Histogram.h"
#include "Sink.h"

namespace orvtrace {

// A native method's calls.
struct MethodCalls {
    const NativeMethod* method = nullptr;
    uint64_t calls = 0;
    uint64_t failed = 0;
    uint64_t leaveMissing = 0;  // and so without a time
    int64_t total = 0;          // nanoseconds of those with a time
    int64_t shortest = 0;
    int64_t longest = 0;
    Moment longestAt;
    Histogram times;
};

// What a log's calls, events and errors come to, in memory that does not grow with the log.
class Statistics : public Sink {
public:
    void track(Track, std::string_view) override {}
    void span(const Span& span) override;
    void mark(const MarkAt& mark) override;

    // Those that were called, by their total time, the longest first.
    std::vector<const MethodCalls*> methods() const;
    uint64_t calls() const { return mCalls; }
    uint64_t marks(Mark kind) const;

private:
    std::map<const NativeMethod*, std::unique_ptr<MethodCalls>> mMethods;
    uint64_t mCalls = 0;
    uint64_t mMarks[5] = {};
};

// What became of the lines.
struct LineCounts {
    uint64_t lines = 0;
    uint64_t ours = 0;
    uint64_t otherTags = 0;
    uint64_t foreign = 0;  // in none of the formats
    uint64_t separators = 0;
    uint64_t longLines = 0;
    uint64_t strayLeaves = 0;
    uint64_t setBack = 0;
    uint64_t withoutTime = 0;          // ours, in a format without times
    int digits = 9;                    // behind the point, the fewest
    int64_t shortestStep = INT64_MAX;  // nanoseconds between two lines of a thread
    bool threads = true;               // false if a line of ours had no thread's id

    uint64_t entries() const { return ours + otherTags; }
};

}  // namespace orvtrace
