// SPDX-License-Identifier: Apache-2.0
#include "playback/Seeker.h"

#include <media/MediaPlayerInterface.h>
#include <media/MediaTrack.h>

#include <algorithm>
#include <chrono>
#include <string>

#include "base/EngineLog.h"

namespace orvtarn {
namespace {

using SeekMode = android::MediaTrack::ReadOptions::SeekMode;
using android::status_t;
using std::chrono::seconds;

constexpr seconds kSeekLimit{10};
// Positions closer than this are the same frame's.
constexpr double kSameFrame = 0.001;
// An exact seek ends at the next frame at the latest, usually.
constexpr double kLate = 0.1;

// How far ahead of a key frame mpv asks for it, in seconds.
constexpr double kRunUp = 0.5;

constexpr char kExact[] = "absolute+exact";
constexpr char kKeyFrame[] = "absolute+keyframes";
constexpr char kForward[] = "relative+keyframes";

bool isSeekMode(int mode) {
    return mode >= SeekMode::SEEK_PREVIOUS_SYNC && mode <= SeekMode::SEEK_CLOSEST;
}

}  // namespace

status_t Seeker::seekTo(int msec, int mode) {
    if (!isSeekMode(mode)) return failed(android::BAD_VALUE, "seekTo", "no such seek mode");
    const double duration = mState.read([](const PlayerState::Values& v) { return v.duration; });
    double target = std::max(msec, 0) / 1000.0;
    if (duration > 0) target = std::min(target, duration);
    return announced(
        inTurn("seekTo", Kind::Seek, [&](const Turn& turn) { return seekAs(mode, target, turn); }));
}

status_t Seeker::seekToTime(const char* operation, double target) {
    return announced(showFrame(operation, target));
}

status_t Seeker::showFrame(const char* operation, double target) {
    return inTurn(operation, Kind::Seek,
                  [&](const Turn& turn) { return moveTo(target, kExact, turn); });
}

status_t Seeker::refresh() {
    const bool wanted = mState.read(
        [](const PlayerState::Values& v) { return v.seekable && v.phase != Phase::Completed; });
    if (!wanted) return android::NO_ERROR;
    return inTurn("refresh", Kind::Seek,
                  [this](const Turn& turn) { return moveTo(position(), kExact, turn); });
}

status_t Seeker::runAndAwait(const char* operation, const std::function<int()>& command) {
    return inTurn(operation, Kind::Seek,
                  [&](const Turn& turn) { return await(operation, turn, command); });
}

status_t Seeker::setDirection(const char* operation, bool backward) {
    const auto turn = [&] { return mMpv.setBackward(backward); };
    return inTurn(operation, Kind::SeekInPlace,
                  [&](const Turn& t) { return await(operation, t, turn); });
}

status_t Seeker::runAlone(const char* operation, const std::function<bool()>& move) {
    return inTurn(operation, Kind::Move, [&](const Turn&) {
        return move() ? android::NO_ERROR : android::INVALID_OPERATION;
    });
}

status_t Seeker::announced(status_t status) {
    if (status == android::NO_ERROR) mNotifier.post(android::MEDIA_SEEK_COMPLETE);
    return status;
}

status_t Seeker::inTurn(const char* operation, Kind kind, const Task& task) {
    const status_t open = mState.requireOpen(operation);
    if (open != android::NO_ERROR) return open;
    const Turn turn = {mState.read([](const PlayerState::Values& v) { return v.session; }),
                       std::chrono::steady_clock::now() + kSeekLimit};
    status_t status = begin(operation, kind, turn);
    if (status != android::NO_ERROR) return status;
    mTransport.setSeeking(true);
    status = task(turn);
    mTransport.setSeeking(false);
    mState.update([](PlayerState::Values& v) { v.seeking = v.attended = false; });
    mEvents.lookForEnd();
    return status;
}

// Waits for its turn. NO_ERROR makes the caller the one that seeks.
status_t Seeker::begin(const char* operation, Kind kind, const Turn& turn) {
    bool possible = true;
    bool begun = false;
    // The turn is taken inside the wait: of two that wake up, one waits on.
    const bool inTime = mState.waitUntil(turn.deadline, [&](PlayerState::Values& v) {
        if (v.session != turn.session || !v.isOpen()) return true;
        possible = v.seekable || kind == Kind::Move;
        if (!possible) return true;
        begun = !v.seeking;
        if (!begun) return false;
        v.seeking = v.attended = true;
        // What is sought from the end is no longer complete.
        if (kind == Kind::Seek && v.phase == Phase::Completed) v.phase = Phase::Paused;
        return true;
    });
    if (begun) return android::NO_ERROR;
    if (!inTime) {
        // One that nobody attends to and that does not arrive is given up.
        mState.update([](PlayerState::Values& v) { v.seeking = v.attended; });
        return failed(android::TIMED_OUT, operation, "another seek does not end");
    }
    if (!possible) mNotifier.post(android::MEDIA_INFO, android::MEDIA_INFO_NOT_SEEKABLE);
    return failed(android::INVALID_OPERATION, operation,
                  possible ? "ended by another operation" : "the media cannot seek");
}

status_t Seeker::seekAs(int mode, double target, const Turn& turn) {
    switch (mode) {
        case SeekMode::SEEK_NEXT_SYNC:
            return seekToNextSync(target, turn);
        case SeekMode::SEEK_CLOSEST_SYNC:
            return seekToClosestSync(target, turn);
        case SeekMode::SEEK_CLOSEST:
            return moveTo(target, kExact, turn);
        default:
            return moveTo(target, kKeyFrame, turn);
    }
}

// mpv has a seek to the key frame before a time, and one to the key frame
// after a distance from here.
status_t Seeker::seekToNextSync(double target, const Turn& turn) {
    const status_t status = moveTo(target, kKeyFrame, turn);
    const double distance = target - position();
    if (status != android::NO_ERROR || distance < kSameFrame) return status;
    return moveTo(distance, kForward, turn);
}

status_t Seeker::seekToClosestSync(double target, const Turn& turn) {
    status_t status = moveTo(target, kKeyFrame, turn);
    const double previous = position();
    if (status != android::NO_ERROR || target - previous < kSameFrame) return status;
    status = moveTo(target - previous, kForward, turn);
    const double next = position();
    if (status != android::NO_ERROR || next - target <= target - previous) return status;
    return moveTo(previous, kKeyFrame, turn);
}

// A seek that comes right behind one of mpv's own, as when a track was
// chosen, may lose its key frame and arrive at the next one: it is repeated.
status_t Seeker::moveTo(double target, const char* flags, const Turn& turn) {
    const bool isForward = flags == kForward;
    const std::optional<double> key = isForward ? std::nullopt : keyFrameWithoutIndex(target);
    if (key) return moveFrom(*key, flags == kKeyFrame ? *key : target, turn);
    const auto seek = [&] { return mMpv.seek(target, flags); };
    const status_t status = await("seekTo", turn, seek);
    const bool late = !isForward && position() > target + kLate;
    return status == android::NO_ERROR && late ? await("seekTo", turn, seek) : status;
}

// To a time, decoding from a key frame that is known. In formats without an index
// mpv itself gets to the first key frame after the time that it asks for.
status_t Seeker::moveFrom(double key, double target, const Turn& turn) {
    const double usual = mMpv.getDouble("hr-seek-demuxer-offset").value_or(0);
    mMpv.set("hr-seek-demuxer-offset", target - key + kRunUp);
    const status_t status = await("seekTo", turn, [&] { return mMpv.seek(target, kExact); });
    mMpv.set("hr-seek-demuxer-offset", usual);
    return status;
}

// Nothing in formats that have an index.
std::optional<double> Seeker::keyFrameWithoutIndex(double target) const {
    const std::string format = mMpv.getString("file-format").value_or("");
    const bool isGuessed = format == "mpegts" || format == "mpeg";
    return isGuessed && mKeyFrameBefore ? mKeyFrameBefore(target) : std::nullopt;
}

status_t Seeker::await(const char* operation, const Turn& turn,
                       const std::function<int()>& command) {
    mState.update([](PlayerState::Values& v) { v.beginSeek(); });
    const int error = command();
    if (error < 0) return failed(android::INVALID_OPERATION, operation, mpv_error_string(error));
    const auto overtaken = [&turn](const PlayerState::Values& v) {
        return v.session != turn.session || !v.isOpen();
    };
    const bool inTime = mState.waitUntil(turn.deadline, [&](const PlayerState::Values& v) {
        return overtaken(v) || !v.isArriving();
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
