// SPDX-License-Identifier: Apache-2.0
//
// Whatever the bytes, record texts keep their promises: they end within the
// array, and never inside a character.
#include <stdint.h>

#include <algorithm>

#include "base/RecordText.h"
#include "support/Require.h"

namespace {

void require(bool holds) {
    orvfuzz::require(holds, "a text ends within its array and no character");
}

// Each high surrogate is followed by a low one, which stands nowhere else.
template <typename Next>
void requirePairs(Next next) {
    bool isOpen = false;
    for (int unit = next(); unit > 0; unit = next()) {
        require(((unit & 0xFC00) == 0xDC00) == isOpen);
        isOpen = (unit & 0xFC00) == 0xD800;
    }
    require(!isOpen);
}

// The next unit of modified UTF-8; 0 at the end. U+0000 reads as U+0001, which
// makes no difference here.
int nextUnit(const char*& text) {
    const auto byte = [&] { return static_cast<uint8_t>(*text++); };
    const auto trail = [&] {
        const uint8_t value = byte();
        require((value & 0xC0) == 0x80);
        return value & 0x3F;
    };
    const uint8_t lead = byte();
    if (lead < 0x80) return lead;
    require(lead >= 0xC0 && lead < 0xF0);
    if (lead < 0xE0) {
        const int unit = (lead & 0x1F) << 6 | trail();
        require(unit == 0 || unit >= 0x80);
        return std::max(unit, 1);
    }
    const int high = trail();
    const int unit = (lead & 0xF) << 12 | high << 6 | trail();
    require(unit >= 0x800);
    return unit;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view input(reinterpret_cast<const char*>(data), size);
    OrvText narrow;
    orvtarn::setText(narrow, input);
    require(narrow[ORV_TEXT_BYTES - 1] == 0);
    const char* at = narrow;
    requirePairs([&] { return nextUnit(at); });

    OrvWideText wide;
    orvtarn::setWideText(wide, input);
    int index = 0;
    requirePairs([&] { return index < ORV_TEXT_UNITS ? wide[index++] : 0; });
    return 0;
}
