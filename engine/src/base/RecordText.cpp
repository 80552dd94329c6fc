// SPDX-License-Identifier: Apache-2.0
#include "base/RecordText.h"

namespace orvtarn {
namespace {

const char32_t kReplacement = 0xFFFD;

// What the lead byte of a sequence says. The range of the second byte is
// narrower after some leads: it keeps out overlong forms, surrogates and
// everything beyond U+10FFFF.
struct Lead {
    int trailing;  // -1: not a lead byte
    char32_t bits;
    uint8_t secondMin = 0x80;
    uint8_t secondMax = 0xBF;
};

Lead leadOf(uint8_t byte) {
    if (byte < 0x80) return {0, byte};
    if (byte < 0xC2) return {-1, 0};
    if (byte < 0xE0) return {1, byte & 0x1Fu};
    if (byte == 0xE0) return {2, 0, 0xA0, 0xBF};
    if (byte == 0xED) return {2, 0xD, 0x80, 0x9F};
    if (byte < 0xF0) return {2, byte & 0xFu};
    if (byte == 0xF0) return {3, 0, 0x90, 0xBF};
    if (byte < 0xF4) return {3, byte & 7u};
    if (byte == 0xF4) return {3, 4, 0x80, 0x8F};
    return {-1, 0};
}

// Takes one character off the front. An ill-formed sequence is taken up to the
// byte that breaks it.
char32_t takeCharacter(std::string_view& utf8) {
    const Lead lead = leadOf(static_cast<uint8_t>(utf8.front()));
    utf8.remove_prefix(1);
    if (lead.trailing < 0) return kReplacement;
    char32_t character = lead.bits;
    uint8_t min = lead.secondMin;
    uint8_t max = lead.secondMax;
    for (int i = 0; i < lead.trailing; i++) {
        const uint8_t byte = utf8.empty() ? 0 : static_cast<uint8_t>(utf8.front());
        if (byte < min || byte > max) return kReplacement;
        character = character << 6 | (byte & 0x3Fu);
        utf8.remove_prefix(1);
        min = 0x80;
        max = 0xBF;
    }
    return character;
}

// Writes one or two UTF-16 units.
int toUtf16(char32_t character, uint16_t units[2]) {
    if (character < 0x10000) {
        units[0] = static_cast<uint16_t>(character);
        return 1;
    }
    units[0] = static_cast<uint16_t>(0xD7C0 + (character >> 10));
    units[1] = static_cast<uint16_t>(0xDC00 | (character & 0x3FF));
    return 2;
}

// Writes one to three bytes.
int toModifiedUtf8(uint16_t unit, char* bytes) {
    if (unit != 0 && unit < 0x80) {
        bytes[0] = static_cast<char>(unit);
        return 1;
    }
    if (unit < 0x800) {
        bytes[0] = static_cast<char>(0xC0 | unit >> 6);
        bytes[1] = static_cast<char>(0x80 | (unit & 0x3F));
        return 2;
    }
    bytes[0] = static_cast<char>(0xE0 | unit >> 12);
    bytes[1] = static_cast<char>(0x80 | (unit >> 6 & 0x3F));
    bytes[2] = static_cast<char>(0x80 | (unit & 0x3F));
    return 3;
}

}  // namespace

size_t setText(OrvText& text, std::string_view utf8) {
    clearText(text);
    const size_t size = utf8.size();
    int used = 0;
    while (!utf8.empty()) {
        const size_t taken = size - utf8.size();
        uint16_t units[2];
        const int count = toUtf16(takeCharacter(utf8), units);
        char bytes[6];
        int length = 0;
        for (int i = 0; i < count; i++) length += toModifiedUtf8(units[i], bytes + length);
        if (used + length >= ORV_TEXT_BYTES) return taken;
        std::copy_n(bytes, length, text + used);
        used += length;
    }
    return size;
}

void setWideText(OrvWideText& text, std::string_view utf8) {
    clearText(text);
    int used = 0;
    while (!utf8.empty()) {
        const char32_t character = takeCharacter(utf8);
        uint16_t units[2];
        const int count = toUtf16(character == 0 ? kReplacement : character, units);
        if (used + count > ORV_TEXT_UNITS) return;
        std::copy_n(units, count, text + used);
        used += count;
    }
}

}  // namespace orvtarn
