// SPDX-License-Identifier: Apache-2.0
#include "inspect/SecondReading.h"

#include <orvtarn/PlayerTypes.h>

#include <utility>

#include "base/EngineLog.h"

namespace orvtarn {

bool SecondReading::withFile(const std::function<void(MediaFile&)>& task) {
    std::lock_guard<std::mutex> use(mUseMutex);
    const std::shared_ptr<MediaFile> opened = file();
    if (opened == nullptr) return false;
    opened->restartTimeLimit();
    setStart(*opened);
    task(*opened);
    return true;
}

android::status_t SecondReading::draw(int64_t positionMs, int streamIndex,
                                      const _Media_Thumbnail_Info_T& thumbnail) {
    std::lock_guard<std::mutex> use(mUseMutex);
    const std::shared_ptr<Thumbnailer> drawer = thumbnailer(streamIndex);
    if (drawer == nullptr) return ORV_ERROR_UNSUPPORTED;
    return drawer->draw(positionMs, thumbnail);
}

void SecondReading::close() {
    mClosed = true;
    std::lock_guard<std::mutex> keep(mKeepMutex);
    mFile.reset();
    mThumbnailer.reset();
}

void SecondReading::tryAgain() {
    mUnreadable = false;
    mUndrawable = kNoStream;
}

std::unique_ptr<MediaFile> SecondReading::open() {
    std::unique_ptr<MediaFile> opened;
    if (mClosed || mRaw || mUnreadable || mSource == nullptr) return nullptr;
    const android::status_t status = openAgain(opened);
    if (status != android::NO_ERROR && !mClosed) {
        failed(status, "details", "the media cannot be read twice");
    }
    mUnreadable = opened == nullptr;
    return opened;
}

// 0 without a file for sources that can only be read once.
android::status_t SecondReading::openAgain(std::unique_ptr<MediaFile>& opened) {
    MediaOpenOptions options;
    options.headers = mSource->headers();
    options.cancel = &mClosed;
    if (!mSource->isOfBytes()) {
        return mSource->canOpenTwice() ? MediaFile::open(mSource->name(), options, opened)
                                       : android::NO_ERROR;
    }
    std::unique_ptr<ByteSource> reader = mSource->openReader();
    return reader != nullptr ? MediaFile::open(std::move(reader), options, opened)
                             : android::NO_ERROR;
}

void SecondReading::setStart(MediaFile& opened) const {
    if (mStartUs != INT64_MIN) opened.setStartUs(mStartUs);
}

std::shared_ptr<MediaFile> SecondReading::file() {
    {
        std::lock_guard<std::mutex> keep(mKeepMutex);
        if (mFile != nullptr) return mFile;
    }
    const std::shared_ptr<MediaFile> opened = open();
    return keep(mFile, opened) ? opened : nullptr;
}

std::shared_ptr<Thumbnailer> SecondReading::thumbnailer(int streamIndex) {
    {
        std::lock_guard<std::mutex> keep(mKeepMutex);
        if (mThumbnailer != nullptr && mThumbnailerStream == streamIndex) return mThumbnailer;
    }
    if (mUndrawable == streamIndex) return nullptr;
    std::unique_ptr<MediaFile> opened = open();
    if (opened == nullptr) return nullptr;
    setStart(*opened);
    std::unique_ptr<Thumbnailer> created;
    Thumbnailer::create(std::move(opened), streamIndex, created);
    if (created == nullptr) mUndrawable = streamIndex;
    std::shared_ptr<Thumbnailer> shared = std::move(created);
    if (!keep(mThumbnailer, shared)) return nullptr;
    mThumbnailerStream = streamIndex;
    return shared;
}

template <class Unit>
bool SecondReading::keep(std::shared_ptr<Unit>& member, const std::shared_ptr<Unit>& unit) {
    std::lock_guard<std::mutex> keep(mKeepMutex);
    if (mClosed || unit == nullptr) return false;
    member = unit;
    return true;
}

}  // namespace orvtarn
