// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include "inspect/MediaFile.h"

namespace orvtarn {

// A stream's timestamps as times from the media's start, in microseconds.
class StreamTime {
public:
    // A time that a frame misses by no more than this, by rounding, is the frame's.
    static constexpr int64_t kRoundingUs = 1000;

    StreamTime(MediaFile& file, const AVStream& stream) : mFile(file), mStream(stream) {}

    int64_t of(int64_t timestamp) const;
    // Has packets read from about that time on; they may begin before or after it.
    bool seek(int64_t us);

private:
    MediaFile& mFile;
    const AVStream& mStream;
};

}  // namespace orvtarn
