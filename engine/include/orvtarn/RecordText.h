// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <string.h>

#include <algorithm>

// Texts in engine records are arrays of fixed length. 8-bit texts are modified
// UTF-8, cut at a character and always terminated. UTF-16 texts end at the
// first zero unit or with the array, never inside a surrogate pair.
enum : int {
    ORV_TEXT_UNITS = 128,  // UTF-16 units of a wide text
    ORV_TEXT_BYTES = 128,  // bytes of an 8-bit text
};

typedef uint16_t OrvWideText[ORV_TEXT_UNITS];
typedef char OrvText[ORV_TEXT_BYTES];

// What the records' constructors do to a wide text: the second half stays as
// it is. Whoever asks for a record calls clearText on the texts it will read.
inline void clearFirstHalf(OrvWideText& text) {
    std::fill_n(text, ORV_TEXT_UNITS / 2, uint16_t{0});
}

inline void clearText(OrvWideText& text) { memset(text, 0, sizeof(text)); }
inline void clearText(OrvText& text) { memset(text, 0, sizeof(text)); }
