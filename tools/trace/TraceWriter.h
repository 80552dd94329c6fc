// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <set>
#include <string>

#include "Json.h"
#include "OutputFile.h"
#include "Sink.h"

namespace orvtrace {

// Writes a trace in the trace-event format (JSON), which Perfetto's viewer and Chrome's
// about:tracing open.
class TraceWriter : public Sink {
public:
    // Throws a Failure if the file cannot be written.
    explicit TraceWriter(const std::string& path);

    void track(Track track, std::string_view name) override;
    void span(const Span& span) override;
    void mark(const MarkAt& mark) override;
    // Ends the trace; only then the file has its name. Throws a Failure if it cannot be
    // written whole.
    void finish();

private:
    void begin(const char* phase, std::string_view name, const char* category, Track track,
               const Moment& moment);
    void nameTrack(const char* what, Track track, std::string_view name);

    OutputFile mFile;
    Json mJson;
    bool mHasZero = false;
    int64_t mZero = 0;
    std::set<int> mProcesses;
};

}  // namespace orvtrace
