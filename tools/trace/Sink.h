// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>

#include "Meaning.h"
#include "NativeMethods.h"

namespace orvtrace {

// A point of the log's time: nanoseconds by its Clock, and as it stands in the line, where
// it is empty in a format without times.
struct Moment {
    Moment() = default;
    Moment(int64_t at, std::string_view written) : ns(at) {
        length = static_cast<uint8_t>(std::min(written.size(), sizeof(text)));
        memcpy(text, written.data(), length);
    }
    bool known() const { return length > 0; }
    std::string_view asWritten() const { return {text, length}; }

    int64_t ns = 0;
    uint8_t length = 0;
    char text[39] = {};
};

// Where spans and marks stand: a thread of a process, or a player, whose id is no thread's.
struct Track {
    int pid = 0;
    int64_t id = 0;
};

// From a line that enters to the one that leaves.
struct Span {
    Track track;
    std::string_view name;
    const NativeMethod* method = nullptr;  // null for what is none
    Moment begin;
    int64_t end = 0;
    bool timed = true;  // its end is known, and the log has times
    bool failed = false;
    bool leaveMissing = false;  // a line that leaves was to come, and did not
    std::string_view failure;   // what the log said of it
};

struct MarkAt {
    Track track;
    Moment moment;
    Mark kind;
    char priority;
    std::string_view text;
};

// Takes what the lines of a log say. Texts last for the call alone.
class Sink {
public:
    virtual ~Sink() = default;
    // Before a track's first span or mark; may come again.
    virtual void track(Track track, std::string_view name) = 0;
    // When it ends; of nested ones the inner first.
    virtual void span(const Span& span) = 0;
    virtual void mark(const MarkAt& mark) = 0;
};

}  // namespace orvtrace
