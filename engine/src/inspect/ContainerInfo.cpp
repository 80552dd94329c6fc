// SPDX-License-Identifier: Apache-2.0
#include "inspect/ContainerInfo.h"

#include <ctype.h>
#include <string.h>

#include <algorithm>
#include <cstdlib>
#include <initializer_list>

#include "base/LibavValues.h"
#include "base/RecordText.h"

extern "C" {
#include <libavformat/avformat.h>
}

namespace orvtarn {
namespace {

int32_t toMilliseconds(int64_t time, AVRational base) {
    return toInt32(av_rescale_q(time, base, {1, 1000}));
}

bool isMedia(const AVStream& stream) {
    const AVMediaType type = stream.codecpar->codec_type;
    return (type == AVMEDIA_TYPE_AUDIO || type == AVMEDIA_TYPE_VIDEO) &&
           (stream.disposition & AV_DISPOSITION_ATTACHED_PIC) == 0;
}

const char* firstTag(const AVDictionary* tags, std::initializer_list<const char*> names) {
    for (const char* name : names) {
        const char* value = tagOf(tags, name);
        if (*value != '\0') return value;
    }
    return "";
}

// The first of the names that has a value. Where a container has tags, those of
// its streams are about the tracks.
const char* tag(const AVFormatContext& media, std::initializer_list<const char*> names) {
    if (media.metadata != nullptr) return firstTag(media.metadata, names);
    for (unsigned i = 0; i < media.nb_streams; i++) {
        if (!isMedia(*media.streams[i])) continue;
        const char* value = firstTag(media.streams[i]->metadata, names);
        if (*value != '\0') return value;
    }
    return "";
}

// The number that the text begins with, at least 0.
int32_t leadingNumber(const char* text) {
    return toInt32(std::max(0LL, strtoll(text, nullptr, 10)));
}

// The second number of "3/12".
int32_t numberBehindSlash(const char* text) {
    const char* slash = strchr(text, '/');
    return slash == nullptr ? 0 : leadingNumber(slash + 1);
}

// The first four digits in a row, as in "2021", "2021-03-04" and "4.3.2021".
int32_t yearOf(const char* date) {
    int digits = 0;
    for (const char* at = date; *at != '\0'; at++) {
        digits = isdigit(static_cast<unsigned char>(*at)) ? digits + 1 : 0;
        if (digits == 4) return static_cast<int32_t>(strtol(at - 3, nullptr, 10));
    }
    return 0;
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
    setWideText(info.mTitle, tag(media, {"title"}));
    setWideText(info.mArtist, tag(media, {"artist", "album_artist"}));
    setWideText(info.mAlbum, tag(media, {"album"}));
    setWideText(info.mGenre, tag(media, {"genre"}));
    setWideText(info.mComposer, tag(media, {"composer"}));
    setWideText(info.mComment, tag(media, {"comment", "description"}));
    setWideText(info.mContainer, media.iformat->long_name);
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
    setText(info.mText, tagOf(mark.metadata, "title"));
    return true;
}

}  // namespace orvtarn
