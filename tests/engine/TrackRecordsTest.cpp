// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <list>
#include <string>

#include "RealPlayer.h"
#include "TestMedia.h"
#include "records/CodecFourCC.h"
#include "records/TrackRecords.h"

namespace orvtarn {
namespace {

std::u16string textOf(const OrvWideText& text) {
    return std::u16string(text, std::find(text, text + ORV_TEXT_UNITS, 0));
}

// What the player and libavformat say together about a file.
TrackTables tablesOf(const std::string& name, const MediaFile& file) {
    orvtest::RealPlayer player;
    EXPECT_TRUE(player.load(orvtest::mediaPath(name)));
    mpv_node list = player.trackList();
    TrackTables tables = trackTables(list);
    mpv_free_node_contents(&list);
    addContainerDetails(file, tables);
    for (auto& track : tables.audio) addAudioTexts(file, track);
    return tables;
}

void expectVideo(const TrackTables& tables) {
    ASSERT_EQ(tables.video.size(), 1u);
    const VideoCodecInfo& video = tables.video[0].record;
    EXPECT_EQ(video.mCodec, codecFourCC("h264"));
    EXPECT_EQ(video.mWidth, 320);
    EXPECT_EQ(video.mHeight, 180);
    EXPECT_EQ(video.mFrameRate, 25000);
    EXPECT_NE(video.mFlags & ORV_TRACK_FLAG_SELECTED, 0);
    EXPECT_TRUE(tables.video[0].selected);
    EXPECT_EQ(tables.video[0].id, 1);
    EXPECT_EQ(tables.video[0].streamIndex, 0);
}

TEST(TrackRecords, DescribesTheTracksOfAMatroskaFile) {
    const auto file = orvtest::openMedia("tracks.mkv");
    const TrackTables tables = tablesOf("tracks.mkv", *file);
    expectVideo(tables);
    ASSERT_EQ(tables.audio.size(), 2u);
    const AudioTrackInfo& main = tables.audio[0].record;
    EXPECT_EQ(main.mCodec, codecFourCC("aac"));
    EXPECT_EQ(main.mChannels, 2);
    EXPECT_EQ(main.mSampleRate, 48000);
    EXPECT_EQ(main.mBitsPerSample, 0);
    EXPECT_EQ(main.mTrackId, 1);
    EXPECT_EQ(textOf(main.mTitle), u"Main mix");
    EXPECT_EQ(textOf(main.mCodecName), u"AAC (Advanced Audio Coding)");
    EXPECT_EQ(textOf(main.mChannelLayout), u"stereo");
    EXPECT_EQ(textOf(main.mProfile), u"LC");
    EXPECT_EQ(std::string(main.mLanguage), "eng");
    EXPECT_EQ(main.mFlags & ORV_TRACK_FLAG_DEFAULT, 0);
    EXPECT_EQ(tables.audio[0].streamIndex, 1);

    const AudioTrackInfo& comment = tables.audio[1].record;
    EXPECT_EQ(comment.mCodec, codecFourCC("flac"));
    EXPECT_EQ(comment.mChannels, 1);
    EXPECT_EQ(comment.mSampleRate, 44100);
    EXPECT_EQ(comment.mBitsPerSample, 16);
    EXPECT_EQ(comment.mTrackId, 2);
    EXPECT_EQ(textOf(comment.mTitle), u"Kommentar (größer)");
    EXPECT_EQ(textOf(comment.mChannelLayout), u"mono");
    EXPECT_EQ(textOf(comment.mComment), u"Nur für Fans");
    EXPECT_EQ(textOf(comment.mEncoder).substr(0, 4), u"Lavc");
    EXPECT_EQ(std::string(comment.mLanguage).substr(0, 2), "de");
    EXPECT_NE(comment.mFlags & ORV_TRACK_FLAG_DEFAULT, 0);
}

TEST(TrackRecords, DescribesTheTracksOfAnMp4File) {
    const auto file = orvtest::openMedia("tracks.mp4");
    const TrackTables tables = tablesOf("tracks.mp4", *file);
    expectVideo(tables);
    EXPECT_GT(tables.video[0].record.mBitRate, 10000);
    ASSERT_EQ(tables.audio.size(), 2u);
    EXPECT_EQ(textOf(tables.audio[0].record.mHandler), u"SoundHandler");
    EXPECT_GT(tables.audio[0].record.mBitRate, 10000);
}

// MP4 keeps no titles of subtitle tracks.
TEST(TrackRecords, JoinsLanguageAndTitleOfSubtitles) {
    for (const char* name : {"tracks.mkv", "tracks.mp4"}) {
        const auto file = orvtest::openMedia(name);
        const TrackTables tables = tablesOf(name, *file);
        const bool isMkv = std::string(name) == "tracks.mkv";
        ASSERT_EQ(tables.subtitles.size(), 2u) << name;
        const SubtitleTrackInfo& full = tables.subtitles[0].record;
        const SubtitleTrackInfo& japanese = tables.subtitles[1].record;
        EXPECT_EQ(full.mTrackId, 1);
        EXPECT_EQ(full.mCodec, codecFourCC(isMkv ? "subrip" : "mov_text"));
        EXPECT_EQ(std::string(full.mText), isMkv ? "eng;Full" : "eng;");
        EXPECT_EQ(std::string(full.mLanguage), "eng");
        EXPECT_NE(full.mFlags & ORV_TRACK_FLAG_FORCED, 0);
        EXPECT_EQ(japanese.mFlags & ORV_TRACK_FLAG_FORCED, 0);
        EXPECT_EQ(std::string(japanese.mText), isMkv ? "jpn;字幕" : "jpn;");
        EXPECT_EQ(japanese.mTrackId, 2);
        EXPECT_EQ(tables.subtitles[1].streamIndex, 4);
    }
}

TEST(TrackRecords, ListsTracksFromOtherFilesAsExternal) {
    const auto file = orvtest::openMedia("tracks.mkv");
    orvtest::RealPlayer player;
    ASSERT_TRUE(player.load(orvtest::mediaPath("silent.mkv")));
    ASSERT_TRUE(player.command("audio-add", orvtest::mediaPath("tagged.mp3").c_str(), "select"));
    mpv_node list = player.trackList();
    TrackTables tables = trackTables(list);
    mpv_free_node_contents(&list);
    ASSERT_EQ(tables.audio.size(), 1u);
    EXPECT_NE(tables.audio[0].record.mFlags & ORV_TRACK_FLAG_EXTERNAL, 0);
    EXPECT_EQ(tables.audio[0].streamIndex, -1);
    // The stream with its number in the other file is not asked.
    addContainerDetails(*file, tables);
    addAudioTexts(*file, tables.audio[0]);
    EXPECT_EQ(textOf(tables.audio[0].record.mCodecName), u"MP3 (MPEG audio layer 3)");
    EXPECT_EQ(textOf(tables.audio[0].record.mProfile), u"");
}

TEST(TrackRecords, TakesNoCoverForVideo) {
    const auto file = orvtest::openMedia("covered.mp3");
    const TrackTables tables = tablesOf("covered.mp3", *file);
    EXPECT_TRUE(tables.video.empty());
    EXPECT_EQ(tables.audio.size(), 1u);
    // A picture that is the media itself is shown like video.
    EXPECT_EQ(tablesOf("still.png", *orvtest::openMedia("still.png")).video.size(), 1u);
}

TEST(TrackRecords, KnowsTheSampleWidthOfPcm) {
    std::unique_ptr<MediaFile> file;
    const std::string path = testing::TempDir() + "/wide.wav";
    orvtest::outputOf(
        "ffmpeg -nostdin -v error -y -f lavfi -i sine=440:duration=0.2 -c:a "
        "pcm_s24le '" +
        path + "'");
    ASSERT_EQ(MediaFile::open(path, {}, file), 0);
    TrackTables tables;
    tables.audio.push_back({AudioTrackInfo(), 1, 0, true});
    addContainerDetails(*file, tables);
    EXPECT_EQ(tables.audio[0].record.mBitsPerSample, 24);
    EXPECT_EQ(tables.audio[0].record.mBitRate, 44100 * 24);
    remove(path.c_str());
}

// Nodes as a player might send them on a bad day.
class Nodes {
public:
    mpv_node text(const char* value) {
        mpv_node node = {};
        node.format = MPV_FORMAT_STRING;
        node.u.string = const_cast<char*>(value);
        return node;
    }
    mpv_node integer(int64_t value) {
        mpv_node node = {};
        node.format = MPV_FORMAT_INT64;
        node.u.int64 = value;
        return node;
    }
    mpv_node number(double value) {
        mpv_node node = {};
        node.format = MPV_FORMAT_DOUBLE;
        node.u.double_ = value;
        return node;
    }
    mpv_node list(std::vector<mpv_node> values) {
        return hold(MPV_FORMAT_NODE_ARRAY, {}, std::move(values));
    }
    mpv_node map(const std::vector<std::pair<const char*, mpv_node>>& members) {
        std::vector<char*> keys;
        std::vector<mpv_node> values;
        for (const auto& [key, value] : members) {
            keys.push_back(const_cast<char*>(key));
            values.push_back(value);
        }
        return hold(MPV_FORMAT_NODE_MAP, std::move(keys), std::move(values));
    }

private:
    struct Held {
        std::vector<char*> keys;
        std::vector<mpv_node> values;
        mpv_node_list list;
    };

