// SPDX-License-Identifier: Apache-2.0
// setParameter, getParameter and invoke: what they keep, do and refuse.
#include <binder/Parcel.h>
#include <orvtarn/Parameters.h>
#include <utils/String16.h>
#include <utils/String8.h>

#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class ParametersTest : public PlayerTest {
protected:
    static int32_t getInt32(TarnPlayer& player, int key) {
        Parcel reply;
        EXPECT_EQ(NO_ERROR, player.getParameter(key, &reply));
        reply.setDataPosition(0);
        return reply.readInt32();
    }
    status_t setInt32(int key, int32_t value) {
        Parcel request;
        request.writeInt32(value);
        request.setDataPosition(0);
        return player->setParameter(key, request);
    }
    status_t setText(int key, const char* value) {
        Parcel request;
        request.writeString16(String16(value));
        request.setDataPosition(0);
        return player->setParameter(key, request);
    }
    std::string getText(int key) {
        Parcel reply;
        String16 text;
        EXPECT_EQ(NO_ERROR, player->getParameter(key, &reply));
        reply.setDataPosition(0);
        EXPECT_EQ(NO_ERROR, reply.readString16(&text));
        return String8(text).c_str();
    }
    status_t invoke(int method, int32_t argument) {
        Parcel request;
        Parcel reply;
        request.writeInt32(method);
        request.writeInt32(argument);
        request.setDataPosition(0);
        return player->invoke(request, &reply);
    }
    status_t invoke(int method, const std::string& argument) {
        Parcel request;
        Parcel reply;
        request.writeInt32(method);
        request.writeString16(String16(argument.c_str()));
        request.setDataPosition(0);
        return player->invoke(request, &reply);
    }
    int subtitleTrack() {
        int index = -2;
        EXPECT_NE(0, player->getCurrentSubtitleIndex(&index));
        return index;
    }
    // Waits for subtitles on the grey picture, or for their absence.
    bool seesText(bool wanted = true) {
        return eventually([&] {
            const Picture picture = sink->newest();
            int bright = 0;
            for (size_t i = 1; i < picture.pixels.size(); i += 4) bright += picture.pixels[i] > 200;
            return !picture.pixels.empty() && (bright > 50) == wanted;
        });
    }
};

TEST_F(ParametersTest, ParametersAreKeptAndChecked) {
    EXPECT_EQ(NO_ERROR, setInt32(ORV_PARAMETER_NETWORK_TIMEOUT, 5000));
    EXPECT_EQ(5000, getInt32(*player, ORV_PARAMETER_NETWORK_TIMEOUT));
    EXPECT_EQ(BAD_VALUE, setInt32(ORV_PARAMETER_NETWORK_TIMEOUT, 999));
    EXPECT_EQ(NO_ERROR, setInt32(ORV_PARAMETER_KEEP_ASPECT, 0));
    EXPECT_EQ(0, getInt32(*player, ORV_PARAMETER_KEEP_ASPECT));
    EXPECT_EQ(NO_ERROR, setInt32(ORV_PARAMETER_AUDIO_DELAY, -250));
    EXPECT_EQ(-250, getInt32(*player, ORV_PARAMETER_AUDIO_DELAY));
    EXPECT_EQ(INVALID_OPERATION, setInt32(ORV_PARAMETER_FRAMES_DELIVERED, 1));
    EXPECT_EQ(BAD_VALUE, setInt32(999, 1));
    Parcel empty;
    EXPECT_EQ(NOT_ENOUGH_DATA, player->setParameter(ORV_PARAMETER_KEEP_ASPECT, empty));
    Parcel reply;
    EXPECT_EQ(BAD_VALUE, player->getParameter(999, &reply));
    EXPECT_EQ(BAD_VALUE, player->getParameter(ORV_PARAMETER_ENGINE_NAME, nullptr));
    EXPECT_EQ(NO_ERROR, player->getParameter(ORV_PARAMETER_ENGINE_NAME, &reply));
    EXPECT_GT(reply.dataSize(), 8u);
}

TEST_F(ParametersTest, InvokesMethods) {
    open("feature.mkv");
    Parcel request;
    Parcel reply;
    request.writeInt32(ORV_INVOKE_GET_TRACKS);
    request.setDataPosition(0);
    ASSERT_EQ(NO_ERROR, player->invoke(request, &reply));
    reply.setDataPosition(0);
    EXPECT_EQ(5, reply.readInt32());
    EXPECT_EQ(ORV_TRACK_KIND_VIDEO, reply.readInt32());
    Parcel select;
    select.writeInt32(ORV_INVOKE_SELECT_TRACK);
    select.writeInt32(2);
    select.setDataPosition(0);
    ASSERT_EQ(NO_ERROR, player->invoke(select, &reply));
    int index = -1;
    EXPECT_NE(0, player->getCurrentAudioIndex(&index));
    EXPECT_EQ(1, index);
    Parcel unknown;
    unknown.writeInt32(77);
    unknown.setDataPosition(0);
    EXPECT_EQ(BAD_VALUE, player->invoke(unknown, &reply));
    EXPECT_EQ(NOT_ENOUGH_DATA, player->invoke(Parcel(), &reply));
}

