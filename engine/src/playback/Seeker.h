// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>

#include <chrono>
#include <functional>
#include <optional>
#include <utility>

#include "core/EventLoop.h"
#include "core/MpvHandle.h"
#include "core/Notifier.h"
#include "core/PlayerState.h"
#include "playback/Transport.h"

namespace orvtarn {

// Moves the position and waits until mpv has arrived there, ten seconds at
// most with all that it takes. One seek at a time: mpv answers several at
// once with one event.
class Seeker {
public:
    Seeker(MpvHandle& mpv, PlayerState& state, Notifier& notifier, EventLoop& events,
           Transport& transport)
        : mMpv(mpv), mState(state), mNotifier(notifier), mEvents(events), mTransport(transport) {}

    // Finds the last key frame at or before a time, in seconds, in media of which
    // mpv cannot; nothing where that cannot be known. Before the first seek.
    using KeyFrameBefore = std::function<std::optional<double>(double seconds)>;
    void setKeyFrameBefore(KeyFrameBefore find) { mKeyFrameBefore = std::move(find); }

    // mode: a MediaTrack::ReadOptions::SeekMode. Times outside of the media are
    // taken as its start or end.
    android::status_t seekTo(int msec, int mode);
    // To the frame at that time, telling the listener.
    android::status_t seekToTime(const char* operation, double seconds);
    // The same without a word to the listener.
    android::status_t showFrame(const char* operation, double seconds);
    // Shows the current frame anew, with subtitles as they are chosen now.
    // Media that cannot seek or are at their end are left alone.
    android::status_t refresh();
    // Runs a command that makes mpv seek, and waits for its arrival.
    android::status_t runAndAwait(const char* operation, const std::function<int()>& command);
    // Has mpv play in that direction from now on; it seeks for that. Media at
    // their end stay there.
    android::status_t setDirection(const char* operation, bool backward);
    // Runs what moves the position without a seek, while nobody seeks.
    android::status_t runAlone(const char* operation, const std::function<bool()>& move);

private:
    // What one operation has: the session that it began in, and its time.
    struct Turn {
        uint64_t session;
        std::chrono::steady_clock::time_point deadline;
    };
    using Task = std::function<android::status_t(const Turn&)>;
    // What an operation asks of the media, and does to them.
    enum class Kind { Seek, SeekInPlace, Move };

    // Runs a task as the only one that seeks.
    android::status_t inTurn(const char* operation, Kind kind, const Task& task);
    android::status_t begin(const char* operation, Kind kind, const Turn& turn);
    android::status_t announced(android::status_t status);
    void leaveEnd();
    android::status_t seekAs(int mode, double seconds, const Turn& turn);
    android::status_t seekToNextSync(double seconds, const Turn& turn);
    android::status_t seekToClosestSync(double seconds, const Turn& turn);
    android::status_t moveTo(double seconds, const char* flags, const Turn& turn);
    android::status_t moveFrom(double key, double seconds, const Turn& turn);
    std::optional<double> keyFrameWithoutIndex(double seconds) const;
    android::status_t await(const char* operation, const Turn& turn,
                            const std::function<int()>& command);
    double position() const;

    MpvHandle& mMpv;
    PlayerState& mState;
    Notifier& mNotifier;
    EventLoop& mEvents;
    Transport& mTransport;
    KeyFrameBefore mKeyFrameBefore;
};

}  // namespace orvtarn
