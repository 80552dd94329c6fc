// SPDX-License-Identifier: Apache-2.0
#include "FakeJni/ModifiedUtf8.h"

namespace fakejni {

namespace {

bool isContinuation(unsigned char byte) { return (byte & 0xC0) == 0x80; }

// The length of the group that starts with that byte; 0 for no start.
int groupLength(unsigned char first) {
    if (first < 0x80) return 1;
    if ((first & 0xE0) == 0xC0) return 2;
    if ((first & 0xF0) == 0xE0) return 3;
    return 0;
}

}  // namespace

std::string toModifiedUtf8(const std::u16string& text) {
    std::string bytes;
    for (char16_t unit : text) {
        if (unit != 0 && unit < 0x80) {
            bytes += static_cast<char>(unit);
        } else if (unit < 0x800) {
            bytes += static_cast<char>(0xC0 | (unit >> 6));
            bytes += static_cast<char>(0x80 | (unit & 0x3F));
        } else {
            bytes += static_cast<char>(0xE0 | (unit >> 12));
            bytes += static_cast<char>(0x80 | ((unit >> 6) & 0x3F));
            bytes += static_cast<char>(0x80 | (unit & 0x3F));
        }
    }
    return bytes;
}

bool fromModifiedUtf8(const char* bytes, std::u16string* text) {
    text->clear();
    for (auto at = reinterpret_cast<const unsigned char*>(bytes); *at != 0;) {
        const int length = groupLength(*at);
        if (length == 0) return false;
        char16_t unit = length == 1 ? *at : *at & (0xFF >> (length + 1));
        for (int i = 1; i < length; ++i) {
            if (!isContinuation(at[i])) return false;
            unit = static_cast<char16_t>((unit << 6) | (at[i] & 0x3F));
        }
        *text += unit;
        at += length;
    }
    return true;
}

}  // namespace fakejni
