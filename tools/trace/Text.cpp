// SPDX-License-Identifier: Apache-2.0
#include "Text.h"

#include <stdio.h>
#include <utf8.h>

#include <iterator>

namespace orvtrace {

std::string asUtf8(std::string_view text) {
    std::string valid;
    valid.reserve(text.size());
    utf8::replace_invalid(text.begin(), text.end(), std::back_inserter(valid), 0xfffd);
    return valid;
}

std::string readableTime(int64_t nanoseconds) {
    struct Unit {
        double size;
        const char* name;
    };
    constexpr Unit kUnits[] = {{1e9, "s"}, {1e6, "ms"}, {1e3, "µs"}};
    char text[32];
    for (const Unit& unit : kUnits) {
        const double value = static_cast<double>(nanoseconds) / unit.size;
        if (value < 0.9995 && unit.size > 1e3) continue;
        int decimals = 2;
        if (value >= 9.995) decimals = 1;
        if (value >= 99.95) decimals = 0;
        snprintf(text, sizeof(text), "%.*f %s", decimals, value, unit.name);
        return text;
    }
    return {};
}

std::string readableCount(uint64_t count) {
    std::string text = std::to_string(count);
    for (size_t at = text.size(); at > 3;) text.insert(at -= 3, " ");
    return text;
}

}  // namespace orvtrace
