// SPDX-License-Identifier: Apache-2.0
#include "playback/Stepper.h"

#include <chrono>

#include "base/EngineLog.h"

namespace orvtarn {
namespace {

// mpv has no word for a step's end: it is asked.
constexpr std::chrono::milliseconds kPollInterval{2};
constexpr std::chrono::seconds kStepLimit{5};

}  // namespace

bool Stepper::step(int amount) {
    if (mState.requireOpen("step") != android::NO_ERROR) return false;
    if (mMpv.getInt("vid").value_or(0) <= 0) return refused("step", "no picture");
    mTransport.becomePaused();
    // The last frame is the last of a loop, too.
    mMpv.set("loop-file", "no");
    const bool towardsEnd = amount > 0;
    bool found = true;
    for (; found && amount != 0; amount += towardsEnd ? -1 : 1) {
        found = towardsEnd ? forward() : back();
    }
    mEvents.applyLooping();
    const double now = mMpv.getDouble("time-pos").value_or(0);
    mState.update([now](PlayerState::Values& v) { v.position = now; });
    return found || refused("step", "no such frame");
}

bool Stepper::forward() {
    const double before = mMpv.getDouble("time-pos").value_or(0);
    if (mMpv.getFlag("eof-reached").value_or(true)) return false;
    if (mMpv.command({"frame-step"}) < 0) return false;
    const auto deadline = std::chrono::steady_clock::now() + kStepLimit;
    while (std::chrono::steady_clock::now() < deadline) {
        const bool moved = mMpv.getDouble("time-pos").value_or(before) != before;
        if (moved && mMpv.getFlag("pause").value_or(false)) return true;
        if (!moved && mMpv.getFlag("eof-reached").value_or(true)) break;
        mState.wait(kPollInterval, [](const PlayerState::Values& v) { return !v.isOpen(); });
    }
    mMpv.set("pause", true);
    return false;
}

bool Stepper::back() {
    const double before = mMpv.getDouble("time-pos").value_or(0);
    if (before <= 0) return false;
    return mSeeker.runAndAwait("step", [this] { return mMpv.command({"frame-back-step"}); }) ==
               android::NO_ERROR &&
           mMpv.getDouble("time-pos").value_or(before) < before;
}

}  // namespace orvtarn
