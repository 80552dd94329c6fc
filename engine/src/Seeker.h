// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>

#include <functional>

#include "MpvHandle.h"
#include "Notifier.h"
#include "PlayerState.h"

namespace orvtarn {

// Moves the position and waits until the core has arrived there. One seek at a
// time: the core answers several at once with one event.
class Seeker {
public:
    Seeker(MpvHandle& mpv, PlayerState& state, Notifier& notifier)
        : mMpv(mpv), mState(state), mNotifier(notifier) {}

    // mode: a MediaTrack::ReadOptions::SeekMode. Times outside of the media are
    // taken as its start or end.
    android::status_t seekTo(int msec, int mode);
    // To the frame at that time, telling the listener.
    android::status_t seekToTime(const char* operation, double seconds);
    // Shows the current frame anew, with subtitles as they are chosen now.
    // Media that cannot seek or are at their end are left alone.
    android::status_t refresh();
    // Runs a command that makes the core seek, and waits for its arrival.
    android::status_t runAndAwait(const char* operation, const std::function<int()>& command);

private:
    // Runs a task as the only one that seeks; it gets the session it began in.
    android::status_t inTurn(const char* operation,
                             const std::function<android::status_t(uint64_t)>& task);
    android::status_t begin(const char* operation, uint64_t& session);
    android::status_t told(android::status_t status);
    android::status_t seekAs(int mode, double seconds, uint64_t session);
    android::status_t seekToNextSync(double seconds, uint64_t session);
    android::status_t seekToClosestSync(double seconds, uint64_t session);
    android::status_t moveTo(double seconds, const char* flags, uint64_t session);
    android::status_t await(const char* operation, uint64_t session,
                            const std::function<int()>& command);
    double position() const;

    MpvHandle& mMpv;
    PlayerState& mState;
    Notifier& mNotifier;
};

}  // namespace orvtarn
