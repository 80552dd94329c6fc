// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PictureRecords.h>

#include "inspect/MediaFile.h"

struct AVStream;

namespace orvtarn {

// The stream of the embedded picture, the front cover where there are several; null
// when there is none. Does not read from the file.
AVStream* coverOf(const MediaFile& file);

// The media's embedded picture, as the bytes that the file holds (JPEG, PNG, …).
// One block to be given up with free; null when there is no picture or no memory.
// Does not read from the file.
MediaAlbumArt* extractAlbumArt(const MediaFile& file);

}  // namespace orvtarn
