// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string_view>
#include <vector>

#include "Calls.h"
#include "Clock.h"
#include "Formats.h"
#include "Players.h"
#include "Sink.h"
#include "Statistics.h"

namespace orvtrace {

// What the lines of a log say, line by line, to all that want it.
class Session {
public:
    // The sinks outlive it.
    explicit Session(const std::vector<Sink*>& writers);

    void line(std::string_view line);
    // Another log goes on where the last one ended.
    void nextLog() { mFormats.restart(); }
    // What is open ends.
    void finish();

    uint64_t lines() const { return mCounts.lines; }
    void addLongLines(uint64_t count) { mCounts.longLines += count; }
    const Statistics& statistics() const { return mStatistics; }
    LineCounts counts() const;
    uint64_t players() const { return mPlayers.count(); }

private:
    // Hands on to several.
    class Fan : public Sink {
    public:
        void add(Sink* sink) { mSinks.push_back(sink); }
        void track(Track track, std::string_view name) override;
        void span(const Span& span) override;
        void mark(const MarkAt& mark) override;

    private:
        std::vector<Sink*> mSinks;
    };
    // The players' eye on calls.
    class CallWatcher : public Sink {
    public:
        explicit CallWatcher(Players& players) : mPlayers(players) {}
        void track(Track, std::string_view) override {}
        void span(const Span& span) override { mPlayers.call(span); }
        void mark(const MarkAt&) override {}

    private:
        Players& mPlayers;
    };

    void ours(const LogLine& line);

    FormatReader mFormats;
    Clock mClock;
    LineCounts mCounts;
    Statistics mStatistics;
    Fan mWriters;
    Players mPlayers;
    CallWatcher mWatcher;
    Fan mAll;
    Calls mCalls;
};

}  // namespace orvtrace
