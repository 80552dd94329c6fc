// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <math.h>
#include <stdint.h>

#include <algorithm>

namespace orvtarn {

// Times of more than 24.8 days do not fit: they become the longest that does.
inline int32_t toMilliseconds(double seconds) {
    return static_cast<int32_t>(
        lround(std::clamp(seconds * 1000, double{INT32_MIN}, double{INT32_MAX})));
}

}  // namespace orvtarn
