// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "JniFixture.h"

// The native methods of the classic media player, each a row of one table: how
// Java calls it, what it logs, where it goes.
namespace orvtest {

constexpr char kMissingLine[] = "service not exist, throw exception. Line:%d\n";

// Calls one native method on the test's player.
using Call = std::function<Outcome(JniFixture&)>;

// What a command promises. It starts as the regular form: enter and leave
// lines, an IllegalStateException and a zero without a service.
struct Command {
    std::string function;  // native
    Call call;
    std::vector<ExpectedLine> body;   // lines between enter and leave, with a service
    std::vector<std::string> engine;  // engine calls
    std::string zero = "void";        // what it returns without a service
    std::string good = "void";        // with one
    bool hasLines = true;             // enter and leave
    bool occurs = false;              // one occur line instead
    bool leaves = true;

    std::vector<ExpectedLine> first() const {
        if (!hasLines) return {};
        return {occurs ? occur(function) : enter(function)};
    }
    std::vector<ExpectedLine> whole(std::vector<ExpectedLine> extra = {}) const {
        std::vector<ExpectedLine> lines = first();
        lines.insert(lines.end(), body.begin(), body.end());
        lines.insert(lines.end(), extra.begin(), extra.end());
        if (hasLines && !occurs && leaves) lines.push_back(leave(function));
        return lines;
    }
};
inline void PrintTo(const Command& command, std::ostream* out) { *out << command.function; }

const std::vector<Command>& playbackCommands();
// Of the native function OrvMediaClient_<name>.
const Command& playbackCommand(const std::string& name);

jobject newParcel(JniFixture& test);
// A line of the media service.
ExpectedLine service(const std::string& operation);

}  // namespace orvtest
