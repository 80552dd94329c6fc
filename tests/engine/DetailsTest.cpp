// SPDX-License-Identifier: Apache-2.0
// What the player tells beyond playback: pictures, metadata, raw samples,
// counters and sound.
#include <binder/Parcel.h>
#include <math.h>
#include <media/Metadata.h>
#include <orvtarn/Parameters.h>
#include <stdlib.h>
#include <utils/String16.h>

#include <algorithm>
#include <map>

#include "FakeStream.h"
#include "LogCapture.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class DetailsTest : public PlayerTest {
protected:
    // The picture of the current position, in the size of the video.
    Picture thumbnail(int width, int height) {
        Picture picture{width, height, 0, std::vector<uint8_t>(size_t(width) * height * 4)};
        _Media_Thumbnail_Info_T request = {picture.pixels.data(),
                                           static_cast<uint32_t>(picture.pixels.size()),
                                           ORV_COLOR_MODE_XRGB8888, width, height};
        EXPECT_TRUE(player->getThumbnailInfo(&request));
        return picture;
    }

    static int64_t getInt64(TarnPlayer& player, int key) {
        Parcel reply;
        int64_t value = -1;
        EXPECT_EQ(NO_ERROR, player.getParameter(key, &reply));
        reply.setDataPosition(0);
        EXPECT_EQ(NO_ERROR, reply.readInt64(&value));
        return value;
    }
};

std::u16string text(const OrvWideText& wide) {
    return std::u16string(wide, std::find(wide, wide + ORV_TEXT_UNITS, 0));
}

