// SPDX-License-Identifier: Apache-2.0
#include "ContainerInfo.h"

#include <ctype.h>

#include <algorithm>
#include <cstdlib>
#include <initializer_list>

#include "RecordText.h"

extern "C" {
#include <libavformat/avformat.h>
}

namespace orvtarn {
namespace {

int32_t toInt32(int64_t value) {
    return static_cast<int32_t>(std::clamp<int64_t>(value, INT32_MIN, INT32_MAX));
}

int32_t toMilliseconds(int64_t time, AVRational base) {
    return toInt32(av_rescale_q(time, base, {1, 1000}));
}

const char* tagIn(const AVDictionary* tags, const char* name) {
    const AVDictionaryEntry* entry = av_dict_get(tags, name, nullptr, 0);
    return entry == nullptr || entry->value[0] == '\0' ? nullptr : entry->value;
}

bool isMedia(const AVStream& stream) {
    const AVMediaType type = stream.codecpar->codec_type;
    return (type == AVMEDIA_TYPE_AUDIO || type == AVMEDIA_TYPE_VIDEO) &&
           (stream.disposition & AV_DISPOSITION_ATTACHED_PIC) == 0;
}

// The first of the names that the container has, or one of its streams.
const char* tag(const AVFormatContext& media, std::initializer_list<const char*> names) {
    for (const char* name : names) {
        if (const char* value = tagIn(media.metadata, name)) return value;
    }
    // Where a container has tags, those of its streams are about the tracks.
    if (media.metadata != nullptr) return nullptr;
    for (unsigned i = 0; i < media.nb_streams; i++) {
        if (!isMedia(*media.streams[i])) continue;
        for (const char* name : names) {
            if (const char* value = tagIn(media.streams[i]->metadata, name)) return value;
        }
    }
    return nullptr;
}

// The number that the text begins with, at least 0.
int32_t leadingNumber(const char* text) {
    return text == nullptr ? 0 : toInt32(std::max(0LL, strtoll(text, nullptr, 10)));
}

// The second number of "3/12".
int32_t numberBehindSlash(const char* text) {
    const char* slash = text == nullptr ? nullptr : strchr(text, '/');
    return slash == nullptr ? 0 : leadingNumber(slash + 1);
}

// The first four digits in a row, as in "2021", "2021-03-04" and "4.3.2021".
int32_t yearOf(const char* date) {
    int digits = 0;
    for (const char* at = date; at != nullptr && *at != '\0'; at++) {
        digits = isdigit(static_cast<unsigned char>(*at)) ? digits + 1 : 0;
        if (digits == 4) return static_cast<int32_t>(strtol(at - 3, nullptr, 10));
    }
    return 0;
}

void setWideTag(OrvWideText& text, const char* value) {
    setWideText(text, value == nullptr ? "" : value);
}

void setNumbers(const AVFormatContext& media, MetaDataInfo& info) {
    const char* track = tag(media, {"track"});
    info.mTrackNumber = leadingNumber(track);
    info.mTrackTotal = numberBehindSlash(track);
    if (info.mTrackTotal == 0) {
        info.mTrackTotal = leadingNumber(tag(media, {"tracktotal", "totaltracks"}));
    }
    info.mDiscNumber = leadingNumber(tag(media, {"disc"}));
    info.mYear = yearOf(tag(media, {"date", "year"}));
    info.mBitRate = toInt32(std::max<int64_t>(0, media.bit_rate));
    if (media.duration > 0) info.mDuration = toMilliseconds(media.duration, AV_TIME_BASE_Q);
}

}  // namespace

MetaDataInfo metaDataInfo(const MediaFile& file) {
    const AVFormatContext& media = *file.context();
    MetaDataInfo info;
    setNumbers(media, info);
    setWideTag(info.mTitle, tag(media, {"title"}));
    setWideTag(info.mArtist, tag(media, {"artist", "album_artist"}));
    setWideTag(info.mAlbum, tag(media, {"album"}));
    setWideTag(info.mGenre, tag(media, {"genre"}));
    setWideTag(info.mComposer, tag(media, {"composer"}));
    setWideTag(info.mComment, tag(media, {"comment", "description"}));
    setWideTag(info.mContainer, media.iformat->long_name);
    info.mChapterCount = chapterCount(file);
    return info;
}

int chapterCount(const MediaFile& file) { return static_cast<int>(file.context()->nb_chapters); }

bool chapterRecord(const MediaFile& file, int chapter, SubtitleTrackInfo& info) {
    if (chapter < 0 || chapter >= chapterCount(file)) return false;
    const AVChapter& mark = *file.context()->chapters[chapter];
    info = SubtitleTrackInfo();
    info.mCodec = ORV_CHAPTER_CODEC;
    info.mTrackId = toMilliseconds(mark.start, mark.time_base);
    info.mFlags = mark.end == AV_NOPTS_VALUE ? -1 : toMilliseconds(mark.end, mark.time_base);
    const char* title = tagIn(mark.metadata, "title");
    setText(info.mText, title == nullptr ? "" : title);
    return true;
}

}  // namespace orvtarn
