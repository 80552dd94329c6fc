// SPDX-License-Identifier: Apache-2.0
#include "inspect/StreamPicture.h"

#include <math.h>
#include <stdint.h>
#include <string.h>

#include <algorithm>

#include "base/LibraryVersions.h"

extern "C" {
#include <libavformat/avformat.h>
#include <libavutil/frame.h>
#include <libavutil/pixdesc.h>
}

namespace orvtarn {
namespace {

constexpr double kGreatestSize = 1 << 16;

template <class Record>
const Record* frameData(const AVFrame& frame, AVFrameSideDataType type) {
    const AVFrameSideData* data = av_frame_get_side_data(&frame, type);
    return data == nullptr ? nullptr : reinterpret_cast<const Record*>(data->data);
}

template <class Record>
const Record* streamData(const AVStream& stream, AVPacketSideDataType type) {
    return reinterpret_cast<const Record*>(streamSideData(stream, type, sizeof(Record)));
}

double peakOf(const LightMetadata& light) {
    if (light.content != nullptr && light.content->MaxCLL > 0) return light.content->MaxCLL;
    const bool isKnown = light.mastering != nullptr && light.mastering->has_luminance != 0 &&
                         light.mastering->max_luminance.den > 0;
    return isKnown ? av_q2d(light.mastering->max_luminance) : 0;
}

const AVPixFmtDescriptor* formatOf(const AVFrame& frame) {
    return av_pix_fmt_desc_get(static_cast<AVPixelFormat>(frame.format));
}

bool isRgb(const AVFrame& frame) {
    const AVPixFmtDescriptor* format = formatOf(frame);
    return format != nullptr && (format->flags & AV_PIX_FMT_FLAG_RGB) != 0;
}

}  // namespace

Orientation orientationOf(const AVStream& stream) {
    constexpr size_t kMatrixSize = 9 * sizeof(int32_t);
    return orientationOf(reinterpret_cast<const int32_t*>(
        streamSideData(stream, AV_PKT_DATA_DISPLAYMATRIX, kMatrixSize)));
}

LightMetadata lightOf(const AVStream& stream) {
    return {streamData<AVMasteringDisplayMetadata>(stream, AV_PKT_DATA_MASTERING_DISPLAY_METADATA),
            streamData<AVContentLightMetadata>(stream, AV_PKT_DATA_CONTENT_LIGHT_LEVEL)};
}

LightMetadata lightOf(const AVFrame& frame) {
    return {frameData<AVMasteringDisplayMetadata>(frame, AV_FRAME_DATA_MASTERING_DISPLAY_METADATA),
            frameData<AVContentLightMetadata>(frame, AV_FRAME_DATA_CONTENT_LIGHT_LEVEL)};
}

AVRational pixelAspect(const AVFormatContext& media, const AVStream& stream) {
    const AVRational aspect = av_guess_sample_aspect_ratio(const_cast<AVFormatContext*>(&media),
                                                           const_cast<AVStream*>(&stream), nullptr);
    return aspect.num > 0 && aspect.den > 0 ? aspect : AVRational{0, 1};
}

PictureSize displayedSize(const AVFormatContext& media, const AVStream& stream) {
    const AVCodecParameters& codec = *stream.codecpar;
    if (codec.width <= 0 || codec.height <= 0) return {};
    const AVRational aspect = pixelAspect(media, stream);
    const double width = codec.width * (aspect.num > 0 ? av_q2d(aspect) : 1);
    const PictureSize size = {static_cast<int>(lround(std::clamp(width, 1.0, kGreatestSize))),
                              codec.height};
    if (!orientationOf(stream).isLying()) return size;
    return {size.height, size.width};
}

AVColorSpace matrixOf(const AVFrame& frame) {
    if (isRgb(frame)) return AVCOL_SPC_RGB;
    if (frame.colorspace != AVCOL_SPC_UNSPECIFIED) return frame.colorspace;
    return frame.width >= 1280 || frame.height > 576 ? AVCOL_SPC_BT709 : AVCOL_SPC_SMPTE170M;
}

PictureTraits traitsOf(const AVStream& stream, const AVFrame& frame) {
    PictureTraits traits;
    traits.width = frame.width;
    traits.height = frame.height;
    traits.orientation = orientationOf(stream);
    traits.isInterlaced = isInterlaced(frame);
    traits.transfer = frame.color_trc;
    traits.primaries = frame.color_primaries;
    traits.range = frame.color_range;
    traits.matrix = isRgb(frame) ? AVCOL_SPC_RGB : frame.colorspace;
    const double peak = peakOf(lightOf(frame));
    traits.peakLuminance = peak > 0 ? peak : peakOf(lightOf(stream));
    return traits;
}

}  // namespace orvtarn
