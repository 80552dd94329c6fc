// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>
#include <stdint.h>
#include <utils/Errors.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "core/MpvHandle.h"
#include "core/Notifier.h"
#include "core/PlayerState.h"
#include "core/ReadTrouble.h"
#include "core/SilenceWatch.h"
#include "source/FailureCause.h"
#include "source/MediaSource.h"

namespace orvtarn {

// The media that mpv opens, plays and ends: where their bytes come from, what goes
// wrong with reading them, and whether they were played to their end, broke off or
// never opened. Used on the thread of mpv's events, but for what says otherwise.
class OpenMedia {
public:
    OpenMedia(MpvHandle& mpv, PlayerState& state, Notifier& notifier)
        : mMpv(mpv), mState(state), mNotifier(notifier) {}

    // Called when mpv has come to an end; true when playback is completed by it.
    void setEndHandler(std::function<bool()> handler) { mEndHandler = std::move(handler); }
    // Whose read errors count for the media being played. Any thread.
    void setSource(std::shared_ptr<MediaSource> source);
    // Ends what goes on in the background; no thread of events is left.
    void stop() { mCause.stop(); }

    // What mpv reports, in its order.
    void onStart();
    void onBeforeOpening();
    void onOpened();
    void onLoaded();
    void onLogLine(const char* writer, const std::string& line);
    void onEndReached(bool reached) { mEndReached = reached; }
    void onEndFile(const mpv_event_end_file& end);
    // Nothing of what was opened can be played.
    void onNothingToPlay();

    // Has the next settling look whether mpv is at the end. Any thread.
    void lookForEnd() { mLooksForEnd = true; }
    // Delivers an end or failure that was reported. All that mpv has logged about it
    // is known by now.
    void settle();
    // Asks a server of which nothing has come for long whether it is there, and fails
    // the media when it gives no answer.
    void watchServer();
    // Seconds until that is worthwhile, -1 for ever.
    double patience() const { return mSilence.remaining(std::chrono::steady_clock::now()); }
    // What mpv says of the duration, or the source where mpv only guesses. Seconds.
    double durationOf(double byMpv) const;

private:
    void onLoadFailed(android::status_t status);
    void findCause(android::status_t status);
    void onEnd();
    bool goesOn();
    bool brokeOff() const;
    bool isSilenceGood() const;
    bool endsEarly() const;
    android::status_t causeOfBreak() const;
    bool sourceFailed() const;
    int64_t reached() const;
    uint64_t session() const;
    void failIn(uint64_t session, android::status_t status);
    std::shared_ptr<MediaSource> source() const;

    MpvHandle& mMpv;
    PlayerState& mState;
    Notifier& mNotifier;
    std::function<bool()> mEndHandler;
    mutable std::mutex mSourceMutex;
    std::shared_ptr<MediaSource> mSource;
    std::string mOpening;  // the name that mpv opens
    bool mHasTracks = false;
    int64_t mFileSize = 0;  // bytes, 0 when unknown
    ReadTrouble mTrouble;
    bool mMissedLines = false;  // which may have been about these media
    SilenceWatch mSilence;
    FailureCause mCause;
    // An end that waits for the log lines about its cause.
    bool mEndReached = false;
    double mWentOnFrom = -1;    // the position, seconds
    uint64_t mSeeksBefore = 0;  // that
    std::atomic<bool> mLooksForEnd{false};
    std::optional<android::status_t> mLoadFailed;
    uint64_t mFailedSession = 0;
};

}  // namespace orvtarn
