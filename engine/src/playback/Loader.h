// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <stdint.h>
#include <utils/Errors.h>

#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "core/MpvHandle.h"
#include "core/MpvLoad.h"
#include "core/OpenMedia.h"
#include "core/PlayerState.h"
#include "core/VideoOutput.h"
#include "inspect/SecondReading.h"
#include "records/PcmFormat.h"
#include "source/MediaSource.h"
#include "source/StreamProtocol.h"

class IOrvStreamSource;

namespace orvtarn {

// Takes a data source, opens it and gives it up again.
class Loader {
public:
    Loader(MpvHandle& mpv, PlayerState& state, VideoOutput& video, OpenMedia& media,
           StreamProtocol& protocol)
        : mMpv(mpv), mState(state), mVideo(video), mMedia(media), mProtocol(protocol) {}

    android::status_t setUrl(const char* url, RequestHeaders headers);
    android::status_t setFd(int fd, int64_t offset, int64_t length);
    // Takes the source over, also when it refuses it.
    android::status_t setStream(std::unique_ptr<IOrvStreamSource> stream);

    android::status_t prepare();
    android::status_t prepareAsync();
    android::status_t stop();
    void reset();
    // Ends every wait and closes the media for good.
    void release();

    // Called before each load, to bring mpv's settings to the start.
    void setBeforeLoad(std::function<void()> action) { mBeforeLoad = std::move(action); }
    // Called when media that were open, or were to be, are closed.
    void setOnUnload(std::function<void()> action) { mOnUnload = std::move(action); }
    // Called when the source is given up.
    void setOnForget(std::function<void()> action) { mOnForget = std::move(action); }
    // The media are raw samples, until the source is given up. BAD_VALUE for a
    // description that does not fit together, INVALID_OPERATION while media are
    // open.
    android::status_t setRawFormat(const char* operation,
                                   const IORV_PB_CTRL_SET_MEDIA_INFO_T& info);
    // The same without a description: two channels of 16 bits at 44100 Hz.
    android::status_t setRaw();
    // 0 for media that are not raw.
    int rawBytesPerSecond() const;

    // The current source; null when there is none.
    std::shared_ptr<MediaSource> source() const;
    // Never null; without a source they have nothing to say.
    std::shared_ptr<SecondReading> secondReading() const;

private:
    android::status_t setSource(const char* operation, const std::shared_ptr<MediaSource>& source);
    void describeSource();
    android::status_t beginPrepare(const char* operation, uint64_t& session);
    android::status_t load();
    MpvOptions mediaOptions();
    void setHeaders();
    void setReach(const MediaSource& media);
    android::status_t awaitPrepared(uint64_t session);
    android::status_t giveUp(uint64_t session);
    void overtake(Phase phase);
    void unload();
    void unloadIn(uint64_t session);
    void closeFile();
    void forgetSource();

    MpvHandle& mMpv;
    PlayerState& mState;
    VideoOutput& mVideo;
    OpenMedia& mMedia;
    StreamProtocol& mProtocol;
    std::function<void()> mBeforeLoad;
    std::function<void()> mOnUnload;
    std::function<void()> mOnForget;

    // Held while media is opened or closed, not while its opening is awaited.
    std::mutex mLoadMutex;
    mutable std::mutex mSourceMutex;
    std::shared_ptr<MediaSource> mSource;
    std::shared_ptr<SecondReading> mSecondReading;
    std::optional<PcmFormat> mRawFormat;
};

}  // namespace orvtarn
