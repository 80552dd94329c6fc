// SPDX-License-Identifier: Apache-2.0
#include "core/EventLoop.h"

#include <media/MediaPlayerInterface.h>
#include <string.h>

#include <algorithm>
#include <cmath>
#include <string>
#include <utility>

#include "base/EngineLog.h"
#include "base/ThreadName.h"
#include "core/AudioOutputs.h"

namespace orvtarn {
namespace {

enum ObservedProperty : uint64_t {
    kTime = 1,
    kDuration,
    kEndReached,
    kSeekable,
    kBuffering,
    kBufferedUntil,
    kInterlaced,
};

struct Observed {
    ObservedProperty id;
    const char* name;
    mpv_format format;
};

const Observed kObserved[] = {
    {kTime, "time-pos", MPV_FORMAT_DOUBLE},
    {kDuration, "duration", MPV_FORMAT_DOUBLE},
    {kEndReached, "eof-reached", MPV_FORMAT_FLAG},
    {kSeekable, "seekable", MPV_FORMAT_FLAG},
    {kBuffering, "paused-for-cache", MPV_FORMAT_FLAG},
    {kBufferedUntil, "demuxer-cache-time", MPV_FORMAT_DOUBLE},
    {kInterlaced, "video-frame-info/interlaced", MPV_FORMAT_FLAG},
};

double numberOf(const mpv_event_property& property) {
    return *static_cast<const double*>(property.data);
}

bool flagOf(const mpv_event_property& property) {
    return *static_cast<const int*>(property.data) != 0;
}

// Places in mpv's load at which it waits.
constexpr char kBeforeOpening[] = "on_load";
constexpr char kOpened[] = "on_preloaded";

}  // namespace

bool EventLoop::start() {
    for (const Observed& property : kObserved) {
        const int error =
            mpv_observe_property(mMpv.get(), property.id, property.name, property.format);
        if (error < 0) return refused("observe", mpv_error_string(error));
    }
    for (const char* hook : {kBeforeOpening, kOpened}) {
        const int error = mpv_hook_add(mMpv.get(), 0, hook, 0);
        if (error < 0) return refused("observe", mpv_error_string(error));
    }
    mpv_request_log_messages(mMpv.get(), "warn");
    mThread = std::thread(&EventLoop::run, this);
    return true;
}

void EventLoop::stop() {
    if (!mThread.joinable()) return;
    mQuit = true;
    mpv_wakeup(mMpv.get());
    mThread.join();
    mMedia.stop();
}

void EventLoop::run() {
    nameThisThread("orv-events");
    bool isEmpty = true;  // no event waits
    while (!mQuit) {
        const mpv_event& event = *mpv_wait_event(mMpv.get(), isEmpty ? mMedia.patience() : 0);
        handle(event);
        // A frame's time may be among the reports that wait, and mpv hands out its
        // log after everything else.
        isEmpty = event.event_id == MPV_EVENT_NONE;
        if (!isEmpty) continue;
        mMedia.settle();
        mMedia.watchServer();
        mFrames.answer();
    }
}

void EventLoop::onSeek() {
    mState.update([](PlayerState::Values& v) { v.onSeek(); });
    if (mRedraw == Redraw::Accepted) mRedraw = Redraw::Begun;
    mFrames.leave();
}

void EventLoop::lookForEnd() {
    mMedia.lookForEnd();
    mpv_wakeup(mMpv.get());
}

void EventLoop::handle(const mpv_event& event) {
    switch (event.event_id) {
        case MPV_EVENT_START_FILE:
            mRedraw = Redraw::None;
            mMedia.onStart();
            mState.update([](PlayerState::Values& v) { v.fileStarted = true; });
            break;
        case MPV_EVENT_END_FILE:
            mMedia.onEndFile(*static_cast<const mpv_event_end_file*>(event.data));
            break;
        case MPV_EVENT_HOOK:
            onHook(*static_cast<const mpv_event_hook*>(event.data));
            break;
        case MPV_EVENT_FILE_LOADED:
            onLoaded();
            break;
        case MPV_EVENT_SEEK:
            onSeek();
            break;
        case MPV_EVENT_COMMAND_REPLY:
            onRedrawAnswered(event.error);
            break;
        case MPV_EVENT_PLAYBACK_RESTART:
            onRestart();
            break;
        case MPV_EVENT_VIDEO_RECONFIG:
            onVideoSize();
            if (mState.phase() == Phase::Started) mPictureHandler();
            break;
        case MPV_EVENT_PROPERTY_CHANGE:
            onProperty(*static_cast<const mpv_event_property*>(event.data));
            break;
        case MPV_EVENT_LOG_MESSAGE:
            onLogMessage(*static_cast<const mpv_event_log_message*>(event.data));
            break;
        default:
            break;
    }
}

void EventLoop::onHook(const mpv_event_hook& hook) {
    if (strcmp(hook.name, kBeforeOpening) == 0) mMedia.onBeforeOpening();
    if (strcmp(hook.name, kOpened) == 0) {
        mMedia.onOpened();
        if (mOpenedHandler) mOpenedHandler();
    }
    mpv_hook_continue(mMpv.get(), hook.id);
}

void EventLoop::onLogMessage(const mpv_event_log_message& message) {
    const std::string text(message.text, strcspn(message.text, "\n"));
    mMedia.onLogLine(message.prefix, text);
    if (message.log_level <= MPV_LOG_LEVEL_ERROR) {
        ALOGW("%s: %s", message.prefix, text.c_str());
    } else {
        ALOGI("%s: %s", message.prefix, text.c_str());
    }
}

// Formats without an index find key frames by guessing, sometimes behind the
// time that was asked for: exact seeks begin further ahead there.
void EventLoop::onLoaded() {
    const bool indexed = mMpv.getString("file-format").value_or("").find("mpeg") != 0;
    mMpv.set("hr-seek-demuxer-offset", indexed ? 0.0 : 2.0);
    if (const auto start = mMpv.getDouble("demuxer-start-time")) {
        mState.update([&](PlayerState::Values& v) { v.startUs = std::llround(*start * 1e6); });
    }
    mMedia.onLoaded();
}

void EventLoop::onRestart() {
    onVideoSize();
    // A track of which nothing can be decoded has no size.
    const bool hasVideo =
        mMpv.getInt("vid").value_or(0) > 0 && mMpv.getInt("dwidth").value_or(0) > 0;
    const bool hasSound =
        mMpv.getInt("aid").value_or(0) > 0 && mMpv.getInt("audio-params/samplerate").has_value();
    const double duration = mMedia.durationOf(mMpv.getDouble("duration").value_or(0));
    const bool seekable = mMpv.getFlag("seekable").value_or(false);
    const bool again = drawsAnew();
    const bool opened = mState.update([&](PlayerState::Values& v) {
        v.restarts++;
        v.left = false;
        if (v.phase != Phase::Preparing || again) return false;
        v.restarted = true;
        v.hasVideo = hasVideo;
        v.duration = std::max(duration, v.duration);
        v.seekable = seekable;
        return true;
    });
    if (!opened) return endUnattendedSeek();
    if (!hasVideo && !hasSound) return mMedia.onNothingToPlay();
    if (hasSound) reportSilence();
    applyLooping();
    becomePreparedIfReady();
}

bool EventLoop::seekUnattended(const std::function<int()>& command) {
    const bool begun = mState.update([](PlayerState::Values& v) {
        if (v.seeking || !v.isOpen()) return false;
        v.seeking = true;
        v.beginSeek();
        return true;
    });
    if (!begun) return false;
    if (command() >= 0) return true;
    mState.update([](PlayerState::Values& v) { v.seeking = false; });
    return false;
}

void EventLoop::endUnattendedSeek() {
    const double position = mMpv.getDouble("time-pos").value_or(0);
    const bool ended = mState.update([&](PlayerState::Values& v) {
        if (!v.seeking || v.attended || v.isArriving()) return false;
        v.seeking = false;
        v.position = position;
        return true;
    });
    if (ended) mMedia.lookForEnd();
}

// The first picture is not shown before its filters are right. mpv is asked for
// it once more; where it cannot seek, the filters begin with the second one. mpv may
// seek by itself as well, since its filters changed: its answer to the request, among
// the events, shows which of the seeks is the last.
bool EventLoop::drawsAnew() {
    if (mRedraw == Redraw::Asked || mRedraw == Redraw::Accepted) return true;
    mRedraw = Redraw::None;
    if (mState.phase() != Phase::Preparing || !mPictureHandler()) return false;
    if (!mMpv.getFlag("seekable").value_or(false)) return false;
    const double position = mMpv.getDouble("time-pos").value_or(0);
    if (mMpv.requestSeek(position, "absolute+exact") < 0) return false;
    mRedraw = Redraw::Asked;
    return true;
}

void EventLoop::onRedrawAnswered(int error) {
    if (mRedraw != Redraw::Asked) return;
    mRedraw = error < 0 ? Redraw::None : Redraw::Accepted;
    if (error < 0) onRestart();
}

void EventLoop::reportSilence() {
    if (mSilenceReported || mMpv.getString("current-ao") != kSilentOutput) return;
    mSilenceReported = true;
    ALOGW("playback: no sound device answers; media plays without sound");
}

void EventLoop::onFrame() {
    const bool first = mState.update([](PlayerState::Values& v) {
        const bool news = !v.framed && v.fileOpen;
        v.framed = v.framed || news;
        return news;
    });
    if (!first) return;
    mNotifier.post(android::MEDIA_INFO, android::MEDIA_INFO_RENDERING_START);
    becomePreparedIfReady();
}

void EventLoop::becomePreparedIfReady() {
    const bool prepared = mState.update([](PlayerState::Values& v) {
        const bool ready = v.phase == Phase::Preparing && v.restarted && (v.framed || !v.hasVideo);
        if (ready) v.phase = Phase::Prepared;
        return ready;
    });
    if (prepared) mNotifier.post(android::MEDIA_PREPARED);
}

void EventLoop::onProperty(const mpv_event_property& property) {
    if (property.format == MPV_FORMAT_NONE) return;  // not available now: keep the last
    for (const Observed& observed : kObserved) {
        if (strcmp(observed.name, property.name) != 0) continue;
        switch (observed.id) {
            case kTime:
                return onTime(numberOf(property));
            case kDuration: {
                const double duration = mMedia.durationOf(numberOf(property));
                return mState.update([&](PlayerState::Values& v) { v.duration = duration; });
            }
            case kEndReached:
                return mMedia.onEndReached(flagOf(property));
            case kSeekable:
                mState.update([&](PlayerState::Values& v) { v.seekable = flagOf(property); });
                return applyLooping();
            case kBuffering:
                return onBuffering(flagOf(property));
            case kBufferedUntil:
                return onBuffered(numberOf(property));
            case kInterlaced:
                if (mState.phase() == Phase::Started) mPictureHandler();
                return;
        }
    }
}

// At the end of media that cannot seek, mpv would try without a pause.
void EventLoop::applyLooping() {
    const bool loops =
        mState.read([](const PlayerState::Values& v) { return v.looping && v.seekable; });
    mMpv.set("loop-file", loops ? "inf" : "no");
}

void EventLoop::onTime(double seconds) {
    // A report from before a seek or step that is done would undo its position.
    if (mState.phase() != Phase::Started) seconds = mMpv.getDouble("time-pos").value_or(seconds);
    mState.update([&](PlayerState::Values& v) { v.position = std::max(seconds, 0.0); });
}

void EventLoop::onBuffering(bool buffering) {
    const bool changed = mState.update(
        [&](PlayerState::Values& v) { return std::exchange(v.buffering, buffering) != buffering; });
    if (!changed) return;
    mNotifier.post(android::MEDIA_INFO, buffering ? android::MEDIA_INFO_BUFFERING_START
                                                  : android::MEDIA_INFO_BUFFERING_END);
}

void EventLoop::onBuffered(double seconds) {
    const int percent = mState.update([&](PlayerState::Values& v) {
        const double share = v.duration > 0 ? seconds / v.duration : 0;
        const int now = static_cast<int>(100 * std::clamp(share, 0.0, 1.0));
        return std::exchange(v.bufferPercent, now) == now ? -1 : now;
    });
    if (percent >= 0) mNotifier.post(android::MEDIA_BUFFERING_UPDATE, percent);
}

void EventLoop::onVideoSize() {
    const int width = static_cast<int>(mMpv.getInt("dwidth").value_or(0));
    const int height = static_cast<int>(mMpv.getInt("dheight").value_or(0));
    if (width <= 0 || height <= 0) return;
    const bool changed = mState.update([&](PlayerState::Values& v) {
        const bool news = v.width != width || v.height != height;
        v.width = width;
        v.height = height;
        return news;
    });
    mVideo.setVideoSize(width, height);
    if (changed) mNotifier.post(android::MEDIA_SET_VIDEO_SIZE, width, height);
}

}  // namespace orvtarn
