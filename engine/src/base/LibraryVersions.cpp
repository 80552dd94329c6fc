// SPDX-License-Identifier: Apache-2.0
#include "base/LibraryVersions.h"

#include <string.h>

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavfilter/avfilter.h>
#include <libavfilter/buffersrc.h>
#include <libavformat/avformat.h>
#include <libavutil/frame.h>
}

namespace orvtarn {
namespace {

struct Renamed {
    const char* name;
    const char* formerName;
};

// mpv 0.40 has the first name, 0.35 the second.
const Renamed kRenamed[] = {
    {"load-console", "load-osd-console"},
    {"play-direction", "play-dir"},
    {"sub-outline-color", "sub-border-color"},
};

}  // namespace

const char* formerMpvName(const char* name) {
    for (const Renamed& renamed : kRenamed) {
        if (strcmp(renamed.name, name) == 0) return renamed.formerName;
    }
    return nullptr;
}

const uint8_t* streamSideData(const AVStream& stream, AVPacketSideDataType type, size_t size) {
    const uint8_t* found = nullptr;
    size_t length = 0;
    // FFmpeg 6.1 moved a stream's side data to its parameters.
#if LIBAVCODEC_VERSION_INT >= AV_VERSION_INT(60, 31, 102)
    const AVCodecParameters& parameters = *stream.codecpar;
    const AVPacketSideData* data =
        av_packet_side_data_get(parameters.coded_side_data, parameters.nb_coded_side_data, type);
    if (data != nullptr) {
        found = data->data;
        length = data->size;
    }
#else
    found = av_stream_get_side_data(&stream, type, &length);
#endif
    return length < size ? nullptr : found;
}

bool isInterlaced(const AVFrame& frame) {
#if LIBAVUTIL_VERSION_INT >= AV_VERSION_INT(58, 7, 100)
    return (frame.flags & AV_FRAME_FLAG_INTERLACED) != 0;
#else
    return frame.interlaced_frame != 0;
#endif
}

void setSourceColors(AVBufferSrcParameters& parameters, const AVFrame& like) {
    // FFmpeg 7.0 negotiates colours between filters.
#if LIBAVFILTER_VERSION_INT >= AV_VERSION_INT(10, 0, 100)
    parameters.color_space = like.colorspace;
    parameters.color_range = like.color_range;
#else
    static_cast<void>(parameters);
    static_cast<void>(like);
#endif
}

}  // namespace orvtarn