    mpv_node hold(mpv_format format, std::vector<char*> keys, std::vector<mpv_node> values) {
        mHeld.push_back({std::move(keys), std::move(values), {}});
        Held& held = mHeld.back();
        held.list = {static_cast<int>(held.values.size()), held.values.data(), held.keys.data()};
        mpv_node node = {};
        node.format = format;
        node.u.list = &held.list;
        return node;
    }

    std::list<Held> mHeld;
};

TEST(TrackRecords, PassesOverNodesOfAnotherShape) {
    Nodes nodes;
    const mpv_node video = nodes.text("video");
    for (const mpv_node& list :
         {mpv_node{}, nodes.text("tracks"), nodes.map({{"type", video}}), nodes.list({}),
          nodes.list({nodes.text("video"), nodes.integer(1), nodes.list({video})}),
          nodes.list({nodes.map({})}), nodes.list({nodes.map({{"type", video}})}),
          nodes.list({nodes.map({{"id", nodes.integer(1)}})}),
          nodes.list({nodes.map({{"type", nodes.integer(5)}, {"id", nodes.integer(1)}})}),
          nodes.list({nodes.map({{"type", video}, {"id", nodes.text("1")}})}),
          nodes.list({nodes.map({{"type", nodes.text("smell")}, {"id", nodes.integer(1)}})})}) {
        const TrackTables tables = trackTables(list);
        EXPECT_TRUE(tables.video.empty() && tables.audio.empty() && tables.subtitles.empty());
    }
}

TEST(TrackRecords, ReadsMembersOfOtherTypesAsEmptyAndBoundsNumbers) {
    Nodes nodes;
    const TrackTables tables = trackTables(nodes.list({nodes.map({
        {"type", nodes.text("video")},
        {"id", nodes.integer(7)},
        {"codec", nodes.integer(3)},
        {"demux-w", nodes.integer(INT64_MAX)},
        {"demux-h", nodes.text("tall")},
        {"demux-fps", nodes.number(INFINITY)},
        {"demux-bitrate", nodes.integer(INT64_MIN)},
    })}));
    ASSERT_EQ(tables.video.size(), 1u);
    const VideoCodecInfo& video = tables.video[0].record;
    EXPECT_EQ(video.mCodec, 0);
    EXPECT_EQ(video.mWidth, INT32_MAX);
    EXPECT_EQ(video.mHeight, 0);
    EXPECT_EQ(video.mFrameRate, 0);
    EXPECT_EQ(tables.video[0].streamIndex, -1);
    EXPECT_EQ(tables.video[0].id, 7);
}

TEST(TrackRecords, CutsLongSubtitleTexts) {
    Nodes nodes;
    const std::string title(300, 't');
    const TrackTables tables = trackTables(nodes.list({nodes.map({
        {"type", nodes.text("sub")},
        {"id", nodes.integer(1)},
        {"title", nodes.text(title.c_str())},
    })}));
    ASSERT_EQ(tables.subtitles.size(), 1u);
    EXPECT_EQ(std::string(tables.subtitles[0].record.mText), ";" + std::string(126, 't'));
}

}  // namespace
}  // namespace orvtarn
