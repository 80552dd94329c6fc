// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <optional>

#include "inspect/MediaFile.h"

namespace orvtarn {

struct FrameAt {
    double seconds;  // from the media's start
    bool isThere;    // else it is the media's first or last frame
};

// The frame that many frames after the one of a time, or before it for a negative
// number, of the video stream with that index or of the best one for -1. Counts
// packets, and decodes nothing. Nothing where one of them has no time.
std::optional<FrameAt> frameFrom(MediaFile& file, int streamIndex, double seconds, int amount);

}  // namespace orvtarn
