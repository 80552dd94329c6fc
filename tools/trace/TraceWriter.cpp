// SPDX-License-Identifier: Apache-2.0
#include "TraceWriter.h"

namespace orvtrace {

namespace {

// Processes whose names are kept in mind; another's may be written twice.
constexpr size_t kMaxProcesses = 4096;

const char* categoryOf(Mark kind) {
    switch (kind) {
        case Mark::kEvent:
            return "event";
        case Mark::kException:
            return "exception";
        case Mark::kWarning:
            return "warning";
        default:
            return "error";
    }
}

}  // namespace

TraceWriter::TraceWriter(const std::string& path) : mFile(path), mJson(mFile.file()) {
    mJson.beginObject();
    mJson.pair("displayTimeUnit", "ms");
    mJson.key("traceEvents");
    mJson.beginArray();
}

void TraceWriter::track(Track track, std::string_view name) {
    if (mProcesses.size() >= kMaxProcesses) mProcesses.clear();
    if (mProcesses.insert(track.pid).second) {
        nameTrack("process_name", {track.pid, track.pid}, "process " + std::to_string(track.pid));
    }
    nameTrack("thread_name", track, name);
}

void TraceWriter::nameTrack(const char* what, Track track, std::string_view name) {
    mJson.beginObject();
    mJson.pair("ph", "M");
    mJson.pair("name", what);
    mJson.pair("pid", track.pid);
    mJson.pair("tid", track.id);
    mJson.key("args");
    mJson.beginObject();
    mJson.pair("name", name);
    mJson.endObject();
    mJson.endObject();
}

void TraceWriter::begin(const char* phase, std::string_view name, const char* category, Track track,
                        const Moment& moment) {
    if (!mHasZero) mZero = moment.ns;
    mHasZero = true;
    mJson.beginObject();
    mJson.pair("ph", phase);
    mJson.pair("name", name);
    mJson.pair("cat", category);
    mJson.pair("pid", track.pid);
    mJson.pair("tid", track.id);
    mJson.key("ts");
    mJson.microseconds(moment.ns - mZero);
}

void TraceWriter::span(const Span& span) {
    if (!span.begin.known()) return;
    const bool instant = span.method != nullptr && span.method->trail != Trail::kPair;
    begin(instant ? "i" : "X", span.name, span.method != nullptr ? "native" : "inner", span.track,
          span.begin);
    if (instant) {
        mJson.pair("s", "t");
    } else {
        mJson.key("dur");
        mJson.microseconds(span.end - span.begin.ns);
    }
    if (span.failed) mJson.pair("cname", "terrible");
    mJson.key("args");
    mJson.beginObject();
    mJson.pair("at", span.begin.asWritten());
    if (span.leaveMissing) mJson.pair("end", "not in the log");
    if (span.failed) mJson.pair("failure", span.failure);
    mJson.endObject();
    mJson.endObject();
}

void TraceWriter::mark(const MarkAt& mark) {
    if (!mark.moment.known()) return;
    begin("i", mark.text, categoryOf(mark.kind), mark.track, mark.moment);
    mJson.pair("s", "t");
    mJson.key("args");
    mJson.beginObject();
    mJson.pair("at", mark.moment.asWritten());
    mJson.pair("priority", std::string_view(&mark.priority, 1));
    mJson.endObject();
    mJson.endObject();
}

void TraceWriter::finish() {
    mJson.endArray();
    mJson.endObject();
    mJson.flush();
    mFile.finish();
}

}  // namespace orvtrace
