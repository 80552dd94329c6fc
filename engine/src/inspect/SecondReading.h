// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/MetaDataInfo.h>
#include <orvtarn/PictureRecords.h>
#include <orvtarn/TrackRecords.h>
#include <stdint.h>
#include <utils/Errors.h>

#include <atomic>
#include <functional>
#include <memory>
#include <mutex>

#include "inspect/MediaFile.h"
#include "inspect/Thumbnailer.h"
#include "source/MediaSource.h"

namespace orvtarn {

// What a source's media say about themselves beyond playback. Opens the source
// a second time, when first asked; any thread, one at a time. What could not be
// opened is not tried again before the next load: that may take its time.
class SecondReading {
public:
    explicit SecondReading(std::shared_ptr<MediaSource> source) : mSource(std::move(source)) {}

    // Runs a task on the opened file. False when there is none: a source that
    // cannot be read twice, media without a format of their own, or closed.
    bool withFile(const std::function<void(MediaFile&)>& task);
    // The frame at a time of the video stream with that index, or of the best one
    // for -1; see Thumbnailer.
    android::status_t draw(int64_t positionMs, int streamIndex,
                           const _Media_Thumbnail_Info_T& thumbnail);

    // Media whose bytes say nothing about their format: nothing is opened.
    void setRaw() { mRaw = true; }
    // The timestamp that the player's times count from, in microseconds.
    void setStartUs(int64_t startUs) { mStartUs = startUs; }
    // The media are loaded anew.
    void tryAgain();
    // Refuses tasks from now on and ends the one under way. What it has open is
    // closed when it returns from the source.
    void close();

private:
    std::unique_ptr<MediaFile> open();
    void setStart(MediaFile& opened) const;
    std::shared_ptr<MediaFile> file();
    android::status_t openAgain(std::unique_ptr<MediaFile>& opened);
    std::shared_ptr<Thumbnailer> thumbnailer(int streamIndex);
    template <class Unit>
    bool keep(std::shared_ptr<Unit>& member, const std::shared_ptr<Unit>& unit);

    // -1 is any stream.
    static constexpr int kNoStream = -2;

    const std::shared_ptr<MediaSource> mSource;
    std::atomic<bool> mRaw{false};
    std::atomic<bool> mClosed{false};
    std::atomic<int64_t> mStartUs{INT64_MIN};  // by the container then
    std::atomic<bool> mUnreadable{false};      // cannot be opened
    std::atomic<int> mUndrawable{kNoStream};   // cannot be decoded
    std::mutex mUseMutex;                      // one task at a time
    std::mutex mKeepMutex;                     // the pointers; never held while the source is read
    std::shared_ptr<MediaFile> mFile;
    std::shared_ptr<Thumbnailer> mThumbnailer;
    int mThumbnailerStream = kNoStream;
};

}  // namespace orvtarn
