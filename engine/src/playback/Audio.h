// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PlayerTypes.h>
#include <utils/Errors.h>

#include <mutex>
#include <optional>
#include <utility>

#include "core/MpvHandle.h"
#include "core/VideoOutput.h"

namespace orvtarn {

// Loudness, balance, and which of picture and sound a player's role has. What is set
// before there is an mpv is kept for it.
class Audio {
public:
    Audio(MpvHandle& mpv, VideoOutput& video) : mMpv(mpv), mVideo(video) {}

    // Linear gains; taken as 0 or 1 outside of that range, BAD_VALUE for what
    // is no number. Sound that is buffered already keeps its gain.
    android::status_t setVolume(float left, float right);
    android::status_t setRole(E_Orv_Player_Role_Type role);
    // mpv has been made: it gets what was set.
    void restore();

private:
    bool hasCore() const { return mMpv.get() != nullptr; }
    android::status_t applyVolume();
    android::status_t setBalance(double left, double right);

    MpvHandle& mMpv;
    VideoOutput& mVideo;
    std::mutex mMutex;
    std::optional<std::pair<double, double>> mVolume;  // left and right, 0 to 1
    std::optional<bool> mMuted;
};

}  // namespace orvtarn
