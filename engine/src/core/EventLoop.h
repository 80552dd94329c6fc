// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>
#include <utils/Errors.h>

#include <atomic>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>

#include "core/FrameClock.h"
#include "core/MpvHandle.h"
#include "core/Notifier.h"
#include "core/PlayerState.h"
#include "core/ReadTrouble.h"
#include "core/VideoOutput.h"
#include "source/FailureCause.h"
#include "source/MediaSource.h"

namespace orvtarn {

// The only thread that waits for mpv's events. Keeps the player's state
// by them and delivers its changes to the listener.
class EventLoop {
public:
    EventLoop(MpvHandle& mpv, PlayerState& state, VideoOutput& video, Notifier& notifier)
        : mMpv(mpv), mState(state), mVideo(video), mNotifier(notifier) {}
    ~EventLoop() { stop(); }

    bool start();
    // Before mpv goes.
    void stop();

    // Whose read errors count for the media being played.
    void setSource(std::shared_ptr<MediaSource> source);
    // Called when mpv has come to an end, on the loop's thread; true when
    // playback is completed by it.
    void setEndHandler(std::function<bool()> handler) { mEndHandler = std::move(handler); }
    // Called when media are opened and their tracks are about to be chosen, on the
    // loop's thread; the load goes on when it returns.
    void setOpenedHandler(std::function<void()> handler) { mOpenedHandler = std::move(handler); }
    // Called when the first picture of the media was decoded, and when pictures of
    // another kind come, on the loop's thread; true when mpv is to begin the picture anew.
    void setPictureHandler(std::function<bool()> handler) { mPictureHandler = std::move(handler); }
    // A new picture was drawn, or had no surface to go to.
    void onFrame();
    // Brings mpv in line with the state's looping. Any thread.
    void applyLooping();
    // The media time of the frame of that number as far as the frames before lead to
    // it, in microseconds. mpv is asked for it on the loop's thread, which gives
    // the answer to the video output. Does not wait.
    std::optional<int64_t> frameTime(uint64_t frame, int64_t due);
    // How fast the media plays from now on, 1 for normal, negative for backward.
    void setSpeed(double speed) { mFrameClock.setSpeed(speed); }
    // Runs a command that makes mpv seek and does not wait: other seeks do, until it
    // has arrived. False when another one is under way or mpv refuses it. Any thread.
    bool seekUnattended(const std::function<int()>& command);
    // Looks whether mpv is at an end, as an operation may find it there,
    // or have kept it from being noticed. Any thread; does not wait.
    void lookForEnd();

private:
    void run();
    void handle(const mpv_event& event);
    void onHook(const mpv_event_hook& hook);
    void onLoaded();
    void onBeforeOpening();
    void onLogMessage(const mpv_event_log_message& message);
    void onEndFile(const mpv_event_end_file& end);
    void settleEnd();
    void onLoadFailed(android::status_t status);
    void findCause(android::status_t status);
    void onRestart();
    bool drawsAnew();
    void endUnattendedSeek();
    void reportSilence();
    void onProperty(const mpv_event_property& property);
    void onTime(double seconds);
    void onBuffering(bool buffering);
    void onBuffered(double seconds);
    void onEndReached();
    void onVideoSize();
    void becomePreparedIfReady();
    void answerFrameTime();
    void setFrameTime(uint64_t frame, double seconds);
    void onSeek();
    void failWith(android::status_t status);
    void failIn(uint64_t session, android::status_t status);
    std::shared_ptr<MediaSource> source();
    double durationOf(double byMpv);
    bool brokeOff();
    bool endsEarly();
    android::status_t causeOfBreak();
    bool sourceFailed();

    MpvHandle& mMpv;
    PlayerState& mState;
    VideoOutput& mVideo;
    Notifier& mNotifier;
    std::function<bool()> mEndHandler;
    std::function<void()> mOpenedHandler;
    std::function<bool()> mPictureHandler;
    int64_t mFileSize = 0;  // bytes, 0 when unknown
    bool mHasTracks = false;
    std::string mOpening;  // the name that mpv opens
    ReadTrouble mTrouble;
    FailureCause mCause;
    // An end that waits for the log lines about its cause.
    bool mEndReached = false;
    std::optional<android::status_t> mLoadFailed;
    uint64_t mFailedSession = 0;
    std::mutex mSourceMutex;
    std::shared_ptr<MediaSource> mSource;
    bool mSilenceReported = false;  // on the event thread
    std::atomic<bool> mLooksForEnd{false};
    FrameClock mFrameClock;
    std::atomic<uint64_t> mUntimedFrame{0};  // 0 for none
    std::atomic<bool> mQuit{false};
    std::thread mThread;
};

}  // namespace orvtarn
