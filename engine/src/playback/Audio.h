// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PlayerTypes.h>
#include <utils/Errors.h>

#include <mutex>

#include "core/MpvHandle.h"
#include "core/VideoOutput.h"

namespace orvtarn {

// Loudness, balance, and which of picture and sound a player's role has.
class Audio {
public:
    Audio(MpvHandle& mpv, VideoOutput& video) : mMpv(mpv), mVideo(video) {}

    // Linear gains; taken as 0 or 1 outside of that range, BAD_VALUE for what
    // is no number. Sound that is buffered already keeps its gain.
    android::status_t setVolume(float left, float right);
    android::status_t setRole(E_Orv_Player_Role_Type role);

private:
    android::status_t setBalance(double left, double right);

    MpvHandle& mMpv;
    VideoOutput& mVideo;
    std::mutex mMutex;
};

}  // namespace orvtarn
