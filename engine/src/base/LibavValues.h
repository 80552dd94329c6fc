// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <algorithm>

extern "C" {
#include <libavutil/dict.h>
}

namespace orvtarn {

// What does not fit becomes the nearest number that does.
inline int32_t toInt32(int64_t value) {
    return static_cast<int32_t>(std::clamp<int64_t>(value, INT32_MIN, INT32_MAX));
}

// A tag's value as the file has it; empty when there is none.
inline const char* tagOf(const AVDictionary* tags, const char* name) {
    const AVDictionaryEntry* entry = av_dict_get(tags, name, nullptr, 0);
    return entry == nullptr ? "" : entry->value;
}

}  // namespace orvtarn
