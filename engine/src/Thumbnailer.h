// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PictureRecords.h>
#include <stdint.h>
#include <utils/Errors.h>

#include <memory>

#include "MediaFile.h"

struct AVCodecContext;
struct AVFrame;
struct AVPacket;

namespace orvtarn {

enum class FramePick {
    // The first frame that starts at the time or up to 100 ms after it; where
    // frames are further apart than that, the one on screen at the time.
    Exact,
    // The last key frame at or before the time: several times faster.
    KeyFrame,
};

// Draws frames of a file's best video stream, or its embedded picture when it
// has no video. Keeps the decoder for the next picture. One thread at a time.
class Thumbnailer {
public:
    // 0 with the thumbnailer, or ORV_ERROR_UNSUPPORTED without a picture that
    // can be decoded. Takes the file over either way.
    static android::status_t create(std::unique_ptr<MediaFile> file,
                                    std::unique_ptr<Thumbnailer>& thumbnailer);
    ~Thumbnailer();
    Thumbnailer(const Thumbnailer&) = delete;
    Thumbnailer& operator=(const Thumbnailer&) = delete;

    // Draws the frame at a time from the media's start; before the first frame
    // that one, past the last frame that one. Blocks while it reads and
    // decodes. 0, BAD_VALUE as checkThumbnail says it, ORV_ERROR_IO when
    // interrupted, or ORV_ERROR_MALFORMED when no frame can be decoded; the
    // buffer is only written to when the result is 0.
    android::status_t draw(int64_t positionMs, FramePick pick,
                           const _Media_Thumbnail_Info_T& thumbnail);

private:
    struct Decoder;

    Thumbnailer(std::unique_ptr<MediaFile> file, std::unique_ptr<Decoder> decoder);

    std::unique_ptr<MediaFile> mFile;
    std::unique_ptr<Decoder> mDecoder;
};

}  // namespace orvtarn
