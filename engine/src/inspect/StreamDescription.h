// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "inspect/DescriptionWriter.h"

struct AVCodecParameters;
struct AVFormatContext;
struct AVStream;

namespace orvtarn {

// Bits per second, from the codec's parameters or the container's statistics; 0
// when unknown.
int64_t bitRateOf(const AVStream& stream);

// 0 for codecs that have no samples of a fixed width.
int sampleBits(const AVCodecParameters& codec);

// The lines of one stream but for its section's and its track number.
void describeStream(const AVFormatContext& media, const AVStream& stream,
                    DescriptionWriter& writer);

}  // namespace orvtarn
