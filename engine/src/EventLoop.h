// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>
#include <utils/Errors.h>

#include <atomic>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>

#include "MediaSource.h"
#include "MpvHandle.h"
#include "Notifier.h"
#include "PlayerState.h"
#include "VideoOutput.h"

namespace orvtarn {

// The only thread that waits for the core's events. Keeps the player's state
// by them and tells the listener.
class EventLoop {
public:
    EventLoop(MpvHandle& mpv, PlayerState& state, VideoOutput& video, Notifier& notifier)
        : mMpv(mpv), mState(state), mVideo(video), mNotifier(notifier) {}
    ~EventLoop() { stop(); }

    bool start();
    // Before the core goes.
    void stop();

    // Whose read errors count for the media being played.
    void setSource(std::shared_ptr<MediaSource> source);
    // Called at the end of the media, on the loop's thread; true when it went
    // on instead (as rewinding does at the start).
    void setEndHandler(std::function<bool()> handler) { mEndHandler = std::move(handler); }
    // Called when media are opened and their tracks are about to be chosen, on the
    // loop's thread; the load goes on when it returns.
    void setOpenedHandler(std::function<void()> handler) { mOpenedHandler = std::move(handler); }
    // A new picture was drawn, or had no surface to go to.
    void onFrame();

private:
    void run();
    void handle(const mpv_event& event);
    void onOpened(const mpv_event_hook& hook);
    void onLoaded();
    void onEndFile(const mpv_event_end_file& end);
    void onRestart();
    void onProperty(const mpv_event_property& property);
    void onTime(double seconds);
    void onBuffering(bool buffering);
    void onBuffered(double seconds);
    void onEndReached();
    void onVideoSize();
    void becomePreparedIfReady();
    void failWith(android::status_t status);
    std::shared_ptr<MediaSource> source();
    double durationOf(double core);
    bool brokeOff();
    bool sourceFailed();

    MpvHandle& mMpv;
    PlayerState& mState;
    VideoOutput& mVideo;
    Notifier& mNotifier;
    std::function<bool()> mEndHandler;
    std::function<void()> mOpenedHandler;
    int64_t mFileSize = 0;  // bytes, 0 when unknown
    std::mutex mSourceMutex;
    std::shared_ptr<MediaSource> mSource;
    std::atomic<bool> mQuit{false};
    std::thread mThread;
};

}  // namespace orvtarn
