// SPDX-License-Identifier: Apache-2.0
#include "Json.h"

#include "Text.h"

namespace orvtrace {

namespace {

constexpr size_t kWriteSize = 256 * 1024;

bool isAscii(std::string_view text) {
    unsigned char all = 0;
    for (const char c : text) all |= static_cast<unsigned char>(c);
    return all < 0x80;
}

}  // namespace

Json::Json(FILE* file)
    : mBuffer(kWriteSize), mStream(file, mBuffer.data(), mBuffer.size()), mWriter(mStream) {}

void Json::text(std::string_view text) {
    if (isAscii(text)) {
        mWriter.String(text.data(), size(text));
        return;
    }
    const std::string valid = asUtf8(text);
    mWriter.String(valid.data(), size(valid));
}

void Json::microseconds(int64_t nanoseconds) {
    const bool negative = nanoseconds < 0;
    const uint64_t size = negative ? -static_cast<uint64_t>(nanoseconds) : nanoseconds;
    char text[40];
    const int length =
        snprintf(text, sizeof(text), "%s%llu.%03u", negative ? "-" : "",
                 static_cast<unsigned long long>(size / 1000), static_cast<unsigned>(size % 1000));
    mWriter.RawValue(text, length, rapidjson::kNumberType);
}

}  // namespace orvtrace
