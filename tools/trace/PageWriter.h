// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "Json.h"
#include "OutputFile.h"
#include "Sink.h"
#include "Statistics.h"

namespace orvtrace {

// Writes a page that draws a trace and needs nothing else. It holds the longest spans and
// the first marks alone, so that neither the page nor the memory here grows with the log.
class PageWriter : public Sink {
public:
    // Throws a Failure if the file cannot be written.
    explicit PageWriter(const std::string& path);

    void track(Track track, std::string_view name) override;
    void span(const Span& span) override;
    void mark(const MarkAt& mark) override;
    // Throws a Failure if it cannot be written whole.
    void finish(const Statistics& statistics, const LineCounts& lines, uint64_t players);

    static constexpr size_t kMaxSpans = 20000;
    static constexpr size_t kMaxMarks = 10000;
    static constexpr size_t kMaxTracks = 2000;

private:
    struct Bar {
        int64_t begin;
        int64_t time;
        size_t track;
        std::string name;
        std::string at;
        std::string note;
        bool native;
        bool failed;
    };
    struct Dot {
        int64_t at;
        size_t track;
        Mark kind;
        std::string when;
        std::string text;
    };
    using Key = std::pair<int, int64_t>;

    static bool isLonger(const Bar& a, const Bar& b);
    bool findTrack(Track track, size_t& index) const;
    std::string data(const Statistics& statistics, const LineCounts& lines, uint64_t players);
    void writeTracks(Json& json) const;
    void writeBars(Json& json) const;
    void writeDots(Json& json) const;

    OutputFile mFile;
    std::map<Key, size_t> mIndices;
    std::vector<std::string> mTracks;
    std::vector<Bar> mBars;  // a heap, the shortest first
    std::vector<Dot> mDots;
    uint64_t mSpans = 0;
    uint64_t mMarks = 0;
    int64_t mZero = INT64_MAX;
};

}  // namespace orvtrace
