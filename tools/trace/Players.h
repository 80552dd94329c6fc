// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "LogLine.h"
#include "Meaning.h"
#include "Sink.h"

namespace orvtrace {

// Recognises players. An event's line has its media service's address; a call's has not,
// so it is known whose it is while its process has one player alone. Each has a track with
// its life, what it waits for (being prepared, the end of a seek) and its events.
class Players {
public:
    explicit Players(Sink& sink) : mSink(sink) {}

    void line(const LogLine& line, const Meaning& meaning, int64_t ns);
    // A native method's call that has ended.
    void call(const Span& span);
    void finish();

    uint64_t count() const { return mCount; }

private:
    struct Player {
        Track track;
        uint64_t address = 0;  // 0 while it is unknown
        bool alive = false;    // its birth stands in the log, its end does not
        Moment born;
        std::string wait;  // what it waits for
        Moment waits;
    };
    struct Process {
        std::vector<Player> players;
        size_t gone = 0;  // of several players: it is not known which
        int64_t last = 0;
    };

    void beBorn(Process& process, int pid, const Moment& now);
    void go(Process& process, int64_t ns);
    void event(Process& process, const LogLine& line, const Meaning& meaning, int64_t ns);
    void wait(Process& process, const char* what, const Moment& now);
    static Player* onlyOne(Process& process);
    void giveUp(Process& process, int64_t ns);
    void endWait(Player& player, int64_t ns, bool missing);
    void end(Process& process, int64_t ns);
    Player& playerAt(Process& process, int pid, uint64_t address);
    Player& add(Process& process, int pid, uint64_t address);

    Sink& mSink;
    std::map<int, Process> mProcesses;
    uint64_t mCount = 0;
};

}  // namespace orvtrace