TEST_F(DetailsTest, TheThumbnailIsTheFrameOnScreen) {
    open("feature.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(6000, 0));
    ASSERT_TRUE(sink->waitFor(0, [](const Picture& p) { return p.timestampUs == 6000000; }));
    const Picture shown = sink->newest();
    // Two ways of scaling colours differ here and there, two frames everywhere.
    EXPECT_LT(thumbnail(1280, 720).differences(shown), 1280 * 720 / 20);
}

TEST_F(DetailsTest, ThumbnailsAreChecked) {
    uint8_t buffer[64] = {};
    _Media_Thumbnail_Info_T request = {buffer, 64, ORV_COLOR_MODE_XRGB8888, 4, 1};
    EXPECT_FALSE(player->getThumbnailInfo(&request)) << "no media";
    open("short.mp4");
    EXPECT_TRUE(player->getThumbnailInfo(&request));
    EXPECT_FALSE(player->getThumbnailInfo(nullptr));
    request.u4BufferSize = 63;
    EXPECT_FALSE(player->getThumbnailInfo(&request));
    request = {buffer, 64, 19, 4, 1};
    EXPECT_FALSE(player->getThumbnailInfo(&request));
}

TEST_F(DetailsTest, TheThumbnailIsOfTheSelectedTrack) {
    open("pictures.mkv");
    EXPECT_LT(thumbnail(160, 90).brightness(), 20);
    ASSERT_TRUE(player->selectTrack(1));
    EXPECT_GT(thumbnail(160, 90).brightness(), 230);
    ASSERT_TRUE(player->selectTrack(0));
    EXPECT_LT(thumbnail(160, 90).brightness(), 20);
}

TEST_F(DetailsTest, TheCoverIsTheMediasOwnBytes) {
    open("covered.mp3");
    MediaAlbumArt* art = player->extractAlbumArt();
    ASSERT_NE(nullptr, art);
    EXPECT_EQ(bytesOf(mediaPath("front.jpg")),
              std::vector<uint8_t>(art->data(), art->data() + art->size()));
    free(art);
    player->reset();
    open("short.mp4");
    EXPECT_EQ(nullptr, player->extractAlbumArt());
}

TEST_F(DetailsTest, MetadataInSeveralScripts) {
    open("tagged.mp3");
    MetaDataInfo info;
    ASSERT_TRUE(player->getMetaDataInfo(info));
    EXPECT_EQ(u"Ode an die Freude – К радости", text(info.mTitle));
    EXPECT_EQ(u"東京交響楽団", text(info.mArtist));
    EXPECT_EQ(1824, info.mYear);
    EXPECT_EQ(3, info.mTrackNumber);
    EXPECT_EQ(12, info.mTrackTotal);
}

TEST_F(DetailsTest, MetadataOfAStreamThatIsReadOnce) {
    FakeStream stream(mediaPath("tagged.mp3"));
    stream.mSeekable = false;
    ASSERT_EQ(NO_ERROR, player->setDataSource(stream.forEngine()));
    ASSERT_EQ(NO_ERROR, player->prepare());
    MetaDataInfo info;
    ASSERT_TRUE(player->getMetaDataInfo(info));
    EXPECT_EQ(u"東京交響楽団", text(info.mArtist));
    EXPECT_EQ(1824, info.mYear);
    player->release();
}

// Types of the platform's metadata values.
constexpr int kText = 1;
constexpr int kInteger = 2;
constexpr int kFlag = 3;

// Keys and value types of the records that getMetadata appends.
std::map<int, int> recordsOf(TarnPlayer& player, const SortedVector<int>& ids) {
    Parcel records;
    EXPECT_EQ(NO_ERROR, player.getMetadata(ids, &records));
    std::map<int, int> found;
    for (size_t at = 0; at < records.dataSize();) {
        records.setDataPosition(at);
        const int32_t length = records.readInt32();
        const int32_t key = records.readInt32();
        found[key] = records.readInt32();
        if (length <= 0) break;
        at += static_cast<size_t>(length);
    }
    return found;
}

TEST_F(DetailsTest, MetadataRecordsAreThoseAskedFor) {
    open("tagged.mp3");
    using media::Metadata;
    SortedVector<int> ids;
    const std::map<int, int> all = recordsOf(*player, ids);
    EXPECT_EQ(kText, all.at(Metadata::kTitle));
    EXPECT_EQ(kInteger, all.at(Metadata::kDuration));
    EXPECT_EQ(kFlag, all.at(Metadata::kSeekAvailable));
    EXPECT_EQ(0u, all.count(Metadata::kVideoWidth)) << "there is no video";
    ids.add(Metadata::kTitle);
    ids.add(Metadata::kVideoWidth);
    const std::map<int, int> one = {{Metadata::kTitle, kText}};
    EXPECT_EQ(one, recordsOf(*player, ids));
}

TEST_F(DetailsTest, MetadataTextsAreUtf16AfterTheirOwnLength) {
    open("tagged.mp3");
    using media::Metadata;
    SortedVector<int> ids;
    ids.add(Metadata::kArtist);
    Parcel records;
    ASSERT_EQ(NO_ERROR, player->getMetadata(ids, &records));
    records.setDataPosition(0);
    EXPECT_EQ(4 * 4 + 8 * 2, records.readInt32());  // 7 units, one of zero
    EXPECT_EQ(Metadata::kArtist, records.readInt32());
    EXPECT_EQ(kText, records.readInt32());
    String16 artist;
    EXPECT_EQ(NO_ERROR, records.readString16(&artist));
    EXPECT_EQ(String16(u"東京交響楽団"), artist);
    EXPECT_EQ(0u, records.dataAvail());
}

IORV_PB_CTRL_SET_MEDIA_INFO_T stereo16(bool bigEndian) {
    IORV_PB_CTRL_SET_MEDIA_INFO_T info = {};
    info.eMediaType = E_ORV_MEDIA_TYPE_AUDIO_ES;
    info.uFormatInfo.tAudioEsInfo.tAudInfo.eAudEnc = E_ORV_AUD_ENC_PCM;
    info.uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info = {
        E_ORV_PCM_TYPE_SIGNED,         E_Orv_Aud_Ch_Num{2},
        E_Orv_Aud_Sample_Rate{44100},  4,
        E_Orv_Aud_Bits_Per_Sample{16}, bigEndian};
    return info;
}

class RawTest : public DetailsTest, public testing::WithParamInterface<bool> {};

TEST_P(RawTest, SamplesPlayByTheirDescription) {
    IORV_PB_CTRL_SET_MEDIA_INFO_T info = stereo16(GetParam());
    ASSERT_EQ(NO_ERROR, player->setPCMMediaInfo(&info));
    player->setPcmFlag();
    open(GetParam() ? "tone-s16be.pcm" : "tone-s16le.pcm");
    EXPECT_NEAR(2000, duration(), 20);
    AudioTrackInfo track;
    ASSERT_TRUE(player->getAudioTrackInfo(true, 0, track));
    EXPECT_EQ(2, track.mChannels);
    EXPECT_EQ(44100, track.mSampleRate);
    EXPECT_TRUE(player->seekToPosition(176400));
    EXPECT_NEAR(1000, position(), 30);
    int bytes = 0;
    EXPECT_EQ(NO_ERROR, player->getCurrentBytePosition(&bytes));
    EXPECT_NEAR(176400, bytes, 5000);
    playToEnd();
    player->reset();
    open("short.mp4");
    EXPECT_NEAR(3000, duration(), 50) << "the description went with its media";
}

INSTANTIATE_TEST_SUITE_P(ByteOrders, RawTest, testing::Bool());

TEST_F(DetailsTest, TheFlagAloneMeansUsualSamples) {
    player->setPcmFlag();
    open("tone-s16le.pcm");
    EXPECT_NEAR(2000, duration(), 20);
}

TEST_F(DetailsTest, TheDescriptionTellsALengthThatTheSourceDoesNot) {
    for (const bool hasLength : {true, false}) {
        FakeStream stream(mediaPath("tone-s16le.pcm"));
        stream.mSeekable = stream.mHasLength = hasLength;
        IORV_PB_CTRL_SET_MEDIA_INFO_T info = stereo16(false);
        info.u4TotalDuration = 5000;
        ASSERT_EQ(NO_ERROR, player->setPCMMediaInfo(&info));
        ASSERT_EQ(NO_ERROR, player->setDataSource(stream.forEngine()));
        ASSERT_EQ(NO_ERROR, player->prepare());
        EXPECT_NEAR(hasLength ? 2000 : 5000, duration(), 20);
        player->reset();
    }
}

TEST_F(DetailsTest, AFlagThatComesTooLateIsLogged) {
    open("short.mp4");
    LogCapture log;
    player->setPcmFlag();
    EXPECT_TRUE(log.waitFor(error("setPcmFlag: not possible while prepared")));
}

TEST_F(DetailsTest, DescriptionsAreChecked) {
    IORV_PB_CTRL_SET_MEDIA_INFO_T info = stereo16(false);
    info.uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info.u2BlockAlign = 3;
    EXPECT_EQ(BAD_VALUE, player->setPCMMediaInfo(&info));
    EXPECT_EQ(BAD_VALUE, player->setPCMMediaInfo(nullptr));
    info = stereo16(false);
    open("short.mp4");
    EXPECT_EQ(INVALID_OPERATION, player->setPCMMediaInfo(&info)) << "media are open";
}

TEST_F(DetailsTest, CountsItsFrames) {
    open("silent.mp4");
    playToEnd();
    // The last one may be on its way.
    EXPECT_TRUE(eventually([&] {
        return static_cast<int64_t>(sink->frameCount()) ==
               getInt64(*player, ORV_PARAMETER_FRAMES_DELIVERED);
    }));
    EXPECT_EQ(0, getInt64(*player, ORV_PARAMETER_FRAMES_MISSED));
    // A machine with other work drops some of the 60; none gets lost unseen.
    const int64_t dropped = getInt64(*player, ORV_PARAMETER_FRAMES_DROPPED);
    EXPECT_NEAR(60, static_cast<double>(sink->frameCount() + dropped), 3);
}

TEST_F(DetailsTest, RolesShowAndHide) {
    EXPECT_EQ(BAD_VALUE, player->setPlayerRole(static_cast<E_Orv_Player_Role_Type>(3)));
    ASSERT_EQ(NO_ERROR, player->setPlayerRole(E_ORV_PLAYER_ROLE_BACKGROUND));
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() > 300; }));
    EXPECT_EQ(0u, sink->frameCount());
    ASSERT_EQ(NO_ERROR, player->setPlayerRole(E_ORV_PLAYER_ROLE_MAIN));
    EXPECT_TRUE(sink->waitFor(3));
}

