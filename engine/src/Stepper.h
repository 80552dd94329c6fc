// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "MpvHandle.h"
#include "PlayerState.h"
#include "Seeker.h"
#include "Transport.h"

namespace orvtarn {

// Single frames, forward and back, of media with a picture. Playback is paused
// by it.
class Stepper {
public:
    Stepper(MpvHandle& mpv, PlayerState& state, Seeker& seeker, Transport& transport)
        : mMpv(mpv), mState(state), mSeeker(seeker), mTransport(transport) {}

    // Blocks until the last of the frames is shown. False when one of them is
    // not there.
    bool step(int amount);

private:
    bool forward();
    bool back();

    MpvHandle& mMpv;
    PlayerState& mState;
    Seeker& mSeeker;
    Transport& mTransport;
};

}  // namespace orvtarn
