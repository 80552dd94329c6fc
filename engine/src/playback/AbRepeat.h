// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PlayerTypes.h>

#include <mutex>

#include "core/MpvHandle.h"
#include "core/PlayerState.h"

namespace orvtarn {

// The section that is played again and again.
class AbRepeat {
public:
    AbRepeat(MpvHandle& mpv, PlayerState& state) : mMpv(mpv), mState(state) {}

    // type: an E_Orv_AB_Repeat_Type. A section of one frame gets a second one. False for other
    // types, where the media cannot seek, and for an end without or not behind a beginning.
    bool set(int type);
    void reset();

private:
    bool setBegin();
    bool setEnd();

    MpvHandle& mMpv;
    PlayerState& mState;
    std::mutex mMutex;
};

}  // namespace orvtarn
