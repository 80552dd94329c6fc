// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <stdint.h>
#include <utils/Errors.h>

#include <functional>
#include <memory>
#include <mutex>
#include <string>

#include "EventLoop.h"
#include "MediaSource.h"
#include "MpvHandle.h"
#include "PlayerState.h"
#include "StreamProtocol.h"
#include "VideoOutput.h"

class IOrvStreamSource;

namespace orvtarn {

// Takes a data source, opens it and gives it up again.
class Loader {
public:
    Loader(MpvHandle& mpv, PlayerState& state, VideoOutput& video, EventLoop& events,
           StreamProtocol& protocol)
        : mMpv(mpv), mState(state), mVideo(video), mEvents(events), mProtocol(protocol) {}

    android::status_t setUrl(const char* url, RequestHeaders headers);
    android::status_t setFd(int fd, int64_t offset, int64_t length);
    android::status_t setStream(IOrvStreamSource* stream);

    android::status_t prepare();
    android::status_t prepareAsync();
    android::status_t stop();
    void reset();
    // Ends every wait and closes the media for good.
    void release();

    // Called before each load, to bring the core's settings to the start.
    void setBeforeLoad(std::function<void()> action) { mBeforeLoad = std::move(action); }
    // Called when the source is given up.
    void setOnForget(std::function<void()> action) { mOnForget = std::move(action); }
    // Options of the next loads, as "loadfile" takes them.
    void setLoadOptions(std::string options);

    // The current source; null when there is none.
    std::shared_ptr<MediaSource> source() const;

private:
    android::status_t setSource(const char* operation, std::shared_ptr<MediaSource> source);
    android::status_t beginPrepare(const char* operation, uint64_t& session);
    android::status_t load();
    void setHeaders();
    android::status_t awaitPrepared(uint64_t session);
    android::status_t giveUp(uint64_t session);
    void overtake(Phase phase);
    void unload();
    void forgetSource();

    MpvHandle& mMpv;
    PlayerState& mState;
    VideoOutput& mVideo;
    EventLoop& mEvents;
    StreamProtocol& mProtocol;
    std::function<void()> mBeforeLoad;
    std::function<void()> mOnForget;

    // Held while media is opened or closed, not while its opening is awaited.
    std::mutex mLoadMutex;
    mutable std::mutex mSourceMutex;
    std::shared_ptr<MediaSource> mSource;
    std::string mLoadOptions;
};

}  // namespace orvtarn
