// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>

#include <string>

#include "core/MpvLoad.h"

namespace orvtest {

// A player of libmpv without screen and loudspeaker, to see what it makes of
// the engine's values.
class RealPlayer {
public:
    RealPlayer();
    ~RealPlayer();
    RealPlayer(const RealPlayer&) = delete;
    RealPlayer& operator=(const RealPlayer&) = delete;

    mpv_handle* handle() { return mMpv; }
    // Opens a file, paused. Waits at most ten seconds. False when it cannot be
    // opened.
    bool load(const std::string& path, const orvtarn::MpvOptions& options = {});
    bool command(const char* name, const char* first, const char* second);
    // Empty when unavailable.
    std::string text(const std::string& property);
    // The property "track-list"; the caller frees the contents.
    mpv_node trackList();

private:
    mpv_handle* mMpv;
};

}  // namespace orvtest
