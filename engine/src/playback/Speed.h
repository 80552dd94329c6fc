// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/Errors.h>

#include <atomic>
#include <condition_variable>
#include <mutex>
#include <thread>

#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "playback/Seeker.h"
#include "playback/Transport.h"

namespace orvtarn {

// Play speeds, in thousandths; negative ones play backward. mpv plays
// backward at up to eight times the speed; beyond, and where mpv finds no way
// back, mpv stands still and this unit seeks from key frame to key frame by the
// clock. At its start, media that were played backward go on forward at the
// normal speed.
class Speed {
public:
    Speed(MpvHandle& mpv, PlayerState& state, Seeker& seeker, Transport& transport,
          EventLoop& events, FrameTiming& frameTiming)
        : mMpv(mpv),
          mState(state),
          mSeeker(seeker),
          mTransport(transport),
          mEvents(events),
          mFrameTiming(frameTiming) {}
    ~Speed() { stopJumping(); }

    // Normal when it fails. BAD_VALUE outside of 250..32000 forward or backward, INVALID_OPERATION
    // before the media is prepared and backward in media that cannot seek.
    android::status_t set(int speed);
    int get() const { return mSpeed; }
    bool canSeek(int speed) const;
    bool canPlay(int speed) const;

    // mpv came to an end, on the event loop's thread; true when it was
    // the start, from which it goes on.
    bool onEndReached();
    // Back to normal, for media that are about to be loaded or were closed.
    void reset();
    // Before the other units go.
    void shutDown() { stopJumping(); }

private:
    android::status_t apply(int speed);
    android::status_t play(int speed, bool jumps);
    bool isAtStart() const;
    int setTempo(int speed, bool jumps);
    void becomeNormal();
    void startJumping(int speed);
    void stopJumping();
    void jump(int speed);
    bool jumpTo(double seconds);

    MpvHandle& mMpv;
    PlayerState& mState;
    Seeker& mSeeker;
    Transport& mTransport;
    EventLoop& mEvents;
    FrameTiming& mFrameTiming;
    std::atomic<int> mSpeed{1000};

    std::mutex mSetMutex;  // one change at a time
    std::mutex mJumpMutex;
    std::condition_variable mJumpChanged;
    bool mJumping = false;
    std::thread mJumper;
};

}  // namespace orvtarn