TEST_F(DetailsTest, SurfacesMayComeGoAndChangeTheirSize) {
    player->setVideoSurfaceTexture(nullptr);
    open("feature.mkv");
    EXPECT_EQ(0u, sink->frameCount());
    player->setVideoSurfaceTexture(sink);
    ASSERT_TRUE(sink->waitFor(0)) << "paused, too";
    EXPECT_EQ(1280, sink->newest().width);
    sink->setDefaultSize(400, 400);
    ASSERT_TRUE(sink->waitFor(1, [](const Picture& p) { return p.width == 400; }));
    EXPECT_LT(sink->newest().brightness(0, 0, 1000, 200), 5) << "black bars keep the aspect";
    sp<FrameSink> other = new FrameSink;
    player->setVideoSurfaceTexture(other);
    const uint64_t before = sink->frameCount();
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(other->waitFor(5));
    EXPECT_EQ(before, sink->frameCount());
}

TEST_F(DetailsTest, ASurfaceThatIsFullOrGoneDoesNotStopPlayback) {
    sink->block(true);
    open("silent.mp4");
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() > 300; }));
    EXPECT_EQ(0u, sink->frameCount());
    EXPECT_GT(getInt64(*player, ORV_PARAMETER_FRAMES_MISSED), 0);
    sink->block(false);
    ASSERT_TRUE(sink->waitFor(0));
    sink->abandon();
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE));
}

TEST_F(DetailsTest, TheBufferFillsAsTheMediaAreRead) {
    open("short.mp4");
    playToEnd();
    EXPECT_GE(player->getBufferPercent(), 95);
    EXPECT_LE(player->getBufferPercent(), 100);
    EXPECT_GE(events->count(MEDIA_BUFFERING_UPDATE), 1);
}

TEST_F(DetailsTest, VolumesAreTaken) {
    EXPECT_EQ(NO_ERROR, player->setVolume(0.2f, 0.8f));
    open("tone.mp3");
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_EQ(NO_ERROR, player->setVolume(1, 0));
    EXPECT_EQ(NO_ERROR, player->setVolume(0, 0));
    EXPECT_EQ(NO_ERROR, player->setVolume(-1, 7));
    EXPECT_EQ(BAD_VALUE, player->setVolume(1, NAN));
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE));
}

TEST_F(DetailsTest, WhatTheDesktopHasNotIsRefused) {
    EXPECT_FALSE(player->setTS(1));
    EXPECT_EQ(INVALID_OPERATION, player->setUnLockPin(1234));
    EXPECT_EQ(BAD_VALUE, player->setUnLockPin(-1));
    EXPECT_EQ(BAD_VALUE, player->setUnLockPin(10000));
    player->configPlayer(true);
    open("short.mp4");
}

}  // namespace
