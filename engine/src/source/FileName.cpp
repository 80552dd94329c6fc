// SPDX-License-Identifier: Apache-2.0
#include "source/FileName.h"

#include <strings.h>

#include <cstddef>

#include "source/UrlScheme.h"

namespace orvtarn {
namespace {

int hexDigit(char character) {
    if (character >= '0' && character <= '9') return character - '0';
    if (character >= 'a' && character <= 'f') return character - 'a' + 10;
    if (character >= 'A' && character <= 'F') return character - 'A' + 10;
    return -1;
}

// A coded NUL, which no path has, stays as it is: it would cut the path short.
std::string percentDecoded(const std::string& text) {
    std::string decoded;
    for (size_t i = 0; i < text.size(); i++) {
        const int high = text[i] == '%' && i + 2 < text.size() ? hexDigit(text[i + 1]) : -1;
        const int low = high < 0 ? -1 : hexDigit(text[i + 2]);
        const bool isCode = low >= 0 && (high | low) != 0;
        decoded += isCode ? static_cast<char>(high << 4 | low) : text[i];
        if (isCode) i += 2;
    }
    return decoded;
}

}  // namespace

bool filePath(const std::string& name, std::string& path) {
    constexpr size_t kScheme = sizeof("file:") - 1;
    path = name;
    if (strncasecmp(name.c_str(), "file:/", kScheme + 1) != 0) return schemeOf(name).empty();
    path = percentDecoded(name.substr(kScheme));
    if (path.compare(0, 2, "//") != 0) return true;
    // The only host whose files these can be.
    const bool isNamed = path.compare(2, sizeof("localhost"), "localhost/") == 0;
    path.erase(0, isNamed ? sizeof("//localhost") - 1 : 2);
    return true;
}

}  // namespace orvtarn
