// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <stdint.h>
#include <utils/Errors.h>

#include <string>

namespace orvtarn {

// What mpv and FFmpeg log about reading the media's bytes. To mpv, media that
// broke off look like media that ended; only the log distinguishes them. The
// texts are fixed in both, in no user's language. One thread uses it.
class ReadTrouble {
public:
    // One line of mpv's log.
    void note(const std::string& line);
    void forget();
    // The engine's status for the weightiest trouble; 0 when there was none.
    android::status_t status() const { return mStatus; }

private:
    size_t mWeight = SIZE_MAX;  // less is weightier
    android::status_t mStatus = android::NO_ERROR;
};

}  // namespace orvtarn
