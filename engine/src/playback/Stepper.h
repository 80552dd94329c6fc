// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <functional>
#include <optional>
#include <utility>

#include "core/EventLoop.h"
#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "inspect/FrameTimes.h"
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

    // Finds the frame that many frames from the one of a time; nothing where that
    // cannot be known. Before the first step.
    using FrameFrom = std::function<std::optional<FrameAt>(double seconds, int amount)>;
    void setFrameFrom(FrameFrom find) { mFrameFrom = std::move(find); }

    // Blocks until the last of the frames is shown, ten seconds at most for many at
    // once. False when one of them is not there: the last that is there is shown.
    bool step(int amount);

private:
    bool move(int amount);
    bool forward();
    bool showNext();
    bool back();
    std::optional<FrameAt> frameByRate(double seconds, int amount) const;
    bool jump(const FrameAt& target);

    MpvHandle& mMpv;
    PlayerState& mState;
    Seeker& mSeeker;
    Transport& mTransport;
    EventLoop& mEvents;
    FrameFrom mFrameFrom;
};

}  // namespace orvtarn
