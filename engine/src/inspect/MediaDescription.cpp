// SPDX-License-Identifier: Apache-2.0
#include "inspect/MediaDescription.h"

#include "base/RecordText.h"
#include "inspect/StreamDescription.h"

extern "C" {
#include <libavformat/avformat.h>
}

namespace orvtarn {
namespace {

template <class Record>
bool writeTrack(const std::vector<Track<Record>>& table, int stream, DescriptionWriter& writer) {
    for (size_t i = 0; i < table.size(); i++) {
        if (table[i].streamIndex != stream) continue;
        writer.number("track", static_cast<int64_t>(i));
        return true;
    }
    return false;
}

void describeContainer(const AVFormatContext& media, DescriptionWriter& writer) {
    writer.section("media");
    writer.text("format", media.iformat->name);
    writer.text("formatName", media.iformat->long_name);
    writer.time("durationUs", media.duration, AV_TIME_BASE_Q);
    writer.time("startUs", media.start_time, AV_TIME_BASE_Q);
    writer.positive("bitRate", media.bit_rate);
    writer.positive("size", media.pb == nullptr ? 0 : avio_size(media.pb));
    writer.number("streams", media.nb_streams);
}

}  // namespace

std::string describeMedia(const MediaFile& file, const TrackTables& tables) {
    const AVFormatContext& media = *file.context();
    DescriptionWriter writer;
    describeContainer(media, writer);
    for (unsigned i = 0; i < media.nb_streams; i++) {
        writer.section("stream");
        describeStream(media, *media.streams[i], writer);
        const int index = media.streams[i]->index;
        if (!writeTrack(tables.video, index, writer) && !writeTrack(tables.audio, index, writer)) {
            writeTrack(tables.subtitles, index, writer);
        }
    }
    return writer.take();
}

bool descriptionRecord(const std::string& text, int piece, SubtitleTrackInfo& info) {
    if (piece < 0) return false;
    std::string_view rest = text;
    SubtitleTrackInfo record;
    for (int i = 0; i <= piece; i++) {
        if (rest.empty()) return false;
        rest.remove_prefix(setText(record.mText, rest));
    }
    record.mCodec = ORV_DESCRIPTION_CODEC;
    info = record;
    return true;
}

}  // namespace orvtarn
