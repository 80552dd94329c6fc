// SPDX-License-Identifier: Apache-2.0
#include "Seeker.h"

#include <media/MediaPlayerInterface.h>
#include <media/MediaTrack.h>

#include <algorithm>
#include <chrono>

#include "EngineLog.h"

namespace orvtarn {
namespace {

using SeekMode = android::MediaTrack::ReadOptions::SeekMode;
using android::status_t;
using std::chrono::seconds;

constexpr seconds kSeekLimit{10};
// Positions closer than this are the same frame's.
constexpr double kSameFrame = 0.001;

bool isSeekMode(int mode) {
    return mode >= SeekMode::SEEK_PREVIOUS_SYNC && mode <= SeekMode::SEEK_CLOSEST;
}

}  // namespace

status_t Seeker::seekTo(int msec, int mode) {
    if (!isSeekMode(mode)) return failed(android::BAD_VALUE, "seekTo", "no such seek mode");
    uint64_t session = 0;
    const status_t begun = begin("seekTo", session);
    if (begun != android::NO_ERROR) return begun;
    const double duration = mState.read([](const PlayerState::Values& v) { return v.duration; });
    double target = std::max(msec, 0) / 1000.0;
    if (duration > 0) target = std::min(target, duration);
    const status_t status = seekAs(mode, target);
    mState.update([](PlayerState::Values& v) { v.seeking = false; });
    if (status == android::NO_ERROR) mNotifier.post(android::MEDIA_SEEK_COMPLETE);
    return status;
}

status_t Seeker::seekToTime(const char* operation, double target) {
    uint64_t session = 0;
    status_t status = begin(operation, session);
    if (status != android::NO_ERROR) return status;
    status = moveTo(target, "absolute+exact");
    mState.update([](PlayerState::Values& v) { v.seeking = false; });
    if (status == android::NO_ERROR) mNotifier.post(android::MEDIA_SEEK_COMPLETE);
    return status;
}

status_t Seeker::refresh() {
    const bool seekable = mState.read([](const PlayerState::Values& v) { return v.seekable; });
    if (!seekable) return android::NO_ERROR;
    return runAndAwait("refresh", [this] { return mMpv.seek(0, "relative+exact"); });
}

status_t Seeker::runAndAwait(const char* operation, const std::function<int()>& command) {
    uint64_t session = 0;
    status_t status = begin(operation, session);
    if (status != android::NO_ERROR) return status;
    status = await(operation, session, command);
    mState.update([](PlayerState::Values& v) { v.seeking = false; });
    return status;
}

// Waits for its turn. NO_ERROR makes the caller the one that seeks.
status_t Seeker::begin(const char* operation, uint64_t& session) {
    const status_t open = mState.requireOpen(operation);
    if (open != android::NO_ERROR) return open;
    mState.wait(kSeekLimit, [](const PlayerState::Values& v) { return !v.seeking || !v.isOpen(); });
    bool seekable = true;
    const bool begun = mState.update([&](PlayerState::Values& v) {
        seekable = v.seekable;
        session = v.session;
        if (v.seeking || !v.isOpen() || !seekable) return false;
        v.seeking = true;
        return true;
    });
    if (begun) return android::NO_ERROR;
    if (!seekable) mNotifier.post(android::MEDIA_INFO, android::MEDIA_INFO_NOT_SEEKABLE);
    return failed(android::INVALID_OPERATION, operation,
                  seekable ? "ended by another operation" : "the media cannot seek");
}

status_t Seeker::seekAs(int mode, double target) {
    switch (mode) {
        case SeekMode::SEEK_NEXT_SYNC:
            return seekToNextSync(target);
        case SeekMode::SEEK_CLOSEST_SYNC:
            return seekToClosestSync(target);
        case SeekMode::SEEK_CLOSEST:
            return moveTo(target, "absolute+exact");
        default:
            return moveTo(target, "absolute+keyframes");
    }
}

// The core has a seek to the key frame before a time, and one to the key frame
// after a distance from here.
status_t Seeker::seekToNextSync(double target) {
    const status_t status = moveTo(target, "absolute+keyframes");
    const double distance = target - position();
    if (status != android::NO_ERROR || distance < kSameFrame) return status;
    return moveTo(distance, "relative+keyframes");
}

status_t Seeker::seekToClosestSync(double target) {
    status_t status = moveTo(target, "absolute+keyframes");
    const double previous = position();
    if (status != android::NO_ERROR || target - previous < kSameFrame) return status;
    status = moveTo(target - previous, "relative+keyframes");
    const double next = position();
    if (status != android::NO_ERROR || next - target <= target - previous) return status;
    return moveTo(previous, "absolute+keyframes");
}

status_t Seeker::moveTo(double target, const char* flags) {
    const uint64_t session = mState.read([](const PlayerState::Values& v) { return v.session; });
    return await("seekTo", session, [&] { return mMpv.seek(target, flags); });
}

status_t Seeker::await(const char* operation, uint64_t session,
                       const std::function<int()>& command) {
    const auto before = mState.update([](PlayerState::Values& v) {
        // What is sought from the end is no longer complete.
        if (v.phase == Phase::Completed) v.phase = Phase::Paused;
        return v;
    });
    const int error = command();
    if (error < 0) return failed(android::INVALID_OPERATION, operation, mpv_error_string(error));
    const auto overtaken = [session](const PlayerState::Values& v) {
        return v.session != session || !v.isOpen();
    };
    const bool inTime = mState.wait(kSeekLimit, [&](const PlayerState::Values& v) {
        return overtaken(v) || (v.seeks > before.seeks && v.restarts > before.restarts);
    });
    if (!inTime) return failed(android::TIMED_OUT, operation, "the position is not reached");
    if (mState.read(overtaken)) {
        return failed(android::INVALID_OPERATION, operation, "ended by another operation");
    }
    const double now = position();
    mState.update([now](PlayerState::Values& v) { v.position = now; });
    return android::NO_ERROR;
}

double Seeker::position() const {
    const double last = mState.read([](const PlayerState::Values& v) { return v.position; });
    return std::max(mMpv.getDouble("time-pos").value_or(last), 0.0);
}

}  // namespace orvtarn
