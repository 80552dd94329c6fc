// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <string_view>

namespace orvtarn {

// The four-character code of a codec by libavcodec's name, first character in
// the low byte: the registered one of well-known codecs, as "mp4a" for "aac",
// else the first four letters of the name, as "pcx " for "pcx". 0 for an empty
// name.
int32_t codecFourCC(std::string_view codecName);

}  // namespace orvtarn
