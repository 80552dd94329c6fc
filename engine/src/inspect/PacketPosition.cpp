// SPDX-License-Identifier: Apache-2.0
#include "inspect/PacketPosition.h"

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
}

#include <algorithm>
#include <functional>

namespace orvtarn {
namespace {

// A frame that a time just misses by rounding is still meant.
constexpr double kRounding = 0.0005;

constexpr int64_t kFirstRunUp = 64 * 1024;  // bytes

const AVStream* leadingStream(MediaFile& file) {
    AVFormatContext* context = file.context();
    int index = av_find_best_stream(context, AVMEDIA_TYPE_VIDEO, -1, -1, nullptr, 0);
    const AVStream* video = index >= 0 ? file.stream(index) : nullptr;
    if (video != nullptr && (video->disposition & AV_DISPOSITION_ATTACHED_PIC) == 0) return video;
    index = av_find_best_stream(context, AVMEDIA_TYPE_AUDIO, -1, -1, nullptr, 0);
    return index >= 0 ? file.stream(index) : nullptr;
}

double startOf(const MediaFile& file) { return static_cast<double>(file.startUs()) / AV_TIME_BASE; }

// Calls the visitor with each packet of the stream from here on, until it says
// false.
void eachPacket(MediaFile& file, const AVStream& stream,
                const std::function<bool(const AVPacket&)>& visit) {
    AVPacket* packet = av_packet_alloc();
    bool goesOn = packet != nullptr;
    while (goesOn && av_read_frame(file.context(), packet) >= 0) {
        const bool counts = packet->stream_index == stream.index && packet->pos >= 0 &&
                            packet->pts != AV_NOPTS_VALUE;
        goesOn = !counts || visit(*packet);
        av_packet_unref(packet);
    }
    av_packet_free(&packet);
}

// The timestamp of the last packet that the format's own index has at or before
// a byte; of the first one where there is no index.
int64_t indexedTimeBefore(const AVStream& stream, int64_t position) {
    auto* indexed = const_cast<AVStream*>(&stream);
    const int count = avformat_index_get_entries_count(indexed);
    int64_t time = INT64_MIN;
    for (int i = 0; i < count; i++) {
        const AVIndexEntry* entry = avformat_index_get_entry(indexed, i);
        if (entry->pos <= position && (entry->flags & AVINDEX_KEYFRAME) != 0) {
            time = entry->timestamp;
        }
    }
    return time;
}

bool seeksByBytes(const AVInputFormat& format) {
    return (format.flags & AVFMT_TS_DISCONT) != 0 && (format.flags & AVFMT_NO_BYTE_SEEK) == 0;
}

bool seekByIndex(MediaFile& file, const AVStream& stream, int64_t position) {
    int64_t time = indexedTimeBefore(stream, position);
    if (time == INT64_MIN) time = stream.start_time == AV_NOPTS_VALUE ? 0 : stream.start_time;
    return av_seek_frame(file.context(), stream.index, time, AVSEEK_FLAG_BACKWARD) >= 0;
}

// The timestamp of the last packet from here on that lies at or before a byte.
std::optional<int64_t> lastPacketBefore(MediaFile& file, const AVStream& stream, int64_t position) {
    std::optional<int64_t> time;
    eachPacket(file, stream, [&](const AVPacket& packet) {
        if (packet.pos <= position) time = packet.pts;
        return packet.pos <= position;
    });
    return time;
}

std::optional<int64_t> packetTimeAt(MediaFile& file, const AVStream& stream, int64_t position) {
    if (!seeksByBytes(*file.context()->iformat)) {
        if (!seekByIndex(file, stream, position)) return {};
        return lastPacketBefore(file, stream, position);
    }
    // A seek arrives at the next whole packet: it begins further and further
    // ahead until there is one before the byte.
    for (int64_t ahead = kFirstRunUp;; ahead *= 8) {
        const int64_t from = std::max<int64_t>(position - ahead, 0);
        if (av_seek_frame(file.context(), -1, from, AVSEEK_FLAG_BYTE) < 0) return {};
        const std::optional<int64_t> time = lastPacketBefore(file, stream, position);
        if (time || from == 0) return time;
    }
}

}  // namespace

std::optional<int64_t> byteAtTime(MediaFile& file, double seconds) {
    const AVStream* stream = leadingStream(file);
    if (stream == nullptr) return {};
    const double base = av_q2d(stream->time_base);
    const double target = seconds + startOf(file) + kRounding;
    const auto time = static_cast<int64_t>(target / base);
    if (av_seek_frame(file.context(), stream->index, time, AVSEEK_FLAG_BACKWARD) < 0) return {};
    std::optional<int64_t> position;
    int64_t latest = INT64_MIN;
    eachPacket(file, *stream, [&](const AVPacket& packet) {
        if (packet.pts <= time && packet.pts >= latest) {
            latest = packet.pts;
            position = packet.pos;
        }
        return packet.dts == AV_NOPTS_VALUE ? packet.pts <= time : packet.dts <= time;
    });
    return position;
}

std::optional<double> timeAtByte(MediaFile& file, int64_t position) {
    const AVStream* stream = leadingStream(file);
    if (stream == nullptr) return {};
    std::optional<int64_t> time = packetTimeAt(file, *stream, position);
    // What lies before the first packet belongs to it.
    if (!time && stream->start_time != AV_NOPTS_VALUE) time = stream->start_time;
    if (!time) return {};
    const double seconds = static_cast<double>(*time) * av_q2d(stream->time_base);
    return std::max(seconds - startOf(file), 0.0);
}

}  // namespace orvtarn
