// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include "source/MediaSource.h"

namespace orvtarn {

// Whether a URL's server gives some more bytes, from a position on, of a file
// of that size. To mpv a connection that broke and a stream that
// ended look alike; this tells them apart. Blocks, a few seconds at most.
bool isServed(const MediaSource& source, int64_t position, int64_t size);

}  // namespace orvtarn
