// SPDX-License-Identifier: Apache-2.0
#include "inspect/StreamDescription.h"

#include <stdlib.h>
#include <string.h>

#include <algorithm>
#include <string>

#include "base/LibavValues.h"
#include "base/LibraryVersions.h"
#include "inspect/StreamPicture.h"

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
#include <libavutil/dovi_meta.h>
#include <libavutil/pixdesc.h>
}

namespace orvtarn {
namespace {

struct Disposition {
    int bit;
    const char* name;
};

const Disposition kDispositions[] = {
    {AV_DISPOSITION_DEFAULT, "default"},
    {AV_DISPOSITION_DUB, "dub"},
    {AV_DISPOSITION_ORIGINAL, "original"},
    {AV_DISPOSITION_COMMENT, "comment"},
    {AV_DISPOSITION_LYRICS, "lyrics"},
    {AV_DISPOSITION_KARAOKE, "karaoke"},
    {AV_DISPOSITION_FORCED, "forced"},
    {AV_DISPOSITION_HEARING_IMPAIRED, "hearing_impaired"},
    {AV_DISPOSITION_VISUAL_IMPAIRED, "visual_impaired"},
    {AV_DISPOSITION_CLEAN_EFFECTS, "clean_effects"},
    {AV_DISPOSITION_ATTACHED_PIC, "attached_pic"},
    {AV_DISPOSITION_TIMED_THUMBNAILS, "timed_thumbnails"},
    {AV_DISPOSITION_CAPTIONS, "captions"},
    {AV_DISPOSITION_DESCRIPTIONS, "descriptions"},
    {AV_DISPOSITION_METADATA, "metadata"},
    {AV_DISPOSITION_DEPENDENT, "dependent"},
    {AV_DISPOSITION_STILL_IMAGE, "still_image"},
};

std::string flagsOf(const AVStream& stream) {
    std::string flags;
    for (const Disposition& disposition : kDispositions) {
        if ((stream.disposition & disposition.bit) == 0) continue;
        flags += (flags.empty() ? "" : ",") + std::string(disposition.name);
    }
    return flags;
}

const char* kindOf(const AVStream& stream) {
    switch (stream.codecpar->codec_type) {
        case AVMEDIA_TYPE_VIDEO:
            return (stream.disposition & AV_DISPOSITION_ATTACHED_PIC) != 0 ? "picture" : "video";
        case AVMEDIA_TYPE_AUDIO:
            return "audio";
        case AVMEDIA_TYPE_SUBTITLE:
            return "subtitle";
        case AVMEDIA_TYPE_ATTACHMENT:
            return "attachment";
        default:
            return "data";
    }
}

const char* fieldOrderOf(const AVCodecParameters& codec) {
    switch (codec.field_order) {
        case AV_FIELD_PROGRESSIVE:
            return "progressive";
        case AV_FIELD_TT:
            return "tt";
        case AV_FIELD_BB:
            return "bb";
        case AV_FIELD_TB:
            return "tb";
        case AV_FIELD_BT:
            return "bt";
        default:
            return nullptr;
    }
}

// "und" is the code for no known language.
const char* languageOf(const AVStream& stream) {
    const char* code = tagOf(stream.metadata, "language");
    return strcmp(code, "und") == 0 ? "" : code;
}

void describeCodec(const AVCodecParameters& codec, DescriptionWriter& writer) {
    if (codec.codec_id == AV_CODEC_ID_NONE) return;
    writer.text("codec", avcodec_get_name(codec.codec_id));
    const AVCodecDescriptor* descriptor = avcodec_descriptor_get(codec.codec_id);
    if (descriptor != nullptr) writer.text("codecName", descriptor->long_name);
    char tag[AV_FOURCC_MAX_STRING_SIZE];
    if (codec.codec_tag != 0) writer.text("codecTag", av_fourcc_make_string(tag, codec.codec_tag));
    writer.text("profile", avcodec_profile_name(codec.codec_id, codec.profile));
    writer.positive("level", codec.level);
}

void describeColors(const AVCodecParameters& codec, DescriptionWriter& writer) {
    if (codec.color_primaries != AVCOL_PRI_UNSPECIFIED) {
        writer.text("primaries", av_color_primaries_name(codec.color_primaries));
    }
    if (codec.color_trc != AVCOL_TRC_UNSPECIFIED) {
        writer.text("transfer", av_color_transfer_name(codec.color_trc));
    }
    if (codec.color_space != AVCOL_SPC_UNSPECIFIED) {
        writer.text("matrix", av_color_space_name(codec.color_space));
    }
    if (codec.color_range != AVCOL_RANGE_UNSPECIFIED) {
        writer.text("range", av_color_range_name(codec.color_range));
    }
    if (codec.chroma_location != AVCHROMA_LOC_UNSPECIFIED) {
        writer.text("chromaLocation", av_chroma_location_name(codec.chroma_location));
    }
}

void describeLight(const AVStream& stream, DescriptionWriter& writer) {
    const LightMetadata light = lightOf(stream);
    if (light.mastering != nullptr && light.mastering->has_luminance != 0) {
        writer.luminance("masteringMinLuminance", light.mastering->min_luminance);
        writer.luminance("masteringMaxLuminance", light.mastering->max_luminance);
    }
    if (light.content != nullptr) {
        writer.positive("maxContentLight", light.content->MaxCLL);
        writer.positive("maxFrameAverageLight", light.content->MaxFALL);
    }
    const auto* vision = reinterpret_cast<const AVDOVIDecoderConfigurationRecord*>(
        streamSideData(stream, AV_PKT_DATA_DOVI_CONF, sizeof(AVDOVIDecoderConfigurationRecord)));
    if (vision != nullptr) writer.number("dolbyVisionProfile", vision->dv_profile);
}

AVRational displayAspect(const AVCodecParameters& codec, AVRational pixel) {
    AVRational aspect = {0, 1};
    if (pixel.num > 0) {
        av_reduce(&aspect.num, &aspect.den, int64_t{codec.width} * pixel.num,
                  int64_t{codec.height} * pixel.den, 1024 * 1024);
    }
    return aspect;
}

void describePicture(const AVFormatContext& media, const AVStream& stream,
                     DescriptionWriter& writer) {
    const AVCodecParameters& codec = *stream.codecpar;
    writer.positive("width", codec.width);
    writer.positive("height", codec.height);
    const PictureSize displayed = displayedSize(media, stream);
    writer.positive("displayWidth", displayed.width);
    writer.positive("displayHeight", displayed.height);
    const AVRational pixel = pixelAspect(media, stream);
    writer.ratio("pixelAspect", pixel, ':');
    writer.ratio("displayAspect", displayAspect(codec, pixel), ':');
    const Orientation orientation = orientationOf(stream);
    writer.positive("rotation", orientation.rotation);
    writer.positive("mirrored", orientation.isMirrored ? 1 : 0);
    const auto format = static_cast<AVPixelFormat>(codec.format);
    const AVPixFmtDescriptor* pixels = av_pix_fmt_desc_get(format);
    if (pixels != nullptr) {
        writer.text("pixelFormat", av_get_pix_fmt_name(format));
        writer.positive("bitDepth", pixels->comp[0].depth);
    }
    writer.text("fieldOrder", fieldOrderOf(codec));
    describeColors(codec, writer);
    writer.ratio("frameRate", stream.avg_frame_rate, '/');
    describeLight(stream, writer);
}

void describeSound(const AVCodecParameters& codec, DescriptionWriter& writer) {
    writer.positive("sampleRate", codec.sample_rate);
    writer.positive("channels", codec.ch_layout.nb_channels);
    char layout[128];
    if (codec.ch_layout.order != AV_CHANNEL_ORDER_UNSPEC &&
        av_channel_layout_describe(&codec.ch_layout, layout, sizeof(layout)) > 0) {
        writer.text("channelLayout", layout);
    }
    writer.text("sampleFormat", av_get_sample_fmt_name(static_cast<AVSampleFormat>(codec.format)));
    writer.positive("bitsPerSample", sampleBits(codec));
}

void describeAttachment(const AVStream& stream, DescriptionWriter& writer) {
    writer.text("fileName", tagOf(stream.metadata, "filename"));
    writer.text("mimeType", tagOf(stream.metadata, "mimetype"));
    writer.positive("size", stream.codecpar->extradata_size);
}

}  // namespace

// Matroska keeps the bit rate in a statistics tag.
int64_t bitRateOf(const AVStream& stream) {
    if (stream.codecpar->bit_rate > 0) return stream.codecpar->bit_rate;
    return std::max(0LL, strtoll(tagOf(stream.metadata, "BPS"), nullptr, 10));
}

int sampleBits(const AVCodecParameters& codec) {
    if (codec.bits_per_raw_sample > 0) return codec.bits_per_raw_sample;
    return av_get_exact_bits_per_sample(codec.codec_id);
}

void describeStream(const AVFormatContext& media, const AVStream& stream,
                    DescriptionWriter& writer) {
    const AVCodecParameters& codec = *stream.codecpar;
    writer.number("index", stream.index);
    writer.text("kind", kindOf(stream));
    describeCodec(codec, writer);
    writer.text("language", languageOf(stream));
    writer.text("title", tagOf(stream.metadata, "title"));
    writer.text("flags", flagsOf(stream));
    writer.time("startUs", stream.start_time, stream.time_base);
    writer.time("durationUs", stream.duration, stream.time_base);
    writer.positive("bitRate", bitRateOf(stream));
    if (codec.codec_type == AVMEDIA_TYPE_VIDEO) describePicture(media, stream, writer);
    if (codec.codec_type == AVMEDIA_TYPE_AUDIO) describeSound(codec, writer);
    if (codec.codec_type == AVMEDIA_TYPE_ATTACHMENT) describeAttachment(stream, writer);
}

}  // namespace orvtarn
