// SPDX-License-Identifier: Apache-2.0
#include "source/ServerProbe.h"

#include <algorithm>
#include <chrono>
#include <string>
#include <vector>

extern "C" {
#include <libavformat/avio.h>
#include <libavutil/dict.h>
}

namespace orvtarn {
namespace {

using Clock = std::chrono::steady_clock;

constexpr std::chrono::seconds kLimit{3};
constexpr int64_t kSample = 64 * 1024;

int isLate(void* deadline) { return Clock::now() > *static_cast<Clock::time_point*>(deadline); }

}  // namespace

bool isServed(const MediaSource& source, int64_t position, int64_t size) {
    Clock::time_point deadline = Clock::now() + kLimit;
    const AVIOInterruptCB interrupt = {isLate, &deadline};
    AVDictionary* options = nullptr;
    av_dict_set(&options, "headers", headerLines(source.headers()).c_str(), 0);
    av_dict_set_int(&options, "offset", position, 0);
    AVIOContext* context = nullptr;
    const int error =
        avio_open2(&context, source.name().c_str(), AVIO_FLAG_READ, &interrupt, &options);
    av_dict_free(&options);
    if (error < 0) return false;
    // mpv's own buffer may have held what lies just before the break.
    std::vector<unsigned char> bytes(static_cast<size_t>(std::min(size - position, kSample)));
    const bool given = avio_read(context, bytes.data(), static_cast<int>(bytes.size())) ==
                       static_cast<int>(bytes.size());
    avio_closep(&context);
    return given;
}

}  // namespace orvtarn