TEST_F(ParametersTest, AspectIsKeptOrNot) {
    sink->setDefaultSize(400, 400);
    open("plain.mp4");
    ASSERT_TRUE(eventually([&] { return sink->newest().width == 400; }));
    EXPECT_LT(sink->newest().brightness(0, 0, 1000, 200), 5) << "black bars";
    ASSERT_EQ(NO_ERROR, setInt32(ORV_PARAMETER_KEEP_ASPECT, 0));
    EXPECT_TRUE(eventually([&] { return sink->newest().brightness(0, 0, 1000, 200) > 50; }));
}

TEST_F(ParametersTest, SubtitlesAreHiddenWhateverIsSelected) {
    open("plain.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(4000, 0));
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(seesText());
    ASSERT_EQ(NO_ERROR, setInt32(ORV_PARAMETER_SUBTITLES_VISIBLE, 0));
    EXPECT_TRUE(seesText(false));
    EXPECT_EQ(0, getInt32(*player, ORV_PARAMETER_SUBTITLES_VISIBLE));
    EXPECT_EQ(0, subtitleTrack());
    ASSERT_EQ(NO_ERROR, setInt32(ORV_PARAMETER_SUBTITLES_VISIBLE, 1));
    EXPECT_TRUE(seesText());
}

TEST_F(ParametersTest, EncodingsAreThoseOfIconv) {
    constexpr int kKey = ORV_PARAMETER_SUBTITLE_ENCODING;
    EXPECT_EQ("auto", getText(kKey));
    for (const char* name : {"ISO-8859-5", "cp1251", "auto", "UTF-8"}) {
        EXPECT_EQ(NO_ERROR, setText(kKey, name)) << name;
        EXPECT_EQ(name, getText(kKey));
    }
    for (const char* name : {"", "no such encoding", "latin-1,auto"}) {
        EXPECT_EQ(BAD_VALUE, setText(kKey, name)) << name;
    }
    EXPECT_EQ("UTF-8", getText(kKey)) << "what is refused changes nothing";
}

// The same bytes are other letters, and so another picture.
TEST_F(ParametersTest, TheEncodingIsUsed) {
    std::vector<Picture> pictures;
    for (const char* name : {"ISO-8859-1", "ISO-8859-5", "ISO-8859-1"}) {
        ASSERT_EQ(NO_ERROR, setText(ORV_PARAMETER_SUBTITLE_ENCODING, name));
        open("plain.mp4");
        ASSERT_EQ(NO_ERROR, player->seekTo(4000, 0));
        ASSERT_TRUE(player->setSubtitleDataSource(mediaPath("latin1.srt").c_str()));
        ASSERT_TRUE(seesText());
        pictures.push_back(sink->newest());
        player->reset();
        open("silent.mp4");
        ASSERT_TRUE(eventually([&] { return sink->newest().width == 320; }));
        player->reset();
    }
    EXPECT_GT(pictures[0].differences(pictures[1]), 50);
    EXPECT_EQ(0, pictures[0].differences(pictures[2]));
}

TEST_F(ParametersTest, InvokeAddsSelectsAndDeselects) {
    open("plain.mkv");
    const std::string lines = mediaPath("lines.srt");
    EXPECT_EQ(NO_ERROR, invoke(ORV_INVOKE_ADD_SUBTITLES, lines));
    int count = 0;
    EXPECT_TRUE(player->getSubtitleTrackCount(count));
    EXPECT_EQ(3, count);
    EXPECT_EQ(-1, subtitleTrack());
    EXPECT_EQ(NAME_NOT_FOUND, invoke(ORV_INVOKE_ADD_SUBTITLES, mediaPath("missing.srt")));
    EXPECT_EQ(BAD_VALUE, invoke(ORV_INVOKE_ADD_SUBTITLES, mediaPath("garbage.bin")));
    // One picture and one sound come before the subtitles.
    EXPECT_EQ(NO_ERROR, invoke(ORV_INVOKE_SELECT_TRACK, 4));
    EXPECT_EQ(2, subtitleTrack());
    EXPECT_EQ(BAD_VALUE, invoke(ORV_INVOKE_DESELECT_TRACK, 3)) << "is not selected";
    EXPECT_EQ(NO_ERROR, invoke(ORV_INVOKE_DESELECT_TRACK, 4));
    EXPECT_EQ(-1, subtitleTrack());
    EXPECT_EQ(BAD_VALUE, invoke(ORV_INVOKE_SELECT_TRACK, 5));
}

TEST_F(ParametersTest, InvokeNeedsMedia) {
    EXPECT_EQ(INVALID_OPERATION, invoke(ORV_INVOKE_GET_TRACKS, 0));
    EXPECT_EQ(INVALID_OPERATION, invoke(ORV_INVOKE_SELECT_TRACK, 0));
    EXPECT_EQ(INVALID_OPERATION, invoke(ORV_INVOKE_DESELECT_TRACK, 0));
    EXPECT_EQ(INVALID_OPERATION, invoke(ORV_INVOKE_ADD_SUBTITLES, mediaPath("lines.srt")));
}

}  // namespace
