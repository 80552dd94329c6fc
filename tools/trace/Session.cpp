// SPDX-License-Identifier: Apache-2.0
#include "Session.h"

namespace orvtrace {

Session::Session(const std::vector<Sink*>& writers)
    : mPlayers(mWriters), mWatcher(mPlayers), mCalls(mAll) {
    for (Sink* writer : writers) mWriters.add(writer);
    mAll.add(&mStatistics);
    mAll.add(&mWatcher);
    mAll.add(&mWriters);
}

void Session::line(std::string_view text) {
    ++mCounts.lines;
    LogLine line;
    switch (mFormats.read(text, line)) {
        case FormatReader::Result::kSeparator:
            ++mCounts.separators;
            break;
        case FormatReader::Result::kForeign:
            ++mCounts.foreign;
            break;
        case FormatReader::Result::kEntry:
            if (isOurs(line.tag)) {
                ours(line);
            } else {
                ++mCounts.otherTags;
            }
    }
}

void Session::ours(const LogLine& line) {
    ++mCounts.ours;
    if (!line.time.known) ++mCounts.withoutTime;
    const Format format = mFormats.format();
    if (format == Format::kBrief || format == Format::kTime) mCounts.threads = false;
    const int64_t ns = mClock.at(line.time);
    const Meaning meaning = meaningOf(line);
    // A player's events come before the call that ends with them, and its end before its
    // release's.
    mPlayers.line(line, meaning, ns);
    mCalls.line(line, meaning, ns);
}

void Session::finish() {
    mCalls.finish();
    mPlayers.finish();
}

LineCounts Session::counts() const {
    LineCounts counts = mCounts;
    counts.strayLeaves = mCalls.strayLeaves();
    counts.shortestStep = mCalls.shortestStep();
    counts.setBack = mClock.setBack();
    counts.digits = mClock.digits();
    return counts;
}

void Session::Fan::track(Track track, std::string_view name) {
    for (Sink* sink : mSinks) sink->track(track, name);
}

void Session::Fan::span(const Span& span) {
    for (Sink* sink : mSinks) sink->span(span);
}

void Session::Fan::mark(const MarkAt& mark) {
    for (Sink* sink : mSinks) sink->mark(mark);
}

}  // namespace orvtrace
