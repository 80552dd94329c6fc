// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "core/EventLoop.h"
#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "playback/Seeker.h"
#include "playback/Transport.h"

namespace orvtarn {

// Single frames, forward and back, of media with a picture. Playback is paused
// by it.
class Stepper {
public:
    Stepper(MpvHandle& mpv, PlayerState& state, Seeker& seeker, Transport& transport,
            EventLoop& events)
        : mMpv(mpv), mState(state), mSeeker(seeker), mTransport(transport), mEvents(events) {}

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
    EventLoop& mEvents;
};

}  // namespace orvtarn
