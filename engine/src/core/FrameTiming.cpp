// SPDX-License-Identifier: Apache-2.0
#include "core/FrameTiming.h"

#include <math.h>

#include <algorithm>

namespace orvtarn {
namespace {

constexpr int64_t kFarAhead = 1000000;

int64_t toMicroseconds(double seconds) { return llround(std::max(seconds, 0.0) * 1e6); }

}  // namespace

int64_t dueInMicroseconds(int64_t due, int64_t now) {
    return due > now + kFarAhead ? due / 1000 : due;
}

std::optional<int64_t> FrameTiming::begin(uint64_t frame, int64_t due) {
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    const std::optional<double> expected =
        mClock.begin(dueInMicroseconds(due, mpv_get_time_us(mMpv.get())));
    mAsked = frame;
    mpv_wakeup(mMpv.get());
    if (!expected || now.phase != Phase::Started || now.seeking) return {};
    return toMicroseconds(*expected);
}

// Until a seek or the load is done, mpv's time may be the one that it left
// or the one that was asked for.
void FrameTiming::answer() {
    const uint64_t frame = mAsked;
    if (frame == 0) return;
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    if (now.isArriving() || (now.phase == Phase::Preparing && !now.restarted)) return;
    const double reported = mMpv.getDouble("time-pos").value_or(now.position);
    const double time = mClock.resolve(reported, mpv_get_time_us(mMpv.get()));
    // Paused, and no other frame is on its way.
    if (now.phase != Phase::Started && time == reported) mClock.stand();
    give(frame, time);
}

void FrameTiming::leave() {
    const uint64_t frame = mAsked;
    const std::optional<double> time = mClock.leave(mpv_get_time_us(mMpv.get()));
    if (frame != 0 && time) give(frame, *time);
}

void FrameTiming::give(uint64_t frame, double seconds) {
    mVideo.setFrameTime(frame, toMicroseconds(seconds));
    mAsked.compare_exchange_strong(frame, 0);  // unless the next one is here
}

}  // namespace orvtarn
