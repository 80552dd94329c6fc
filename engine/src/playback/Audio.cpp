// SPDX-License-Identifier: Apache-2.0
#include "playback/Audio.h"

#include <math.h>
#include <stdint.h>

#include <algorithm>
#include <string>

#include "base/EngineLog.h"

namespace orvtarn {
namespace {

// A gain as filters take it, with a point whatever the locale.
std::string gainText(double gain) {
    const std::string thousandths = std::to_string(1000 + lround(gain * 1000));
    return std::string(gain >= 1 ? "1." : "0.") + thousandths.substr(1);
}

}  // namespace

android::status_t Audio::setVolume(float left, float right) {
    if (isnan(left) || isnan(right)) return failed(android::BAD_VALUE, "setVolume", "not a number");
    std::lock_guard<std::mutex> lock(mMutex);
    mVolume = {std::clamp(left, 0.0f, 1.0f), std::clamp(right, 0.0f, 1.0f)};
    return hasCore() ? applyVolume() : android::NO_ERROR;
}

void Audio::restore() {
    std::lock_guard<std::mutex> lock(mMutex);
    if (mVolume) applyVolume();
    if (mMuted) mMpv.set("mute", *mMuted);
}

android::status_t Audio::applyVolume() {
    const auto [l, r] = *mVolume;
    const double louder = std::max(l, r);
    // mpv's volume is cubic, in percent.
    int error = mMpv.set("volume", 100 * cbrt(louder));
    if (error < 0) return failed(android::UNKNOWN_ERROR, "setVolume", mpv_error_string(error));
    return louder > 0 ? setBalance(l / louder, r / louder) : android::NO_ERROR;
}

android::status_t Audio::setBalance(double left, double right) {
    std::string filter;
    if (left != right) {
        filter = "@balance:lavfi=[aformat=channel_layouts=stereo,pan=stereo|c0=" + gainText(left) +
                 "*c0|c1=" + gainText(right) + "*c1]";
    }
    const int error = mMpv.set("af", filter);
    if (error >= 0) return android::NO_ERROR;
    return failed(android::UNKNOWN_ERROR, "setVolume", mpv_error_string(error));
}

android::status_t Audio::setRole(E_Orv_Player_Role_Type role) {
    if (role < E_ORV_PLAYER_ROLE_MAIN || role > E_ORV_PLAYER_ROLE_BACKGROUND) {
        return failed(android::BAD_VALUE, "setPlayerRole", "no such role");
    }
    std::lock_guard<std::mutex> lock(mMutex);
    mMuted = role == E_ORV_PLAYER_ROLE_SUB;
    if (hasCore()) mMpv.set("mute", *mMuted);
    mVideo.setVisible(role != E_ORV_PLAYER_ROLE_BACKGROUND);
    return android::NO_ERROR;
}

}  // namespace orvtarn
