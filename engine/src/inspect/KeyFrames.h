// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <optional>

#include "inspect/MediaFile.h"

namespace orvtarn {

// When the last key frame of the best video stream is shown that is shown at or
// before a time; both in seconds from the media's start. For formats without an
// index, whose seeks may lead past it. Reads packets, from further and further
// ahead of the time. Nothing without video or a key frame.
std::optional<double> keyFrameBefore(MediaFile& file, double seconds);

}  // namespace orvtarn
