// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PictureRecords.h>
#include <stddef.h>
#include <utils/Errors.h>

struct AVFrame;

namespace orvtarn {

// 2 or 4; 0 for modes that are not drawn.
int bytesPerPixel(int32_t colorMode);

// Bytes from one row to the next: width pixels rounded up to 64 bytes. For a
// mode that is drawn and a width above 0.
size_t thumbnailStride(int32_t colorMode, int32_t width);

// BAD_VALUE for a mode that is not drawn, a null buffer, sizes below 1 or above
// 16384, and a buffer with less than height rows.
android::status_t checkThumbnail(const _Media_Thumbnail_Info_T& thumbnail);

// Stretches a frame to the thumbnail's size, in its colour mode. Bytes between
// the rows stay as they are. A checked thumbnail; NO_MEMORY or
// ORV_ERROR_UNSUPPORTED for a frame that cannot be converted.
android::status_t drawPicture(const AVFrame& frame, const _Media_Thumbnail_Info_T& thumbnail);

}  // namespace orvtarn
