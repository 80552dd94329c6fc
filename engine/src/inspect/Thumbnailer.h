// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PictureRecords.h>
#include <stdint.h>
#include <utils/Errors.h>

#include <memory>
#include <string>

#include "inspect/FilterGraph.h"
#include "inspect/FrameFinder.h"
#include "inspect/MediaFile.h"

namespace orvtarn {

// Draws frames of a file's video, or its embedded picture when it has no video.
// Keeps the file and the decoder for the next picture. One thread at a time.
class Thumbnailer {
public:
    // Of the video stream with that index, or the best one for -1. 0 with the
    // thumbnailer, or ORV_ERROR_UNSUPPORTED without a picture that can be
    // decoded. Takes the file over either way.
    static android::status_t create(std::unique_ptr<MediaFile> file, int streamIndex,
                                    std::unique_ptr<Thumbnailer>& thumbnailer);

    // Draws the frame at a time from the media's start, which is the one that
    // FrameFinder finds; before the first frame that one, past the last that one.
    // Upright, progressive and in standard dynamic range, see pictureFilters. Blocks
    // while it reads and decodes. 0, BAD_VALUE as checkThumbnail says it,
    // ORV_ERROR_IO when interrupted, ORV_ERROR_MALFORMED when no frame can be
    // decoded, or ORV_ERROR_UNSUPPORTED when one cannot be drawn; the buffer is only
    // written to when the result is 0.
    android::status_t draw(int64_t positionMs, const _Media_Thumbnail_Info_T& thumbnail);

private:
    explicit Thumbnailer(std::unique_ptr<MediaFile> file);
    Frame filtered(const std::string& filters, const AVFrame& frame);

    std::unique_ptr<MediaFile> mFile;
    FrameFinder mFinder;
};

}  // namespace orvtarn
