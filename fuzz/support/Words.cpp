// SPDX-License-Identifier: Apache-2.0
#include "Words.h"

#include <algorithm>

namespace orvfuzz {
namespace {

constexpr char kBlanks[] = " \n\r\t";

int digitOf(char c) {
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

uint64_t digitsOf(std::string_view word, int base) {
    uint64_t value = 0;
    for (char c : word) {
        const int digit = digitOf(c);
        if (digit < 0 || digit >= base) break;
        value = value * static_cast<uint64_t>(base) + static_cast<uint64_t>(digit);
    }
    return value;
}

}  // namespace

bool Words::atEnd() {
    mRest.remove_prefix(std::min(mRest.find_first_not_of(kBlanks), mRest.size()));
    return mRest.empty();
}

std::string_view Words::next() {
    if (atEnd()) return {};
    const std::string_view word = mRest.substr(0, mRest.find_first_of(kBlanks));
    mRest.remove_prefix(word.size());
    return word;
}

int64_t Words::number() {
    std::string_view word = next();
    const bool negative = !word.empty() && word[0] == '-';
    if (negative) word.remove_prefix(1);
    const bool hexadecimal = word.substr(0, 2) == "0x";
    if (hexadecimal) word.remove_prefix(2);
    const uint64_t value = digitsOf(word, hexadecimal ? 16 : 10);
    return static_cast<int64_t>(negative ? -value : value);
}

std::string Words::text() {
    const std::string_view word = next();
    if (word == "\"\"") return {};
    std::string bytes;
    for (size_t i = 0; i < word.size(); i++) {
        if (word[i] == '\\' && word.substr(i + 1, 1) == "x" && i + 3 < word.size()) {
            bytes += static_cast<char>(digitsOf(word.substr(i + 2, 2), 16));
            i += 3;
        } else {
            if (word[i] == '\\' && i + 1 < word.size()) i++;
            bytes += word[i];
        }
    }
    return bytes;
}

}  // namespace orvfuzz
