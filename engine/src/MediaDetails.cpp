// SPDX-License-Identifier: Apache-2.0
#include "MediaDetails.h"

#include <orvtarn/PlayerTypes.h>

#include <utility>

#include "EngineLog.h"

namespace orvtarn {

bool MediaDetails::withFile(const std::function<void(MediaFile&)>& task) {
    std::lock_guard<std::mutex> use(mUseMutex);
    const std::shared_ptr<MediaFile> opened = file();
    if (opened == nullptr) return false;
    opened->restartTimeLimit();
    task(*opened);
    return true;
}

android::status_t MediaDetails::draw(int64_t positionMs, FramePick pick,
                                     const _Media_Thumbnail_Info_T& thumbnail) {
    std::lock_guard<std::mutex> use(mUseMutex);
    const std::shared_ptr<Thumbnailer> drawer = thumbnailer();
    if (drawer == nullptr) return ORV_ERROR_UNSUPPORTED;
    return drawer->draw(positionMs, pick, thumbnail);
}

void MediaDetails::close() {
    mClosed = true;
    std::lock_guard<std::mutex> keep(mKeepMutex);
    mFile.reset();
    mThumbnailer.reset();
}

std::unique_ptr<MediaFile> MediaDetails::open() {
    if (mClosed || mRaw || mSource == nullptr) return nullptr;
    MediaOpenOptions options;
    options.headers = mSource->headers();
    options.cancel = &mClosed;
    std::unique_ptr<MediaFile> opened;
    android::status_t status = android::INVALID_OPERATION;
    if (!mSource->isOfBytes()) {
        status = MediaFile::open(mSource->name(), options, opened);
    } else if (std::unique_ptr<ByteSource> reader = mSource->openReader()) {
        status = MediaFile::open(std::move(reader), options, opened);
    }
    if (status != android::NO_ERROR) failed(status, "details", "the media cannot be read twice");
    return opened;
}

std::shared_ptr<MediaFile> MediaDetails::file() {
    {
        std::lock_guard<std::mutex> keep(mKeepMutex);
        if (mFile != nullptr) return mFile;
    }
    const std::shared_ptr<MediaFile> opened = open();
    return keep(mFile, opened) ? opened : nullptr;
}

std::shared_ptr<Thumbnailer> MediaDetails::thumbnailer() {
    {
        std::lock_guard<std::mutex> keep(mKeepMutex);
        if (mThumbnailer != nullptr) return mThumbnailer;
    }
    std::unique_ptr<MediaFile> opened = open();
    if (opened == nullptr) return nullptr;
    std::unique_ptr<Thumbnailer> created;
    Thumbnailer::create(std::move(opened), -1, created);
    const std::shared_ptr<Thumbnailer> shared = std::move(created);
    return keep(mThumbnailer, shared) ? shared : nullptr;
}

template <class Unit>
bool MediaDetails::keep(std::shared_ptr<Unit>& member, const std::shared_ptr<Unit>& unit) {
    std::lock_guard<std::mutex> keep(mKeepMutex);
    if (mClosed || unit == nullptr) return false;
    member = unit;
    return true;
}

}  // namespace orvtarn
