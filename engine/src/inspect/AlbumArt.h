// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PictureRecords.h>

#include "inspect/MediaFile.h"

namespace orvtarn {

// The media's embedded picture, the front cover where it has several, as the
// bytes that the file holds (JPEG, PNG, …). One block to be given up with free;
// null when there is no picture or no memory. Does not read from the file.
MediaAlbumArt* extractAlbumArt(const MediaFile& file);

}  // namespace orvtarn
