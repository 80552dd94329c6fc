// SPDX-License-Identifier: Apache-2.0
#include "playback/Stepper.h"

#include <stdlib.h>

#include <algorithm>
#include <chrono>
#include <cmath>

#include "base/EngineLog.h"

namespace orvtarn {
namespace {

using android::status_t;

// mpv does not report a step's end: it is asked.
constexpr std::chrono::milliseconds kPollInterval{2};
constexpr std::chrono::seconds kStepLimit{5};
// A seek takes about as long as this many steps forward. mpv's step back is a longer
// seek: it decodes from further ahead.
constexpr int kFewestToJump = 4;

}  // namespace

bool Stepper::step(int amount) {
    if (mState.requireOpen("step") != android::NO_ERROR) return false;
    if (mMpv.getInt("vid").value_or(0) <= 0) return refused("step", "no picture");
    mTransport.becomePaused();
    // The last frame is the last of a loop, too.
    mMpv.set("loop-file", "no");
    // Frames are counted forward, whatever the direction of play.
    const bool turns = amount != 0 && mTransport.isBackward() &&
                       mSeeker.setDirection("step", false) == android::NO_ERROR;
    const bool found = move(amount);
    if (turns) mSeeker.setDirection("step", true);
    mEvents.applyLooping();
    const double now = mMpv.getDouble("time-pos").value_or(0);
    mState.update([now](PlayerState::Values& v) { v.position = now; });
    return found || refused("step", "no such frame");
}

bool Stepper::move(int amount) {
    if (amount < 0 || amount >= kFewestToJump) {
        const double now = mMpv.getDouble("time-pos").value_or(0);
        std::optional<FrameAt> target = mFrameFrom(now, amount);
        if (!target) target = frameByRate(now, amount);
        if (target) return jump(*target);
    }
    bool found = true;
    for (int left = abs(amount); found && left > 0; left--) found = amount > 0 ? forward() : back();
    return found;
}

// Where packets cannot be counted, as on a server, the rate says how far frames are
// apart.
std::optional<FrameAt> Stepper::frameByRate(double seconds, int amount) const {
    const double rate = mMpv.getDouble("container-fps").value_or(0);
    const auto now = mState.read([](const PlayerState::Values& v) { return v; });
    if (rate <= 0 || now.duration <= 0 || !now.seekable) return {};
    const double target = seconds + amount / rate;
    const double last = std::max(now.duration - 1 / rate, 0.0);
    const double reached = std::clamp(target, 0.0, last);
    return FrameAt{reached, std::abs(reached - target) < 0.5 / rate};
}

// One seek in place of many steps.
bool Stepper::jump(const FrameAt& target) {
    const status_t status = mSeeker.showFrame("step", target.seconds);
    return status == android::NO_ERROR && target.isThere;
}

bool Stepper::forward() {
    return mSeeker.runAlone("step", [this] { return showNext(); }) == android::NO_ERROR;
}

bool Stepper::showNext() {
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
