// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "TestMedia.h"
#include "inspect/ContainerInfo.h"

namespace orvtarn {
namespace {

using orvtest::openMedia;

std::u16string textOf(const OrvWideText& text) {
    return std::u16string(text, std::find(text, text + ORV_TEXT_UNITS, 0));
}

// A file of tags alone, as libavformat's own text format has them.
MetaDataInfo infoOfTags(const std::string& tags) {
    const std::string text = ";FFMETADATA1\n" + tags;
    std::unique_ptr<MediaFile> file;
    EXPECT_EQ(MediaFile::open(std::make_unique<orvtest::MemorySource>(
                                  std::vector<uint8_t>(text.begin(), text.end())),
                              {}, file),
              0);
    return metaDataInfo(*file);
}

void expectTags(const MetaDataInfo& info) {
    EXPECT_EQ(textOf(info.mTitle), u"Ode an die Freude – К радости");
    EXPECT_EQ(textOf(info.mArtist), u"東京交響楽団");
    EXPECT_EQ(textOf(info.mAlbum), std::u16string(128, u'Α')) << "128 units, no terminator";
    EXPECT_EQ(textOf(info.mGenre), u"موسيقى");
    EXPECT_EQ(textOf(info.mComposer), u"Ludwig van Beethoven");
    EXPECT_EQ(textOf(info.mComment), std::u16string(126, u'c') + u"\U0001D11E");
    EXPECT_EQ(info.mTrackNumber, 3);
    EXPECT_EQ(info.mTrackTotal, 12);
    EXPECT_EQ(info.mDiscNumber, 2);
    EXPECT_EQ(info.mYear, 1824);
    EXPECT_EQ(info.mChapterCount, 0);
}

TEST(ContainerInfo, ReadsTheTagsOfAnMp3) {
    const MetaDataInfo info = metaDataInfo(*openMedia("tagged.mp3"));
    expectTags(info);
    EXPECT_EQ(textOf(info.mContainer), u"MP2/3 (MPEG audio layer 2/3)");
    EXPECT_NEAR(info.mDuration, 4000, 60);
    EXPECT_NEAR(info.mBitRate, 128000, 10000);
}

// Ogg keeps them in the stream.
TEST(ContainerInfo, ReadsTheTagsOfAStream) {
    const MetaDataInfo info = metaDataInfo(*openMedia("tagged.ogg"));
    expectTags(info);
    EXPECT_EQ(textOf(info.mContainer), u"Ogg");
    EXPECT_NEAR(info.mDuration, 4000, 60);
}

TEST(ContainerInfo, DoesNotTakeATracksTitleForTheMedias) {
    const MetaDataInfo info = metaDataInfo(*openMedia("tracks.mkv"));
    EXPECT_EQ(textOf(info.mTitle), u"");
    EXPECT_EQ(textOf(info.mComment), u"");
    EXPECT_EQ(textOf(info.mContainer), u"Matroska / WebM");
    EXPECT_EQ(info.mChapterCount, 3);
    EXPECT_NEAR(info.mDuration, 10000, 60);
}

TEST(ContainerInfo, SurvivesTagsThatAreNotWhatTheyShouldBe) {
    const MetaDataInfo info = metaDataInfo(*openMedia("broken-tags.mp4"));
    EXPECT_EQ(textOf(info.mTitle), u"caf\uFFFD au lait");
    EXPECT_EQ(textOf(info.mArtist), u"\uFFFD\uFFFD");
    EXPECT_EQ(info.mTrackNumber, 0);
    EXPECT_EQ(info.mYear, 0);
}

TEST(ContainerInfo, FindsTheYearInADate) {
    EXPECT_EQ(infoOfTags("date=2021\n").mYear, 2021);
    EXPECT_EQ(infoOfTags("date=2021-03-04T05:06:07Z\n").mYear, 2021);
    EXPECT_EQ(infoOfTags("date=4.3.1999\n").mYear, 1999);
    EXPECT_EQ(infoOfTags("year=1987\n").mYear, 1987);
    EXPECT_EQ(infoOfTags("date=99\n").mYear, 0);
    EXPECT_EQ(infoOfTags("date=\n").mYear, 0);
}

TEST(ContainerInfo, ReadsNumbersAndTotals) {
    const MetaDataInfo plain = infoOfTags("track=7\ndisc=1\ntracktotal=9\n");
    EXPECT_EQ(plain.mTrackNumber, 7);
    EXPECT_EQ(plain.mTrackTotal, 9);
    EXPECT_EQ(plain.mDiscNumber, 1);
    const MetaDataInfo odd = infoOfTags("track=-3/-5\ndisc=99999999999999999999\n");
    EXPECT_EQ(odd.mTrackNumber, 0);
    EXPECT_EQ(odd.mTrackTotal, 0);
    EXPECT_EQ(odd.mDiscNumber, INT32_MAX);
}

TEST(ContainerInfo, FallsBackToTheNextBestTag) {
    const MetaDataInfo info = infoOfTags("artist=\nalbum_artist=Several\ndescription=About\n");
    EXPECT_EQ(textOf(info.mArtist), u"Several");
    EXPECT_EQ(textOf(info.mComment), u"About");
}

void expectChapter(const MediaFile& file, int index, int32_t start, int32_t end,
                   const std::string& title) {
    SubtitleTrackInfo info;
    ASSERT_TRUE(chapterRecord(file, index, info)) << index;
    EXPECT_EQ(info.mCodec, ORV_CHAPTER_CODEC);
    EXPECT_EQ(info.mTrackId, start);
    EXPECT_EQ(info.mFlags, end);
    EXPECT_EQ(std::string(info.mText), title);
    EXPECT_EQ(std::string(info.mLanguage), "");
}

TEST(ContainerInfo, ListsChapters) {
    for (const char* name : {"tracks.mkv", "tracks.mp4"}) {
        const auto file = openMedia(name);
        ASSERT_EQ(chapterCount(*file), 3) << name;
        expectChapter(*file, 0, 0, 2500, "Opening");
        expectChapter(*file, 1, 2500, 6000, "Глава вторая");
        expectChapter(*file, 2, 6000, 10000, "終章");
    }
}

TEST(ContainerInfo, EndsTheChaptersWithFalse) {
    const auto file = openMedia("tracks.mkv");
    SubtitleTrackInfo info;
    info.mTrackId = 77;
    for (int index : {-1, 3, INT32_MAX, INT32_MIN}) {
        EXPECT_FALSE(chapterRecord(*file, index, info)) << index;
    }
    EXPECT_EQ(info.mTrackId, 77) << "the record was touched";
    EXPECT_EQ(chapterCount(*openMedia("tagged.mp3")), 0);
}

}  // namespace
}  // namespace orvtarn
