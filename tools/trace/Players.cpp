// SPDX-License-Identifier: Apache-2.0
#include "Players.h"

#include <stdio.h>

namespace orvtrace {

namespace {

// Beyond any thread's id.
constexpr int64_t kFirstTrack = 1000000000;
// A process that makes players for days; the oldest tracks are full by then.
constexpr size_t kMaxPlayers = 4096;
constexpr size_t kMaxProcesses = 4096;

const char* waitOf(std::string_view name) {
    if (name == "OrvMediaClient_prepareAsync") return "preparing";
    return name == "OrvMediaClient_seekTo" ? "seeking" : nullptr;
}

// What gives up what is waited for.
bool endsWaits(std::string_view name) {
    return name == "OrvMediaClient_stop" || name == "OrvMediaClient_reset";
}

const char* waitEndedBy(std::string_view event) {
    if (event == "MEDIA_PREPARED") return "preparing";
    return event == "MEDIA_SEEK_COMPLETE" ? "seeking" : nullptr;
}

}  // namespace

void Players::line(const LogLine& line, const Meaning& meaning, int64_t ns) {
    if (mProcesses.size() >= kMaxProcesses && mProcesses.count(line.pid) == 0) finish();
    Process& process = mProcesses[line.pid];
    const Moment now(ns, line.time.text);
    switch (meaning.kind) {
        case Meaning::Kind::kLoad:
            end(process, process.last);
            break;
        case Meaning::Kind::kBorn:
            beBorn(process, line.pid, now);
            break;
        case Meaning::Kind::kGone:
            go(process, ns);
            break;
        case Meaning::Kind::kEnter:
            if (waitOf(meaning.name) != nullptr) wait(process, waitOf(meaning.name), now);
            if (endsWaits(meaning.name)) giveUp(process, ns);
            break;
        default:
            if (!meaning.event.empty()) event(process, line, meaning, ns);
    }
    process.last = ns;
}

void Players::beBorn(Process& process, int pid, const Moment& now) {
    Player& player = add(process, pid, 0);
    player.alive = true;
    player.born = now;
}

void Players::go(Process& process, int64_t ns) {
    size_t alive = 0;
    for (const Player& player : process.players) alive += player.alive ? 1 : 0;
    if (alive == 0 || ++process.gone < alive) return;
    end(process, ns);
}

void Players::event(Process& process, const LogLine& line, const Meaning& meaning, int64_t ns) {
    Player& player = playerAt(process, line.pid, meaning.player);
    mSink.mark({player.track, Moment(ns, line.time.text), meaning.mark, line.priority, line.text});
    const char* ended = waitEndedBy(meaning.event);
    if (ended != nullptr && player.wait == ended) endWait(player, ns, false);
}

void Players::wait(Process& process, const char* what, const Moment& now) {
    Player* player = onlyOne(process);
    if (player == nullptr) return;
    endWait(*player, now.ns, true);
    player->wait = what;
    player->waits = now;
}

void Players::giveUp(Process& process, int64_t ns) {
    Player* player = onlyOne(process);
    if (player != nullptr) endWait(*player, ns, true);
}

// What fails is not waited for.
void Players::call(const Span& span) {
    const NativeMethod* method = span.method;
    if (!span.failed || method == nullptr || method->enter == nullptr ||
        waitOf(method->enter) == nullptr)
        return;
    const auto process = mProcesses.find(span.track.pid);
    Player* player = process == mProcesses.end() ? nullptr : onlyOne(process->second);
    if (player == nullptr || player->wait != waitOf(method->enter)) return;
    player->wait.clear();
}

void Players::endWait(Player& player, int64_t ns, bool missing) {
    if (player.wait.empty()) return;
    Span span;
    span.track = player.track;
    span.name = player.wait;
    span.begin = player.waits;
    span.end = std::max(ns, player.waits.ns);
    span.leaveMissing = missing;
    mSink.span(span);
    player.wait.clear();
}

void Players::end(Process& process, int64_t ns) {
    for (Player& player : process.players) {
        endWait(player, ns, true);
        if (!player.alive) continue;
        Span span;
        span.track = player.track;
        span.name = "player";
        span.begin = player.born;
        span.end = std::max(ns, player.born.ns);
        mSink.span(span);
    }
    process.players.clear();
    process.gone = 0;
}

void Players::finish() {
    for (auto& [pid, process] : mProcesses) end(process, process.last);
    mProcesses.clear();
}

// The address of a new player's first event is its own while there is no other.
Players::Player& Players::playerAt(Process& process, int pid, uint64_t address) {
    for (Player& player : process.players) {
        if (player.address == address) return player;
    }
    Player* only = onlyOne(process);
    if (only == nullptr || only->address != 0) return add(process, pid, address);
    only->address = address;
    return *only;
}

Players::Player& Players::add(Process& process, int pid, uint64_t address) {
    if (process.players.size() >= kMaxPlayers) end(process, process.last);
    Player player;
    player.track = {pid, kFirstTrack + static_cast<int64_t>(mCount++)};
    player.address = address;
    char name[64];
    if (address == 0) {
        snprintf(name, sizeof(name), "player %llu", static_cast<unsigned long long>(mCount));
    } else {
        snprintf(name, sizeof(name), "player %llu (0x%llx)",
                 static_cast<unsigned long long>(mCount), static_cast<unsigned long long>(address));
    }
    mSink.track(player.track, name);
    process.players.push_back(player);
    return process.players.back();
}

// Null if there are several, or none.
Players::Player* Players::onlyOne(Process& process) {
    return process.players.size() == 1 && process.players[0].alive ? &process.players[0] : nullptr;
}

}  // namespace orvtrace
