// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>

#include <vector>

#include "source/MediaSource.h"

namespace orvtarn {

// Why nothing can be played of media that begin with these bytes:
// ORV_ERROR_EMPTY, ORV_ERROR_NOTHING_INSIDE minus their E_Orv_Format, or
// ORV_ERROR_MALFORMED for an unknown format.
android::status_t checkFormat(std::vector<uint8_t> bytes);

// The same for a file or a source of bytes, which is read once more.
// ORV_ERROR_MALFORMED for one that cannot be, ORV_ERROR_IO when that fails.
// Blocks as long as the source's reads.
android::status_t checkFormat(MediaSource& source);

}  // namespace orvtarn
