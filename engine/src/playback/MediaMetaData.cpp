// SPDX-License-Identifier: Apache-2.0
#include "playback/MediaMetaData.h"

#include <binder/Parcel.h>
#include <media/Metadata.h>
#include <stdlib.h>
#include <utils/String16.h>
#include <utils/String8.h>

#include <algorithm>
#include <string>

#include "base/EngineLog.h"
#include "base/Milliseconds.h"
#include "base/RecordText.h"
#include "inspect/ContainerInfo.h"

namespace orvtarn {
namespace {

using android::media::Metadata;

struct TextKey {
    Metadata::Type key;
    OrvWideText MetaDataInfo::* text;
    const char* tag;
};

const TextKey kTexts[] = {
    {Metadata::kTitle, &MetaDataInfo::mTitle, "title"},
    {Metadata::kArtist, &MetaDataInfo::mArtist, "artist"},
    {Metadata::kAlbum, &MetaDataInfo::mAlbum, "album"},
    {Metadata::kGenre, &MetaDataInfo::mGenre, "genre"},
    {Metadata::kComposer, &MetaDataInfo::mComposer, "composer"},
    {Metadata::kComment, &MetaDataInfo::mComment, "comment"},
};

struct NumberKey {
    Metadata::Type key;
    int32_t value;
};

std::string utf8Of(const OrvWideText& text) {
    const auto* end = std::find(text, text + ORV_TEXT_UNITS, uint16_t{0});
    const android::String8 utf8(reinterpret_cast<const char16_t*>(text),
                                static_cast<size_t>(end - text));
    return utf8.c_str();
}

// A text's record. The platform's class has no operation for those.
void appendText(android::Parcel* records, Metadata::Type key, const std::string& utf8) {
    constexpr int32_t kText = 1;
    const size_t begin = records->dataPosition();
    for (const int32_t word : {0, key, kText}) records->writeInt32(word);
    records->writeString16(android::String16(utf8.c_str()));
    const size_t end = records->dataPosition();
    records->setDataPosition(begin);
    records->writeInt32(static_cast<int32_t>(end - begin));
    records->setDataPosition(end);
}

class RecordWriter {
public:
    RecordWriter(const android::SortedVector<int>& keys, android::Parcel* records)
        : mKeys(keys), mRecords(records), mMetadata(records) {}

    void text(Metadata::Type key, const std::string& value) {
        if (!value.empty() && wants(key)) appendText(mRecords, key, value);
    }
    void number(Metadata::Type key, int32_t value) {
        if (value > 0 && wants(key)) mMetadata.appendInt32(key, value);
    }
    void flag(Metadata::Type key, bool value) {
        if (wants(key)) mMetadata.appendBool(key, value);
    }

private:
    bool wants(Metadata::Type key) const {
        return mKeys.isEmpty() || mKeys[0] == Metadata::kAny || mKeys.indexOf(key) >= 0;
    }

    const android::SortedVector<int>& mKeys;
    android::Parcel* const mRecords;
    Metadata mMetadata;
};

}  // namespace

bool MediaMetaData::get(MetaDataInfo& info) {
    if (mState.requireOpen("getMetaDataInfo") != android::NO_ERROR) return false;
    const bool described =
        mLoader.secondReading()->withFile([&](MediaFile& file) { info = metaDataInfo(file); });
    if (!described) info = fromMpv();
    return true;
}

// For media that cannot be read twice: what playback has found.
MetaDataInfo MediaMetaData::fromMpv() const {
    MetaDataInfo info;
    const auto tag = [this](const std::string& name) {
        return mMpv.getString(("metadata/by-key/" + name).c_str()).value_or("");
    };
    for (const TextKey& key : kTexts) setWideText(info.*key.text, tag(key.tag));
    setWideText(info.mContainer, mMpv.getString("file-format").value_or(""));
    info.mDuration = toMilliseconds(mMpv.getDouble("duration").value_or(0));
    info.mChapterCount = static_cast<int32_t>(mMpv.getInt("chapters").value_or(0));
    info.mYear = std::max(atoi(tag("date").c_str()), 0);
    info.mTrackNumber = std::max(atoi(tag("track").c_str()), 0);
    info.mDiscNumber = std::max(atoi(tag("disc").c_str()), 0);
    return info;
}

android::status_t MediaMetaData::write(const android::SortedVector<int>& keys,
                                       android::Parcel* records) {
    if (records == nullptr) return failed(android::BAD_VALUE, "getMetadata", "null argument");
    MetaDataInfo info;
    if (!get(info)) return android::INVALID_OPERATION;
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    RecordWriter writer(keys, records);
    for (const TextKey& key : kTexts) writer.text(key.key, utf8Of(info.*key.text));
    if (info.mYear > 0) writer.text(Metadata::kDate, std::to_string(info.mYear));
    const NumberKey numbers[] = {
        {Metadata::kDuration, toMilliseconds(now.duration)},
        {Metadata::kCdTrackNum, info.mTrackNumber},
        {Metadata::kBitRate, info.mBitRate},
        {Metadata::kVideoHeight, now.height},
        {Metadata::kVideoWidth, now.width},
        {Metadata::kNumTracks, static_cast<int32_t>(mMpv.getInt("track-list/count").value_or(0))},
    };
    for (const NumberKey& number : numbers) writer.number(number.key, number.value);
    writer.flag(Metadata::kPauseAvailable, true);
    writer.flag(Metadata::kSeekBackwardAvailable, now.seekable);
    writer.flag(Metadata::kSeekForwardAvailable, now.seekable);
    writer.flag(Metadata::kSeekAvailable, now.seekable);
    return android::NO_ERROR;
}

}  // namespace orvtarn
