// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>

#include <atomic>
#include <functional>
#include <thread>

#include "core/FrameTiming.h"
#include "core/MpvHandle.h"
#include "core/Notifier.h"
#include "core/OpenMedia.h"
#include "core/PlayerState.h"
#include "core/VideoOutput.h"

namespace orvtarn {

// The only thread that waits for mpv's events. Keeps the player's state
// by them and delivers its changes to the listener.
class EventLoop {
public:
    EventLoop(MpvHandle& mpv, PlayerState& state, VideoOutput& video, Notifier& notifier,
              OpenMedia& media, FrameTiming& frames)
        : mMpv(mpv),
          mState(state),
          mVideo(video),
          mNotifier(notifier),
          mMedia(media),
          mFrames(frames) {}
    ~EventLoop() { stop(); }

    bool start();
    // Before mpv goes.
    void stop();

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
    // Runs a command that makes mpv seek and does not wait: other seeks do, until it
    // has arrived. False when another one is under way or mpv refuses it. Any thread.
    bool seekUnattended(const std::function<int()>& command);
    // Looks whether mpv is at an end, as an operation may find it there,
    // or have kept it from being noticed. Any thread; does not wait.
    void lookForEnd();

private:
    // How far mpv has come with drawing the first picture anew.
    enum class Redraw { None, Asked, Accepted, Begun };

    void run();
    void handle(const mpv_event& event);
    void onHook(const mpv_event_hook& hook);
    void onLoaded();
    void onLogMessage(const mpv_event_log_message& message);
    void onRestart();
    bool drawsAnew();
    void onRedrawAnswered(int error);
    void endUnattendedSeek();
    void reportSilence();
    void onProperty(const mpv_event_property& property);
    void onTime(double seconds);
    void onBuffering(bool buffering);
    void onBuffered(double seconds);
    void onVideoSize();
    void becomePreparedIfReady();
    void onSeek();

    MpvHandle& mMpv;
    PlayerState& mState;
    VideoOutput& mVideo;
    Notifier& mNotifier;
    OpenMedia& mMedia;
    FrameTiming& mFrames;
    std::function<void()> mOpenedHandler;
    std::function<bool()> mPictureHandler;
    bool mSilenceReported = false;  // on the event thread
    Redraw mRedraw = Redraw::None;  // on the event thread
    std::atomic<bool> mQuit{false};
    std::thread mThread;
};

}  // namespace orvtarn
