// SPDX-License-Identifier: Apache-2.0
#include "base/LibraryVersions.h"

#include <string.h>

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
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
    {"sub-outline-color", "sub-border-color"},
};

}  // namespace

const char* formerMpvName(const char* name) {
    for (const Renamed& renamed : kRenamed) {
        if (strcmp(renamed.name, name) == 0) return renamed.formerName;
    }
    return nullptr;
}

const int32_t* displayMatrix(const AVStream& stream) {
    const uint8_t* matrix = nullptr;
    // FFmpeg 6.1 moved a stream's side data to its parameters.
#if LIBAVCODEC_VERSION_INT >= AV_VERSION_INT(60, 31, 102)
    const AVCodecParameters& parameters = *stream.codecpar;
    const AVPacketSideData* data = av_packet_side_data_get(
        parameters.coded_side_data, parameters.nb_coded_side_data, AV_PKT_DATA_DISPLAYMATRIX);
    if (data != nullptr) matrix = data->data;
#else
    matrix = av_stream_get_side_data(&stream, AV_PKT_DATA_DISPLAYMATRIX, nullptr);
#endif
    return reinterpret_cast<const int32_t*>(matrix);
}

}  // namespace orvtarn
