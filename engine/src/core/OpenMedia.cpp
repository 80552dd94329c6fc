// SPDX-License-Identifier: Apache-2.0
#include "core/OpenMedia.h"

#include <media/MediaPlayerInterface.h>
#include <orvtarn/PlayerTypes.h>

#include <chrono>
#include <cmath>
#include <utility>

#include "base/EngineLog.h"
#include "core/MpvError.h"
#include "source/UrlScheme.h"

namespace orvtarn {
namespace {

// Tracks of one file may end at different times. Seconds.
constexpr double kEndSlack = 1.5;
// What was read and not played of one track when the others have come to their end is less.
// Seconds.
constexpr double kAhead = 0.5;

}  // namespace

void OpenMedia::setSource(std::shared_ptr<MediaSource> source) {
    std::lock_guard<std::mutex> lock(mSourceMutex);
    mSource = std::move(source);
}

void OpenMedia::onStart() {
    if (mLoadFailed) settle();
    mTrouble.forget();
    mWentOnFrom = -1;
    mMissedLines = false;
}

// With several players nobody can say whose media a line of FFmpeg's is about.
void OpenMedia::onLogLine(const char* writer, const std::string& line) {
    if (!SharedLog::isOfFfmpeg(writer) || mMpv.ownsLog()) {
        mTrouble.note(line);
    } else {
        mMissedLines = true;
    }
}

void OpenMedia::onBeforeOpening() {
    // Of a playlist, the first entry is the media: mpv would go on to the
    // others, and even when the first fails.
    mMpv.command({"playlist-clear"});
    mHasTracks = false;
    mOpening = mMpv.getString("stream-open-filename").value_or("");
    const std::shared_ptr<MediaSource> media = source();
    if (media == nullptr) return;
    const android::status_t status = checkReference(*media, mOpening);
    if (status == android::NO_ERROR) return;
    failIn(session(), status);
    mMpv.command({"stop"});
}

void OpenMedia::onOpened() { mHasTracks = mMpv.getInt("track-list/count").value_or(0) > 0; }

// A connection that breaks loses the size.
void OpenMedia::onLoaded() { mFileSize = mMpv.getInt("file-size").value_or(0); }

void OpenMedia::onEndFile(const mpv_event_end_file& end) {
    const bool isPlaylist = end.reason == MPV_END_FILE_REASON_REDIRECT;
    if (isPlaylist && end.playlist_insert_num_entries > 0) return;
    const bool isError = end.reason == MPV_END_FILE_REASON_ERROR;
    const bool isEnd = isPlaylist || end.reason == MPV_END_FILE_REASON_EOF;
    if (isError || isEnd) mLoadFailed = isError ? statusOfMpvError(end.error) : ORV_ERROR_MALFORMED;
    mFailedSession = mState.update([](PlayerState::Values& v) {
        v.fileOpen = false;
        return v.session;
    });
}

void OpenMedia::onNothingToPlay() {
    mFailedSession = session();
    mLoadFailed = ORV_ERROR_MALFORMED;
}

void OpenMedia::settle() {
    if (mLooksForEnd.exchange(false)) mEndReached = true;
    if (mLoadFailed) onLoadFailed(*mLoadFailed);
    if (mEndReached && !mLoadFailed) onEnd();
    mLoadFailed.reset();
    mEndReached = false;
}

void OpenMedia::onLoadFailed(android::status_t status) {
    if (sourceFailed()) return failIn(mFailedSession, ORV_ERROR_IO);
    // What they were opened with was known; what is inside was not.
    if (status == ORV_ERROR_UNSUPPORTED && !mHasTracks) status = ORV_ERROR_MALFORMED;
    if (!FailureCause::isVague(status)) return failIn(mFailedSession, status);
    if (mTrouble.status() != android::NO_ERROR && mTrouble.status() != ORV_ERROR_CONNECTION_LOST) {
        return failIn(mFailedSession, mTrouble.status());
    }
    findCause(status);
}

void OpenMedia::findCause(android::status_t status) {
    const std::shared_ptr<MediaSource> media = source();
    const uint64_t session = mFailedSession;
    if (media == nullptr) return failIn(session, status);
    mCause.find(media, mOpening, status,
                [this, session](android::status_t cause) { failIn(session, cause); });
}

void OpenMedia::watchServer() {
    const std::shared_ptr<MediaSource> media = source();
    const bool waits = mState.read([](const PlayerState::Values& v) { return v.awaitsData(); });
    if (media == nullptr || !waits || !isOpenedScheme(schemeOf(mOpening))) return mSilence.stop();
    if (!mSilence.isDue(reached(), std::chrono::steady_clock::now())) return;
    const uint64_t session = this->session();
    mCause.find(media, mOpening, ORV_ERROR_IO, [this, session](android::status_t cause) {
        // Otherwise mpv gets through to it again, or reports why not.
        if (cause == ORV_ERROR_NO_ANSWER) failIn(session, cause);
    });
}

// Changes while data come.
int64_t OpenMedia::reached() const {
    const double until = mMpv.getDouble("demuxer-cache-time").value_or(0);
    return mMpv.getInt("stream-pos").value_or(0) + std::llround(until * 1e6);
}

void OpenMedia::onEnd() {
    // The report may be older than a seek away from the end.
    if (!mMpv.getFlag("eof-reached").value_or(false) || goesOn()) return;
    if (brokeOff()) {
        mMpv.set("pause", true);
        return failIn(session(), causeOfBreak());
    }
    // A seek may pass the end on its way; it has the end looked for when done.
    if (mState.read([](const PlayerState::Values& v) { return v.seeking; })) return;
    if (mEndHandler()) mNotifier.post(android::MEDIA_PLAYBACK_COMPLETE);
}

// mpv stands at the end of a section that was repeated until just now, which is like the
// end of the media to it: a seek has it play what follows. Where that seek itself led to
// no later end, another would not either.
bool OpenMedia::goesOn() {
    const double position = mMpv.getDouble("time-pos").value_or(mWentOnFrom);
    const double ahead = mMpv.getDouble("demuxer-cache-duration").value_or(0);
    if (!endsEarly() || ahead < kAhead || mState.phase() != Phase::Started) return false;
    const uint64_t seeks = mState.read([](const PlayerState::Values& v) { return v.seeks; });
    if (position <= mWentOnFrom && seeks <= mSeeksBefore + 1) return false;
    mWentOnFrom = position;
    mSeeksBefore = seeks;
    return mMpv.seek(position, "absolute+exact") >= 0;
}

// Whether the media came to an end because nobody gives their bytes any more.
bool OpenMedia::brokeOff() const {
    const std::shared_ptr<MediaSource> media = source();
    if (media == nullptr) return false;
    if (media->isOfBytes()) return media->readFailed();
    if (schemeOf(mOpening).empty() || !endsEarly()) return false;
    if (mTrouble.status() != android::NO_ERROR) return true;
    const int64_t position = mMpv.getInt("stream-pos").value_or(mFileSize);
    return !isSilenceGood() && (mFileSize <= 0 || position < mFileSize);
}

// Whether media about which nothing was logged are whole although bytes are left: an
// index may follow them, and a repeated section ends with bytes still to come. Of a
// connection that cannot be taken up again, nothing is logged.
bool OpenMedia::isSilenceGood() const {
    const bool seekable = mState.read([](const PlayerState::Values& v) { return v.seekable; });
    const bool knowsAll = mMpv.ownsLog() && !mMissedLines;
    return seekable && (knowsAll || !mMpv.getFlag("demuxer-cache-idle").value_or(true));
}

// The shown time is clearly before the end that the media name.
bool OpenMedia::endsEarly() const {
    if (mMpv.isBackward()) return false;
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    const double position = mMpv.getDouble("time-pos").value_or(now.position);
    // A stream without a length ends when its connection does.
    if (now.duration <= 0) return mFileSize > 0;
    return position < now.duration - kEndSlack;
}

android::status_t OpenMedia::causeOfBreak() const {
    if (sourceFailed()) return ORV_ERROR_IO;
    return mTrouble.status() != android::NO_ERROR ? mTrouble.status() : ORV_ERROR_CONNECTION_LOST;
}

bool OpenMedia::sourceFailed() const {
    const std::shared_ptr<MediaSource> media = source();
    return media != nullptr && media->readFailed();
}

// Of media without a length mpv only reports how far they have been read.
double OpenMedia::durationOf(double byMpv) const {
    const std::shared_ptr<MediaSource> media = source();
    const int64_t known = media != nullptr ? media->knownDuration() : 0;
    const bool isGuess = byMpv <= 0 || mMpv.getInt("file-size").value_or(0) <= 0;
    return isGuess && known > 0 ? static_cast<double>(known) / 1000 : byMpv;
}

uint64_t OpenMedia::session() const {
    return mState.read([](const PlayerState::Values& v) { return v.session; });
}

// Any thread. A load that was overtaken meanwhile fails nothing.
void OpenMedia::failIn(uint64_t session, android::status_t status) {
    const bool news = mState.update(
        [&](PlayerState::Values& v) { return v.session == session && v.fail(status); });
    if (!news) return;
    ALOGE("playback: ended by an error (status %d)", status);
    mNotifier.post(android::MEDIA_ERROR, android::MEDIA_ERROR_UNKNOWN, status);
}

std::shared_ptr<MediaSource> OpenMedia::source() const {
    std::lock_guard<std::mutex> lock(mSourceMutex);
    return mSource;
}

}  // namespace orvtarn
