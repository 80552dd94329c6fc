// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <stdio.h>

#include <string>
#include <string_view>

extern "C" {
#include <libavutil/avutil.h>
#include <libavutil/mathematics.h>
}

namespace orvtarn {

// Writes the lines of orvtarn/MediaDescription.h. Values that say nothing make no
// line.
class DescriptionWriter {
public:
    void section(std::string_view name) { mText.append("[").append(name).append("]\n"); }

    void text(const char* name, std::string_view value) {
        if (value.empty()) return;
        mText.append(name).append("=");
        for (const char character : value) appendEscaped(character);
        mText.append("\n");
    }
    void text(const char* name, const char* value) {
        if (value != nullptr) text(name, std::string_view(value));
    }
    void number(const char* name, int64_t value) { text(name, std::to_string(value)); }
    void positive(const char* name, int64_t value) {
        if (value > 0) number(name, value);
    }
    // In microseconds.
    void time(const char* name, int64_t value, AVRational base) {
        if (value != AV_NOPTS_VALUE) number(name, av_rescale_q(value, base, AV_TIME_BASE_Q));
    }
    void ratio(const char* name, AVRational value, char separator) {
        if (value.num <= 0 || value.den <= 0) return;
        text(name, std::to_string(value.num) + separator + std::to_string(value.den));
    }
    void luminance(const char* name, AVRational value) {
        if (value.num < 0 || value.den <= 0) return;
        char digits[32];
        snprintf(digits, sizeof(digits), "%.4f", av_q2d(value));
        text(name, std::string_view(digits));
    }

    std::string take() { return std::move(mText); }

private:
    void appendEscaped(char character) {
        switch (character) {
            case '\\':
                mText += "\\\\";
                break;
            case '\n':
                mText += "\\n";
                break;
            case '\r':
                mText += "\\r";
                break;
            default:
                mText += character;
        }
    }

    std::string mText;
};

}  // namespace orvtarn
