// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/Errors.h>

#include <functional>
#include <mutex>

#include "core/EventLoop.h"
#include "core/MpvHandle.h"
#include "core/PlayerState.h"

namespace orvtarn {

// Playing and pausing of prepared media, and what can be asked about it.
class Transport {
public:
    Transport(MpvHandle& mpv, PlayerState& state, EventLoop& events)
        : mMpv(mpv), mState(state), mEvents(events) {}

    // After the end of the media plays it again, if it can seek.
    android::status_t start();
    android::status_t pause();
    bool isPlaying() const;
    android::status_t getCurrentPosition(int* msec) const;
    android::status_t getDuration(int* msec) const;
    android::status_t getVideoWidth(int* width) const;
    android::status_t getVideoHeight(int* height) const;
    android::status_t setLooping(bool looping);
    int bufferPercent() const;

    // mpv is at its end. True when playback is completed by it; what loops
    // goes on.
    bool complete();
    // Pauses as an effect of another operation.
    void becomePaused();
    // While another unit moves the position itself, mpv is kept paused.
    // Backward play after the end begins at the end.
    void setTrick(bool coreHeld, bool backward);
    bool isBackward();
    // While a seek is under way, mpv is kept paused: it stands at the first frame
    // of the new position until that is known.
    void setSeeking(bool seeking);

private:
    void applyPause();
    void keepPosition();
    android::status_t getSize(const char* operation, int PlayerState::Values::* member,
                              int* pixels) const;

    MpvHandle& mMpv;
    PlayerState& mState;
    EventLoop& mEvents;
    // The phase and mpv's own pause change together.
    std::mutex mMutex;
    bool mCoreHeld = false;
    bool mBackward = false;
    bool mSeeking = false;
};

}  // namespace orvtarn
