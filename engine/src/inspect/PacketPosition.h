// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <optional>

#include "inspect/MediaFile.h"

namespace orvtarn {

// Both read packets of the stream that playback goes by: the best video
// stream, or the best audio stream. Nothing when there is none, or for formats
// that do not know where their packets lie.

// Where the last packet lies that begins at or before a time from the media's
// start, in bytes.
std::optional<int64_t> byteAtTime(MediaFile& file, double seconds);

// When the last packet begins that lies at or before a byte, in seconds from
// the media's start.
std::optional<double> timeAtByte(MediaFile& file, int64_t position);

}  // namespace orvtarn
