// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <string_view>

#include "LogLine.h"

namespace orvtrace {

enum class Mark { kNone, kEvent, kException, kError, kWarning };

// What a line of the player's native half says.
struct Meaning {
    // kLoad: a process loads the library. kBorn and kGone: of a player.
    enum class Kind { kOther, kEnter, kLeave, kOccur, kLoad, kBorn, kGone };

    Kind kind = Kind::kOther;
    std::string_view name;  // of what is entered, left or occurs, as the log has it
    Mark mark = Mark::kNone;
    bool failure = false;    // of the native method that is being called
    std::string_view event;  // MEDIA_PREPARED
    uint64_t player = 0;     // the media service's address in an event, 0 for none
};

// Whether the player's native half, or the desktop's engine, writes with this tag.
bool isOurs(std::string_view tag);
// Of a line with such a tag. The texts last as long as the line's.
Meaning meaningOf(const LogLine& line);

}  // namespace orvtrace
