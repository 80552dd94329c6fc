// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace fakejni {

// Java's own 8-bit form: U+0000 is C0 80, and characters beyond 16 bits are
// two three-byte groups, one for each half of their pair.
std::string toModifiedUtf8(const std::u16string& text);

// False, with text holding what came before the fault, when the bytes are not
// modified UTF-8.
bool fromModifiedUtf8(const char* bytes, std::u16string* text);

}  // namespace fakejni
