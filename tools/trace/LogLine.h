// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <string_view>

namespace orvtrace {

constexpr int64_t kNanosecondsPerSecond = 1000000000;
// Later or earlier, a time would not fit into 64 bits of nanoseconds: a line with such a
// one is foreign.
constexpr int kFirstYear = 1970;
constexpr int kLastYear = 2200;
constexpr int64_t kMostSeconds = 8000000000;

// A date and a time of day as a log line has them.
struct LogTime {
    bool known = false;       // brief lines have none
    bool counted = false;     // seconds since some start (epoch, monotonic), in nanoseconds
    int year = 0;             // kFirstYear to kLastYear; 0 for none
    int month = 1;            // 1 to 12
    int day = 1;              // 1 to 31
    int64_t nanoseconds = 0;  // since midnight; if counted since that start
    int digits = 0;           // after the point: 0 to 9
    std::string_view text;    // as it stands in the line
};

// A line of the platform's log. Its texts are those of the line that it was read from,
// and last as long.
struct LogLine {
    LogTime time;
    int pid = 0;
    int tid = 0;  // the process's id in formats that have no thread's
    char priority = '?';
    std::string_view tag;
    std::string_view text;  // without white space at its end
};

}  // namespace orvtrace
