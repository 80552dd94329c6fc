// SPDX-License-Identifier: Apache-2.0
#include "inspect/Thumbnailer.h"

#include <orvtarn/PlayerTypes.h>

#include <new>

#include "inspect/PictureCanvas.h"

namespace orvtarn {

using android::NO_MEMORY;
using android::OK;
using android::status_t;

Thumbnailer::Thumbnailer(std::unique_ptr<MediaFile> file)
    : mFile(std::move(file)), mFinder(*mFile) {}

status_t Thumbnailer::create(std::unique_ptr<MediaFile> file, int streamIndex,
                             std::unique_ptr<Thumbnailer>& thumbnailer) {
    std::unique_ptr<Thumbnailer> created(new (std::nothrow) Thumbnailer(std::move(file)));
    if (created == nullptr) return NO_MEMORY;
    const status_t status = created->mFinder.open(streamIndex);
    if (status == OK) thumbnailer = std::move(created);
    return status;
}

status_t Thumbnailer::draw(int64_t positionMs, const _Media_Thumbnail_Info_T& thumbnail) {
    const status_t status = checkThumbnail(thumbnail);
    if (status != OK) return status;
    mFile->restartTimeLimit();
    const AVFrame* frame = mFinder.find(positionMs);
    if (mFile->isInterrupted()) return ORV_ERROR_IO;
    if (frame == nullptr) return ORV_ERROR_MALFORMED;
    return drawPicture(*frame, mFinder.rotation(), thumbnail);
}

}  // namespace orvtarn
