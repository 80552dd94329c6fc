// SPDX-License-Identifier: Apache-2.0
#include "records/TrackRecords.h"

#include <string.h>

#include <algorithm>
#include <cmath>
#include <string>

#include "base/LibavValues.h"
#include "base/RecordText.h"
#include "inspect/StreamDescription.h"
#include "records/CodecFourCC.h"

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
}

namespace orvtarn {
namespace {

// Reads one entry of the track list. Members that are missing or of another
// type read as the empty value.
class Entry {
public:
    explicit Entry(const mpv_node& node) : mNode(node) {}

    const char* text(const char* name) const {
        const mpv_node* value = member(name, MPV_FORMAT_STRING);
        return value == nullptr ? "" : value->u.string;
    }
    int64_t integer(const char* name, int64_t missing = 0) const {
        const mpv_node* value = member(name, MPV_FORMAT_INT64);
        return value == nullptr ? missing : value->u.int64;
    }
    double number(const char* name) const {
        const mpv_node* value = member(name, MPV_FORMAT_DOUBLE);
        return value == nullptr || !std::isfinite(value->u.double_) ? 0 : value->u.double_;
    }
    bool isSet(const char* name) const {
        const mpv_node* value = member(name, MPV_FORMAT_FLAG);
        return value != nullptr && value->u.flag != 0;
    }

private:
    const mpv_node* member(const char* name, mpv_format format) const {
        if (mNode.format != MPV_FORMAT_NODE_MAP) return nullptr;
        const mpv_node_list& map = *mNode.u.list;
        for (int i = 0; i < map.num; i++) {
            if (strcmp(map.keys[i], name) != 0) continue;
            return map.values[i].format == format ? &map.values[i] : nullptr;
        }
        return nullptr;
    }

