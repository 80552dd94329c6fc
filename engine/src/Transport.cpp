// SPDX-License-Identifier: Apache-2.0
#include "Transport.h"

#include <math.h>

#include <algorithm>

#include "EngineLog.h"

namespace orvtarn {
namespace {

using android::status_t;

int milliseconds(double seconds) { return static_cast<int>(lround(seconds * 1000)); }

}  // namespace

status_t Transport::start() {
    std::lock_guard<std::mutex> lock(mMutex);
    const Phase before = mState.update([this](PlayerState::Values& v) {
        const Phase phase = v.phase;
        if (v.isOpen()) v.phase = Phase::Started;
        if (phase == Phase::Completed && !mBackward) v.position = 0;
        return phase;
    });
    switch (before) {
        case Phase::Started:
            return android::NO_ERROR;
        case Phase::Completed:
            if (!mBackward) mMpv.seek(0, "absolute");
            break;
        case Phase::Prepared:
        case Phase::Paused:
            break;
        default:
            return PlayerState::wrongPhase("start", before);
    }
    mMpv.set("pause", mCoreHeld);
    return android::NO_ERROR;
}

status_t Transport::pause() {
    std::lock_guard<std::mutex> lock(mMutex);
    const Phase before = mState.update([](PlayerState::Values& v) {
        const Phase phase = v.phase;
        if (phase == Phase::Started) v.phase = Phase::Paused;
        return phase;
    });
    if (before == Phase::Started) mMpv.set("pause", true);
    const bool allowed =
        before == Phase::Started || before == Phase::Paused || before == Phase::Completed;
    return allowed ? android::NO_ERROR : PlayerState::wrongPhase("pause", before);
}

void Transport::setTrick(bool coreHeld, bool backward) {
    std::lock_guard<std::mutex> lock(mMutex);
    mCoreHeld = coreHeld;
    mBackward = backward;
    mMpv.set("pause", coreHeld || mState.phase() != Phase::Started);
}

void Transport::becomePaused() {
    std::lock_guard<std::mutex> lock(mMutex);
    mMpv.set("pause", true);
    mState.update([](PlayerState::Values& v) {
        if (v.isOneOf({Phase::Prepared, Phase::Started})) v.phase = Phase::Paused;
    });
}

bool Transport::isPlaying() const {
    return mState.read(
        [](const PlayerState::Values& v) { return v.phase == Phase::Started && !v.buffering; });
}

status_t Transport::getCurrentPosition(int* msec) const {
    if (msec == nullptr) return failed(android::BAD_VALUE, "getCurrentPosition", "null argument");
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    *msec = 0;
    if (now.phase == Phase::Error) return now.error;
    // Programs ask for this again and again: no log line.
    if (!now.isOpen()) return android::INVALID_OPERATION;
    const double position = now.duration > 0 ? std::min(now.position, now.duration) : now.position;
    *msec = milliseconds(now.phase == Phase::Completed ? now.duration : position);
    return android::NO_ERROR;
}

status_t Transport::getDuration(int* msec) const {
    if (msec == nullptr) return failed(android::BAD_VALUE, "getDuration", "null argument");
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    *msec = 0;
    if (!now.isOpen() && now.phase != Phase::Stopped) {
        return PlayerState::wrongPhase("getDuration", now.phase);
    }
    *msec = milliseconds(now.duration);
    return android::NO_ERROR;
}

status_t Transport::getVideoWidth(int* width) const {
    return getSize("getVideoWidth", &PlayerState::Values::width, width);
}

status_t Transport::getVideoHeight(int* height) const {
    return getSize("getVideoHeight", &PlayerState::Values::height, height);
}

status_t Transport::getSize(const char* operation, int PlayerState::Values::*member,
                            int* pixels) const {
    if (pixels == nullptr) return failed(android::BAD_VALUE, operation, "null argument");
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    *pixels = now.*member;
    return now.phase == Phase::Error ? PlayerState::wrongPhase(operation, now.phase)
                                     : android::NO_ERROR;
}

status_t Transport::setLooping(bool looping) {
    const Phase phase = mState.phase();
    if (phase == Phase::Error) return PlayerState::wrongPhase("setLooping", phase);
    mMpv.set("loop-file", looping ? "inf" : "no");
    return android::NO_ERROR;
}

// While playing, the core's own time may be that of the frame to come; paused,
// the state may still be that of the frame before.
int64_t Transport::frameTime() const {
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    const double seconds = now.phase == Phase::Started
                               ? now.position
                               : mMpv.getDouble("time-pos").value_or(now.position);
    return llround(std::max(seconds, 0.0) * 1e6);
}

int Transport::bufferPercent() const {
    return mState.read([](const PlayerState::Values& v) { return v.bufferPercent; });
}

}  // namespace orvtarn
