// SPDX-License-Identifier: Apache-2.0
#include "inspect/Thumbnailer.h"

#include <orvtarn/PlayerTypes.h>

#include <new>
#include <string>
#include <vector>

#include "base/LibraryVersions.h"
#include "base/PictureFilters.h"
#include "inspect/PictureCanvas.h"
#include "inspect/StreamPicture.h"

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
    const std::string filters = pictureFilters(traitsOf(mFinder.stream(), *frame));
    if (filters.empty()) return drawPicture(*frame, thumbnail);
    const Frame shown = filtered(filters, *frame);
    return shown == nullptr ? ORV_ERROR_UNSUPPORTED : drawPicture(*shown, thumbnail);
}

// Deinterlacing also looks at the frames beside the one to draw.
Frame Thumbnailer::filtered(const std::string& filters, const AVFrame& frame) {
    std::vector<const AVFrame*> frames;
    const AVFrame* before = mFinder.before();
    const AVFrame* after = isInterlaced(frame) ? mFinder.after() : nullptr;
    if (before != nullptr && isInterlaced(frame)) frames.push_back(before);
    const size_t wanted = frames.size();
    frames.push_back(&frame);
    if (after != nullptr) frames.push_back(after);
    return filterFrames(filters, frames, wanted);
}

}  // namespace orvtarn
