// SPDX-License-Identifier: Apache-2.0
// What the five track methods ask of the virtual machine on every call.
#include "TrackFixture.h"

namespace orvtest {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

const int kTracks = 2;

// One of the methods, its Java callback, and the local references of a call
// that hands over kTracks tracks, or one for a method without a table.
struct TrackMethod {
    std::string name;
    std::string callback;
    std::string signature;
    std::function<Outcome(JniFixture&)> call;
    size_t locals;
};
void PrintTo(const TrackMethod& method, std::ostream* out) { *out << method.name; }

// A class each, one text a subtitle, eight texts an audio track.
std::vector<TrackMethod> trackMethods() {
    const std::string text = "Ljava/lang/String;";
    const std::string fourTexts = text + text + text + text;
    return {
        {"getVideoCodecInfo", "setVideoCodecInfo", "(IIIIII)V",
         [](JniFixture& f) { return f.call<jboolean>("native_getVideoCodecInfo", "()Z"); }, 1},
        {"getAllVideoTrackInfo", "setAllVideoCodecInfo", "(IIIIIIII)V",
         [](JniFixture& f) { return f.call<jint>("native_getAllVideoTrackInfo", "()I"); }, 1},
        {"getSubtitleTrackInfo", "setSubtitleTrackInfo", "(II" + text + "I)V",
         [](JniFixture& f) { return f.call<jboolean>("native_getSubtitleTrackInfo", "(I)Z", 0); },
         1 + 1},
        {"getAllSubtitleTrackInfo", "setAllSubtitleTrackInfo", "(IIII" + text + "I)V",
         [](JniFixture& f) { return f.call<jint>("native_getAllSubtitleTrackInfo", "()I"); },
         1 + kTracks},
        {"getAllAudioTrackInfo", "setAllAudioTrackInfo",
         "(IIIIIIII" + fourTexts + "I" + fourTexts + ")V",
         [](JniFixture& f) {
             return f.call<jint>("native_getAllAudioTrackInfo", "(Z)I", jboolean{JNI_TRUE});
         },
         1 + 8 * kTracks},
    };
}

class TrackReferencesTest : public JniFixture, public testing::WithParamInterface<TrackMethod> {
protected:
    void SetUp() override {
        JniFixture::SetUp();
        playerClass.method(GetParam().callback, GetParam().signature);
        ScriptedEngine& script = setUpPlayer();
        for (const char* kind : {"Video", "Subtitle", "Audio"}) {
            script.put("get" + std::string(kind) + "TrackCount", kTracks);
        }
        script.currentVideoCodec = codec(1);
        for (int index = 0; index < kTracks; ++index) {
            script.videoCodecs[index] = codec(1);
            script.subtitleTracks[index] = subtitle(1, "eng;");
            script.audioTracks[index] = AudioTrackInfo();
        }
    }
};

TEST_P(TrackReferencesTest, ClassAndMethodAreLookedUpOnEveryCall) {
    const std::string method = GetParam().callback + " " + GetParam().signature;
    for (int time : {1, 2}) {
        SCOPED_TRACE("call " + std::to_string(time));
        EXPECT_FALSE(GetParam().call(*this).java.empty());
        EXPECT_THAT(vm.callsOf("FindClass"), ElementsAre(kPlayerClass));
        EXPECT_THAT(vm.callsOf("GetMethodID"), ElementsAre(method));
    }
}

TEST_P(TrackReferencesTest, LocalReferencesAreLeftToTheMachine) {
    EXPECT_EQ(GetParam().call(*this).locals, GetParam().locals);
    EXPECT_THAT(vm.callsOf("DeleteLocalRef"), IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(Methods, TrackReferencesTest, testing::ValuesIn(trackMethods()),
                         [](const auto& info) { return info.param.name; });

}  // namespace
}  // namespace orvtest
