// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <atomic>
#include <optional>

#include "core/FrameClock.h"
#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "core/VideoOutput.h"

namespace orvtarn {

// A frame's moment as mpv gives it, on a clock that shows that time now; all but the
// moment are microseconds. mpv's header says microseconds of the moment, too, but
// some releases (0.40) give nanoseconds. No frame is due far ahead.
int64_t dueInMicroseconds(int64_t due, int64_t now);

// Asks mpv for the media time of each frame on the thread of its events, since
// the drawing thread must not wait for mpv, and gives it to the video output.
class FrameTiming {
public:
    FrameTiming(MpvHandle& mpv, PlayerState& state, VideoOutput& video)
        : mMpv(mpv), mState(state), mVideo(video) {}

    // How fast the media plays from now on, 1 for normal, negative for backward.
    void setSpeed(double speed) { mClock.setSpeed(speed); }
    // The media time of the frame of that number as far as the frames before lead to
    // it, in microseconds; mpv is asked for it. Any thread. Does not wait.
    std::optional<int64_t> begin(uint64_t frame, int64_t due);
    // Answers for the newest frame, when mpv knows. On the thread of events, as the
    // next one.
    void answer();
    // mpv leaves the place where it was, by a seek.
    void leave();

private:
    void give(uint64_t frame, double seconds);

    MpvHandle& mMpv;
    PlayerState& mState;
    VideoOutput& mVideo;
    FrameClock mClock;
    std::atomic<uint64_t> mAsked{0};  // the frame without an answer, 0 for none
};

}  // namespace orvtarn
