// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/RecordText.h>
#include <string.h>

#include <algorithm>
#include <string>

namespace orvtest {

// Fills an engine record's text; 128 units leave no room for a zero.
inline void setText(OrvWideText& text, const std::u16string& value) {
    clearText(text);
    std::copy_n(value.begin(), std::min<size_t>(value.size(), ORV_TEXT_UNITS), text);
}
inline void setText(OrvText& text, const char* value) {
    clearText(text);
    strncpy(text, value, sizeof(text) - 1);
}

inline bool isClear(const OrvWideText& text) {
    return std::all_of(text, text + ORV_TEXT_UNITS, [](uint16_t unit) { return unit == 0; });
}
inline bool isClear(const OrvText& text) {
    return std::all_of(text, text + ORV_TEXT_BYTES, [](char c) { return c == 0; });
}

// Leaves the stack below the caller full of ones and zeros, so that a record
// built there shows what was not cleared.
__attribute__((noinline)) inline void poisonStack() {
    volatile unsigned char bytes[64 * 1024];
    for (volatile unsigned char& byte : bytes) byte = 0xa5;
}

}  // namespace orvtest
