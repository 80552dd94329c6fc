// SPDX-License-Identifier: Apache-2.0
#include "PageWriter.h"

#include <stdlib.h>

#include <algorithm>

#include "Page.h"
#include "Table.h"
#include "Text.h"

namespace orvtrace {

namespace {

const char* nameOf(Mark kind) {
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

// JSON as it may stand in a page: no "</script>" in it.
std::string embeddable(std::string_view json) {
    std::string text;
    text.reserve(json.size());
    for (const char c : json) {
        if (c == '<') {
            text += "\\u003c";
        } else {
            text += c;
        }
    }
    return text;
}

}  // namespace

PageWriter::PageWriter(const std::string& path) : mFile(path) {}

bool PageWriter::isLonger(const Bar& a, const Bar& b) { return a.time > b.time; }

void PageWriter::track(Track track, std::string_view name) {
    if (mTracks.size() >= kMaxTracks ||
        !mIndices.emplace(Key(track.pid, track.id), mTracks.size()).second)
        return;
    mTracks.push_back("process " + std::to_string(track.pid) + ", " + std::string(name));
}

bool PageWriter::findTrack(Track track, size_t& index) const {
    const auto found = mIndices.find({track.pid, track.id});
    if (found == mIndices.end()) return false;
    index = found->second;
    return true;
}

void PageWriter::span(const Span& span) {
    size_t track;
    if (!span.begin.known()) return;
    ++mSpans;
    mZero = std::min(mZero, span.begin.ns);
    const int64_t time = span.end - span.begin.ns;
    if (!findTrack(span.track, track)) return;
    if (mBars.size() == kMaxSpans) {
        if (time <= mBars.front().time) return;
        std::pop_heap(mBars.begin(), mBars.end(), isLonger);
        mBars.pop_back();
    }
    std::string note(span.failure);
    if (span.leaveMissing)
        note += note.empty() ? "its end is not in the log" : "; its end is not in the log";
    mBars.push_back({span.begin.ns, time, track, std::string(span.name),
                     std::string(span.begin.asWritten()), note, span.method != nullptr,
                     span.failed});
    std::push_heap(mBars.begin(), mBars.end(), isLonger);
}

void PageWriter::mark(const MarkAt& mark) {
    size_t track;
    if (!mark.moment.known()) return;
    ++mMarks;
    mZero = std::min(mZero, mark.moment.ns);
    if (mDots.size() >= kMaxMarks || !findTrack(mark.track, track)) return;
    mDots.push_back({mark.moment.ns, track, mark.kind, std::string(mark.moment.asWritten()),
                     std::string(mark.text)});
}

void PageWriter::writeTracks(Json& json) const {
    json.key("tracks");
    json.beginArray();
    for (const std::string& track : mTracks) json.text(track);
    json.endArray();
}

void PageWriter::writeBars(Json& json) const {
    json.key("spans");
    json.beginArray();
    for (const Bar& bar : mBars) {
        json.beginObject();
        json.pair("track", static_cast<int64_t>(bar.track));
        json.pair("name", bar.name);
        json.key("begin");
        json.microseconds(bar.begin - mZero);
        json.key("time");
        json.microseconds(bar.time);
        json.pair("at", bar.at);
        json.pair("kind", bar.failed ? "failed" : bar.native ? "native" : "inner");
        if (!bar.note.empty()) json.pair("note", bar.note);
        json.endObject();
    }
    json.endArray();
}

void PageWriter::writeDots(Json& json) const {
    json.key("marks");
    json.beginArray();
    for (const Dot& dot : mDots) {
        json.beginObject();
        json.pair("track", static_cast<int64_t>(dot.track));
        json.key("begin");
        json.microseconds(dot.at - mZero);
        json.pair("kind", nameOf(dot.kind));
        json.pair("at", dot.when);
        json.pair("name", dot.text);
        json.endObject();
    }
    json.endArray();
}

std::string PageWriter::data(const Statistics& statistics, const LineCounts& lines,
                             uint64_t players) {
    std::sort(mBars.begin(), mBars.end(), [](const Bar& a, const Bar& b) {
        return a.begin != b.begin ? a.begin < b.begin : a.time > b.time;
    });
    char* text = nullptr;
    size_t size = 0;
    FILE* memory = open_memstream(&text, &size);
    if (memory == nullptr) throw Failure("There is no memory for the page.");
    {
        Json json(memory);
        json.beginObject();
        writeTracks(json);
        writeBars(json);
        writeDots(json);
        json.pair("allSpans", static_cast<int64_t>(mSpans));
        json.pair("allMarks", static_cast<int64_t>(mMarks));
        json.key("table");
        json.beginArray();
        for (const auto& row : rowsOf(statistics, lines)) {
            json.beginArray();
            for (const std::string& cell : row) json.text(cell);
            json.endArray();
        }
        json.endArray();
        json.pair("summary", summaryOf(statistics, lines, players));
        json.endObject();
        json.flush();
    }
    fclose(memory);
    std::string embedded = embeddable({text, size});
    free(text);
    return embedded;
}

void PageWriter::finish(const Statistics& statistics, const LineCounts& lines, uint64_t players) {
    const std::string_view page = kPage;
    const size_t place = page.find(kPageData);
    const std::string json = data(statistics, lines, players);
    FILE* file = mFile.file();
    fwrite(page.data(), 1, place, file);
    fwrite(json.data(), 1, json.size(), file);
    const std::string_view rest = page.substr(place + sizeof(kPageData) - 1);
    fwrite(rest.data(), 1, rest.size(), file);
    mFile.finish();
}

}  // namespace orvtrace
