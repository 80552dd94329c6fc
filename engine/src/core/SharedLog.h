// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string_view>

namespace orvtarn {

// FFmpeg logs for the whole process. mpv hands all of it to the core that was made first, lines
// about other cores' media included; the others get none of it, not even once that one is gone.
// Knows whether one core's log is about its own media alone. Thread-safe.
class SharedLog {
public:
    SharedLog() = default;
    ~SharedLog() { leave(); }
    SharedLog(const SharedLog&) = delete;
    SharedLog& operator=(const SharedLog&) = delete;

    // Whether FFmpeg wrote a line, by the name that mpv gives its writer.
    static bool isOfFfmpeg(std::string_view writer);

    // The core is about to be made.
    void enter();
    // It is made: cores that are made later are not the first.
    void settle();
    // It is gone.
    void leave();
    // Whether all that FFmpeg logs now reaches this core, and is about its media.
    bool isOwn() const;

private:
    bool mEntered = false;
};

}  // namespace orvtarn