    const mpv_node& mNode;
};

int32_t flagsOf(const Entry& entry) {
    return (entry.isSet("default") ? ORV_TRACK_FLAG_DEFAULT : 0) |
           (entry.isSet("forced") ? ORV_TRACK_FLAG_FORCED : 0) |
           (entry.isSet("external") ? ORV_TRACK_FLAG_EXTERNAL : 0) |
           (entry.isSet("selected") ? ORV_TRACK_FLAG_SELECTED : 0);
}

VideoCodecInfo videoRecord(const Entry& entry) {
    VideoCodecInfo info;
    info.mCodec = codecFourCC(entry.text("codec"));
    info.mWidth = toInt32(entry.integer("demux-w"));
    info.mHeight = toInt32(entry.integer("demux-h"));
    info.mFrameRate = toInt32(std::llround(std::min(entry.number("demux-fps"), 1e6) * 1000));
    info.mBitRate = toInt32(entry.integer("demux-bitrate"));
    info.mFlags = flagsOf(entry);
    return info;
}

// libavcodec's description of the codec, or the bare name.
void setCodecName(OrvWideText& text, const char* name) {
    const AVCodecDescriptor* codec = avcodec_descriptor_get_by_name(name);
    setWideText(text, codec == nullptr || codec->long_name == nullptr ? name : codec->long_name);
}

AudioTrackInfo audioRecord(const Entry& entry) {
    AudioTrackInfo info;
    info.mCodec = codecFourCC(entry.text("codec"));
    info.mChannels = toInt32(entry.integer("demux-channel-count"));
    info.mSampleRate = toInt32(entry.integer("demux-samplerate"));
    info.mBitRate = toInt32(entry.integer("demux-bitrate"));
    info.mTrackId = toInt32(entry.integer("id"));
    info.mFlags = flagsOf(entry);
    setWideText(info.mTitle, entry.text("title"));
    setCodecName(info.mCodecName, entry.text("codec"));
    setWideText(info.mChannelLayout, entry.text("demux-channels"));
    for (OrvWideText* text : {&info.mProfile, &info.mComment, &info.mEncoder, &info.mHandler}) {
        clearText(*text);
    }
    setText(info.mLanguage, entry.text("lang"));
    return info;
}

SubtitleTrackInfo subtitleRecord(const Entry& entry) {
    SubtitleTrackInfo info;
    info.mTrackId = toInt32(entry.integer("id"));
    info.mCodec = codecFourCC(entry.text("codec"));
    setText(info.mText, std::string(entry.text("lang")) + ";" + entry.text("title"));
    info.mFlags = flagsOf(entry);
    setText(info.mLanguage, entry.text("lang"));
    return info;
}

template <typename Record>
Track<Record> track(const Entry& entry, const Record& record) {
    const bool isExternal = entry.isSet("external");
    return {record, entry.integer("id"), isExternal ? -1 : toInt32(entry.integer("ff-index", -1)),
            entry.isSet("selected"), toInt32(entry.integer("demux-rotation"))};
}

void addEntry(const Entry& entry, TrackTables& tables) {
    const std::string_view type = entry.text("type");
    const bool isPicture = entry.isSet("albumart");
    if (entry.integer("id") <= 0) return;
    if (type == "video" && !isPicture) tables.video.push_back(track(entry, videoRecord(entry)));
    if (type == "audio") tables.audio.push_back(track(entry, audioRecord(entry)));
    if (type == "sub") tables.subtitles.push_back(track(entry, subtitleRecord(entry)));
}

// The track's stream, when it is of the expected kind.
const AVStream* streamOf(const MediaFile& file, int index, AVMediaType type) {
    const AVStream* stream = file.stream(index);
    return stream != nullptr && stream->codecpar->codec_type == type ? stream : nullptr;
}

void addVideoDetails(const AVStream& stream, VideoCodecInfo& record) {
    const AVCodecParameters& codec = *stream.codecpar;
    if (codec.width > 0 && codec.height > 0) {
        record.mWidth = codec.width;
        record.mHeight = codec.height;
    }
    const AVRational rate = stream.avg_frame_rate;
    if (rate.num > 0 && rate.den > 0) {
        record.mFrameRate = toInt32(av_rescale(rate.num, 1000, rate.den));
    }
    if (bitRateOf(stream) > 0) record.mBitRate = toInt32(bitRateOf(stream));
}

// The rate as decoded: high-efficiency AAC declares half of it.
void addAudioDetails(const AVStream& stream, AudioTrackInfo& record) {
    const AVCodecParameters& codec = *stream.codecpar;
    if (codec.sample_rate > 0) record.mSampleRate = codec.sample_rate;
    if (codec.ch_layout.nb_channels > 0) record.mChannels = codec.ch_layout.nb_channels;
    if (bitRateOf(stream) > 0) record.mBitRate = toInt32(bitRateOf(stream));
    record.mBitsPerSample = sampleBits(codec);
}

void setChannelLayout(OrvWideText& text, const AVChannelLayout& layout) {
    char name[ORV_TEXT_UNITS * 3];
    const int length = av_channel_layout_describe(&layout, name, sizeof(name));
    if (layout.nb_channels > 0 && length > 0) setWideText(text, name);
}

}  // namespace

TrackTables trackTables(const mpv_node& trackList) {
    TrackTables tables;
    if (trackList.format != MPV_FORMAT_NODE_ARRAY) return tables;
    for (int i = 0; i < trackList.u.list->num; i++) {
        addEntry(Entry(trackList.u.list->values[i]), tables);
    }
    return tables;
}

// mpv reports what containers declare; the codec's own word is in the stream.
void addContainerDetails(const MediaFile& file, TrackTables& tables) {
    for (auto& track : tables.video) {
        const AVStream* stream = streamOf(file, track.streamIndex, AVMEDIA_TYPE_VIDEO);
        if (stream != nullptr) addVideoDetails(*stream, track.record);
    }
    for (auto& track : tables.audio) {
        const AVStream* stream = streamOf(file, track.streamIndex, AVMEDIA_TYPE_AUDIO);
        if (stream != nullptr) addAudioDetails(*stream, track.record);
    }
}

void addAudioTexts(const MediaFile& file, Track<AudioTrackInfo>& track) {
    const AVStream* stream = streamOf(file, track.streamIndex, AVMEDIA_TYPE_AUDIO);
    if (stream == nullptr) return;
    const AVCodecParameters& codec = *stream->codecpar;
    const char* profile = avcodec_profile_name(codec.codec_id, codec.profile);
    setWideText(track.record.mProfile, profile == nullptr ? "" : profile);
    setChannelLayout(track.record.mChannelLayout, codec.ch_layout);
    setWideText(track.record.mComment, tagOf(stream->metadata, "comment"));
    setWideText(track.record.mEncoder, tagOf(stream->metadata, "encoder"));
    setWideText(track.record.mHandler, tagOf(stream->metadata, "handler_name"));
}

}  // namespace orvtarn
