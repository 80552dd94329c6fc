// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <android/log.h>

namespace orvtest {

// A line on its way to the log.
struct SinkLine {
    int priority;
    const char* tag;  // may be null
    const char* text;
};

// The log hands a line to its sink as a record and a text; from Android 11 on
// the text is in the record.
template <typename Record>
SinkLine sinkLine(const Record* record, const char* text) {
    return {record->priority, record->tag, text};
}
template <typename Record>
SinkLine sinkLine(const Record* record) {
    return {record->priority, record->tag, record->message};
}

// Installs a sink of the process's log. Take(line) tells whether it took the
// line; others go to stderr, as usual.
template <bool (*Take)(const SinkLine&)>
void installLogSink() {
    __android_log_set_logger([](auto... arguments) {
        if (!Take(sinkLine(arguments...))) __android_log_stderr_logger(arguments...);
    });
}

}  // namespace orvtest
