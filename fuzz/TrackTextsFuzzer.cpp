// SPDX-License-Identifier: Apache-2.0
//
// Texts of media, whatever their bytes, from the engine's records to Java's
// strings. Input, a record each: "audio" and its 8 texts, "subtitle" and its text,
// "meta" and its 7 texts; before one of them "units" takes the texts as pairs of
// bytes, each a UTF-16 unit, as another engine might leave them.
#include <string.h>

#include <algorithm>

#include "FakeJni/ModifiedUtf8.h"
#include "base/RecordText.h"
#include "support/JavaObjects.h"
#include "support/PlayerMachine.h"
#include "support/Require.h"
#include "support/Words.h"

namespace {

using orvfuzz::require;
using Texts = std::vector<std::u16string>;

constexpr int kMostRecords = 50;

std::u16string unitsOf(const OrvWideText& text) {
    return {text, std::find(text, text + ORV_TEXT_UNITS, 0)};
}
std::u16string unitsOf(const OrvText& text) {
    std::u16string units;
    require(fakejni::fromModifiedUtf8(text, &units), "an 8-bit text is modified UTF-8");
    return units;
}

class Records {
public:
    explicit Records(orvfuzz::Words input) : words(input), engine(machine.setUp()) {}

    void run() {
        for (int i = 0; i < kMostRecords && !words.atEnd(); i++) {
            const std::string_view word = words.next();
            machine.vm.forgetCalls();
            if (word == "audio") audio();
            if (word == "subtitle") subtitle();
            if (word == "meta") meta();
            asUnits = word == "units";
        }
        machine.finish();
    }

private:
    void fill(OrvWideText& text) {
        const std::string bytes = words.text();
        if (!asUnits) return orvtarn::setWideText(text, bytes);
        clearText(text);
        memcpy(text, bytes.data(), std::min(bytes.size(), sizeof(text)));
    }
    void fill(OrvText& text) { orvtarn::setText(text, words.text()); }

    template <typename Record, typename Text, typename... Members>
    void fillAll(Record& record, Texts& expected, Text Record::* member, Members... rest) {
        fill(record.*member);
        expected.push_back(unitsOf(record.*member));
        if constexpr (sizeof...(rest) > 0) fillAll(record, expected, rest...);
    }

    void audio() {
        AudioTrackInfo record;
        Texts expected;
        fillAll(record, expected, &AudioTrackInfo::mTitle, &AudioTrackInfo::mCodecName,
                &AudioTrackInfo::mChannelLayout, &AudioTrackInfo::mProfile,
                &AudioTrackInfo::mComment, &AudioTrackInfo::mEncoder, &AudioTrackInfo::mHandler,
                &AudioTrackInfo::mLanguage);
        engine.put("getAudioTrackCount", 1);
        engine.audioTracks[0] = record;
        machine.call<jint>("native_getAllAudioTrackInfo", "(Z)I", jboolean{1});
        requireTexts(expected);
    }
    void subtitle() {
        SubtitleTrackInfo record;
        Texts expected;
        fillAll(record, expected, &SubtitleTrackInfo::mText);
        engine.put("getSubtitleTrackCount", 1);
        engine.subtitleTracks[0] = record;
        machine.call<jint>("native_getAllSubtitleTrackInfo", "()I");
        requireTexts(expected);
        machine.vm.forgetCalls();
        machine.call<jboolean>("native_getSubtitleTrackInfo", "(I)Z", jint{0});
        requireTexts(expected);
    }
    void meta() {
        MetaDataInfo record;
        Texts expected;
        fillAll(record, expected, &MetaDataInfo::mTitle, &MetaDataInfo::mArtist,
                &MetaDataInfo::mAlbum, &MetaDataInfo::mGenre, &MetaDataInfo::mComposer,
                &MetaDataInfo::mContainer, &MetaDataInfo::mComment);
        engine.metaDataInfo = record;
        machine.call<jboolean>("native_getMetaDataInfo", "()Z");
        requireTexts(expected);
    }

    void requireTexts(const Texts& expected) {
        const auto calls = machine.vm.javaCalls();
        require(calls.size() == 1, "Java gets the record once");
        Texts found;
        for (const fakejni::Value& value : calls[0].args) {
            if (value.type == 'L') found.push_back(*value.object->text);
        }
        require(found == expected, "every text arrives, to the last character");
        machine.requireNoViolations();
    }

    orvfuzz::Words words;
    orvfuzz::PlayerMachine machine;
    orvtest::ScriptedEngine& engine;
    bool asUnits = false;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    Records({data, size}).run();
    return 0;
}
