// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <mutex>
#include <optional>

namespace orvtarn {

// Finds the media time of each frame that mpv hands out. A frame comes with the
// moment at which it is due, on mpv's own clock; the media time that mpv reports
// is that of the newest frame it has queued. mpv queues the next one when that is
// due, so the report is the frame's own if it is read in time, and the one after
// it else. Frames that play on are as far apart in the media as they are due, by
// the speed. Any thread. Media times are in seconds, moments in microseconds.
class FrameClock {
public:
    // How fast the media plays, 1 for normal, negative for backward.
    void setSpeed(double speed);
    // mpv has left the place where it was, at a moment: frames that are due later are
    // not the successors of those before. What is known of the time of the newest one.
    std::optional<double> leave(int64_t at);

    // A frame is here. Its time, as far as those before lead to it.
    std::optional<double> begin(int64_t due);
    // The time of that frame, when mpv has reported a time and that was read at the
    // latest at a moment.
    double resolve(double reported, int64_t readAt);
    // Playback stands still: the frames to come are not the successors of those before.
    void stand();

private:
    struct Frame {
        double time;
        int64_t due;
    };

    void forget();
    double choose(double reported, int64_t readAt);
    std::optional<double> expected() const;
    // Whether the newest frame is due when the one after the frame before would be.
    bool follows() const;
    bool isInTime(int64_t readAt) const;
    bool agrees(double expected, double reported) const;

    std::mutex mMutex;
    double mSpeed = 1;
    int64_t mDue = 0;                  // of the newest frame
    std::optional<int64_t> mLastStep;  // to it from the frame before
    std::optional<int64_t> mStep;      // the shorter one of the last two
    std::optional<int64_t> mLeftAt;    // no frame from beyond the jump is here yet
    std::optional<Frame> mKnown;       // a frame whose time was reported
    double mPrevious = 0;              // the time of the frame before
};

}  // namespace orvtarn
