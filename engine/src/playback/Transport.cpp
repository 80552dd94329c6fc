// SPDX-License-Identifier: Apache-2.0
#include "playback/Transport.h"

#include <algorithm>
#include <optional>

#include "base/EngineLog.h"
#include "base/Milliseconds.h"

namespace orvtarn {
using android::status_t;

status_t Transport::start() {
    std::lock_guard<std::mutex> lock(mMutex);
    bool over = false;
    const Phase before = mState.update([&](PlayerState::Values& v) {
        const Phase phase = v.phase;
        over = phase == Phase::Completed && !v.seekable;
        if (v.isOpen() && !over) v.phase = Phase::Started;
        if (phase == Phase::Completed && !over && !mBackward) v.position = 0;
        return phase;
    });
    if (over) return failed(android::INVALID_OPERATION, "start", "the media cannot seek");
    switch (before) {
        case Phase::Started:
            return android::NO_ERROR;
        case Phase::Completed:
            if (!mBackward) mEvents.seekUnattended([this] { return mMpv.seek(0, "absolute"); });
            break;
        case Phase::Prepared:
        case Phase::Paused:
            break;
        default:
            return PlayerState::wrongPhase("start", before);
    }
    applyPause();
    // mpv may have been at its end while it was paused.
    if (before != Phase::Completed) mEvents.lookForEnd();
    return android::NO_ERROR;
}

// mpv keeps the media open at its end, still playing if it could: it is
// paused, so that a later seek does not start it again.
bool Transport::complete() {
    std::lock_guard<std::mutex> lock(mMutex);
    const bool completed = mState.update([](PlayerState::Values& v) {
        if (v.phase != Phase::Started || v.seeking || (v.looping && v.seekable)) return false;
        v.phase = Phase::Completed;
        if (v.duration <= 0) v.duration = v.position;
        return true;
    });
    if (completed) mMpv.set("pause", true);
    return completed;
}

status_t Transport::pause() {
    std::lock_guard<std::mutex> lock(mMutex);
    const Phase before = mState.update([](PlayerState::Values& v) {
        const Phase phase = v.phase;
        if (phase == Phase::Started) v.phase = Phase::Paused;
        return phase;
    });
    if (before == Phase::Started) {
        mMpv.set("pause", true);
        keepPosition();
    }
    const bool allowed =
        before == Phase::Started || before == Phase::Paused || before == Phase::Completed;
    return allowed ? android::NO_ERROR : PlayerState::wrongPhase("pause", before);
}

// The report of the frame that is shown may still be on its way.
void Transport::keepPosition() {
    const std::optional<double> now = mMpv.getDouble("time-pos");
    mState.update([now](PlayerState::Values& v) {
        if (now && v.phase == Phase::Paused && !v.seeking) v.position = std::max(*now, 0.0);
    });
}

void Transport::setTrick(bool coreHeld, bool backward) {
    std::lock_guard<std::mutex> lock(mMutex);
    mCoreHeld = coreHeld;
    mBackward = backward;
    applyPause();
}

bool Transport::isBackward() {
    std::lock_guard<std::mutex> lock(mMutex);
    return mBackward;
}

void Transport::setSeeking(bool seeking) {
    std::lock_guard<std::mutex> lock(mMutex);
    mSeeking = seeking;
    applyPause();
}

void Transport::applyPause() {
    mMpv.set("pause", mCoreHeld || mSeeking || mState.phase() != Phase::Started);
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
    // Programs ask for this again and again: no log line.
    const PlayerState::Position now = mState.currentPosition();
    *msec = now.msec;
    return now.status;
}

status_t Transport::getDuration(int* msec) const {
    if (msec == nullptr) return failed(android::BAD_VALUE, "getDuration", "null argument");
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    *msec = 0;
    if (!now.isOpen() && now.phase != Phase::Stopped) {
        return PlayerState::wrongPhase("getDuration", now.phase);
    }
    *msec = toMilliseconds(now.duration);
    return android::NO_ERROR;
}

status_t Transport::getVideoWidth(int* width) const {
    return getSize("getVideoWidth", &PlayerState::Values::width, width);
}

status_t Transport::getVideoHeight(int* height) const {
    return getSize("getVideoHeight", &PlayerState::Values::height, height);
}

status_t Transport::getSize(const char* operation, int PlayerState::Values::* member,
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
    mState.update([looping](PlayerState::Values& v) { v.looping = looping; });
    mEvents.applyLooping();
    return android::NO_ERROR;
}

int Transport::bufferPercent() const {
    return mState.read([](const PlayerState::Values& v) { return v.bufferPercent; });
}

}  // namespace orvtarn
