// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace orvtrace {

// The text as UTF-8: what is none becomes U+FFFD.
std::string asUtf8(std::string_view text);
// "12.3 ms", of three digits.
std::string readableTime(int64_t nanoseconds);
// "1 234 567"
std::string readableCount(uint64_t count);

}  // namespace orvtrace
