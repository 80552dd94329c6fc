// SPDX-License-Identifier: Apache-2.0
#include "playback/Speed.h"

#include <orvtarn/PlayerTypes.h>
#include <stdlib.h>

#include <algorithm>
#include <chrono>

#include "base/EngineLog.h"
#include "base/ThreadName.h"
#include "playback/ShortestSection.h"

namespace orvtarn {
namespace {

using android::status_t;

constexpr int kSlowest = 250;
constexpr int kFastestBackwardPlay = 8000;
// Above this the decoder cannot follow without leaving frames out.
constexpr int kFastestFullDecoding = 16000;
constexpr std::chrono::milliseconds kJumpInterval{100};
// So near to the start there is nothing to play backward. Seconds.
constexpr double kStart = 0.5;

bool isSpeed(int speed) {
    return speed >= ORV_SPEED_MIN && speed <= ORV_SPEED_MAX && abs(speed) >= kSlowest;
}

}  // namespace

status_t Speed::set(int speed) {
    if (!isSpeed(speed)) return failed(android::BAD_VALUE, "setSpeed", "no such speed");
    std::lock_guard<std::mutex> lock(mSetMutex);
    const status_t open = mState.requireOpen("setSpeed");
    if (open != android::NO_ERROR) return open;
    if (!canPlay(speed)) {
        return failed(android::INVALID_OPERATION, "setSpeed", "the media cannot seek");
    }
    stopJumping();
    return apply(speed);
}

status_t Speed::apply(int speed) {
    const bool jumps = speed < -kFastestBackwardPlay || (speed < 0 && isAtStart());
    status_t status = play(speed, jumps);
    // In damaged media mpv may not find a way back.
    if (status == android::TIMED_OUT && speed < 0 && !jumps) status = play(speed, true);
    if (status != android::NO_ERROR) becomeNormal();
    return status;
}

status_t Speed::play(int speed, bool jumps) {
    const int error = setTempo(speed, jumps);
    if (error < 0) return failed(android::UNKNOWN_ERROR, "setSpeed", mpv_error_string(error));
    const bool backward = speed < 0 && !jumps;
    if (backward != mMpv.isBackward()) {
        const status_t status = mSeeker.setDirection("setSpeed", backward);
        if (status != android::NO_ERROR) return status;
    }
    mSpeed = speed;
    mTransport.setTrick(jumps, speed < 0);
    if (jumps) startJumping(speed);
    return android::NO_ERROR;
}

// mpv takes what it plays of one frame alone for a still picture, and never takes that
// back while the media are open.
bool Speed::isAtStart() const {
    const double start = std::max(kStart, shortestSection(mMpv));
    return mState.read([start](const PlayerState::Values& v) { return v.position < start; });
}

// How fast mpv plays, whatever the direction. 0 or an mpv_error.
int Speed::setTempo(int speed, bool jumps) {
    const double tempo = jumps ? 1.0 : abs(speed) / 1000.0;
    mFrameTiming.setSpeed(speed < 0 ? -tempo : tempo);
    const int error = mMpv.set("framedrop", speed > kFastestFullDecoding ? "decoder+vo" : "vo");
    return error < 0 ? error : mMpv.set("speed", tempo);
}

bool Speed::canSeek(int speed) const {
    if (speed != 0 && !isSpeed(speed)) return false;
    return mState.read([](const PlayerState::Values& v) { return v.isOpen() && v.seekable; });
}

bool Speed::canPlay(int speed) const {
    if (!isSpeed(speed)) return false;
    return mState.read(
        [speed](const PlayerState::Values& v) { return v.isOpen() && (speed > 0 || v.seekable); });
}

bool Speed::onEndReached() {
    // What was set while paused at the start holds until it plays.
    if (mSpeed >= 0 || mState.phase() != Phase::Started) return false;
    mEvents.seekUnattended([this] {
        becomeNormal();
        return mMpv.seek(0, "absolute");
    });
    return true;
}

void Speed::becomeNormal() {
    mSpeed = ORV_SPEED_NORMAL;
    setTempo(ORV_SPEED_NORMAL, false);
    mMpv.setBackward(false);
    mTransport.setTrick(false, false);
}

void Speed::reset() {
    std::lock_guard<std::mutex> lock(mSetMutex);
    stopJumping();
    becomeNormal();
}

void Speed::startJumping(int speed) {
    std::lock_guard<std::mutex> lock(mJumpMutex);
    mJumping = true;
    mJumper = std::thread([this, speed] { jump(speed); });
}

void Speed::stopJumping() {
    {
        std::lock_guard<std::mutex> lock(mJumpMutex);
        mJumping = false;
        mJumpChanged.notify_all();
    }
    if (mJumper.joinable()) mJumper.join();
}

void Speed::jump(int speed) {
    nameThisThread("orv-rewind");
    auto last = std::chrono::steady_clock::now();
    double reached = -1;  // by the latest jump
    double target = 0;    // where the clock says playback is, between key frames
    std::unique_lock<std::mutex> lock(mJumpMutex);
    while (!mJumpChanged.wait_for(lock, kJumpInterval, [this] { return !mJumping; })) {
        const auto now = std::chrono::steady_clock::now();
        const std::chrono::duration<double> passed = now - last;
        last = now;
        const auto state = mState.read([](const PlayerState::Values& v) { return v; });
        if (state.phase != Phase::Started) continue;
        lock.unlock();
        if (state.position != reached) target = state.position;
        target += passed.count() * speed / 1000;
        const bool goesOn = jumpTo(target);
        reached = mState.read([](const PlayerState::Values& v) { return v.position; });
        lock.lock();
        if (!goesOn) return;
    }
}

// False when it is over: at the start of the media, and when a jump fails, as
// when the media are closed or give no data.
bool Speed::jumpTo(double seconds) {
    if (seconds > 0) {
        const auto jump = [&] { return mMpv.seek(seconds, "absolute+keyframes"); };
        if (mSeeker.runAndAwait("setSpeed", jump) == android::NO_ERROR) return true;
    }
    becomeNormal();
    if (seconds <= 0) {
        mSeeker.runAndAwait("setSpeed", [this] { return mMpv.seek(0, "absolute"); });
    }
    return false;
}

}  // namespace orvtarn
