// SPDX-License-Identifier: Apache-2.0
#include "playback/AbRepeat.h"

#include <algorithm>

#include "base/EngineLog.h"
#include "playback/ShortestSection.h"

namespace orvtarn {

bool AbRepeat::set(int type) {
    if (mState.requireOpen("setABRepeat") != android::NO_ERROR) return false;
    std::lock_guard<std::mutex> lock(mMutex);
    switch (type) {
        case E_ORV_AB_REPEAT_OFF:
            reset();
            return true;
        case E_ORV_AB_REPEAT_SET_A:
            return setBegin();
        case E_ORV_AB_REPEAT_SET_B:
            return setEnd();
        default:
            return refused("setABRepeat", "no such type");
    }
}

void AbRepeat::reset() {
    mMpv.set("ab-loop-b", "no");
    mMpv.set("ab-loop-a", "no");
}

bool AbRepeat::setBegin() {
    if (!mState.read([](const PlayerState::Values& v) { return v.seekable; })) {
        return refused("setABRepeat", "the media cannot seek");
    }
    const auto now = mMpv.getDouble("time-pos");
    if (!now) return refused("setABRepeat", "no position");
    reset();
    return mMpv.set("ab-loop-a", *now) >= 0;
}

bool AbRepeat::setEnd() {
    const auto begin = mMpv.getDouble("ab-loop-a");
    const auto now = mMpv.getDouble("time-pos");
    if (!begin) return refused("setABRepeat", "the section has no beginning");
    if (!now || *now <= *begin)
        return refused("setABRepeat", "the end is not behind the beginning");
    return mMpv.set("ab-loop-b", std::max(*now, *begin + shortestSection(mMpv))) >= 0;
}

}  // namespace orvtarn
