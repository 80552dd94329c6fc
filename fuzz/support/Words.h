// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <stdint.h>

#include <string>
#include <string_view>

namespace orvfuzz {

// Reads an input as text: words between blanks and line ends. Inputs that are
// text can be written, read and shortened by hand; a fuzzer makes them from the
// words of its dictionary. Whatever the bytes, reading succeeds: where a number
// should stand and does not, it is 0.
class Words {
public:
    Words(const uint8_t* data, size_t size) : mRest(reinterpret_cast<const char*>(data), size) {}

    bool atEnd();
    std::string_view next();  // empty at the end
    // The next word as a number, decimal or 0x…; what is beyond 64 bits wraps.
    int64_t number();
    int32_t int32() { return static_cast<int32_t>(number()); }
    // Within 0 to limit - 1.
    int below(int limit) { return static_cast<int>(static_cast<uint64_t>(number()) % limit); }
    bool flag() { return number() != 0; }
    // The next word as bytes of text: \xHH and \\ are unescaped, "" is empty.
    std::string text();

private:
    std::string_view mRest;
};

}  // namespace orvfuzz
