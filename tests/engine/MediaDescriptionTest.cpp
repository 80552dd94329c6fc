// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "PlayerTest.h"
#include "TestMedia.h"
#include "inspect/DescriptionWriter.h"
#include "inspect/MediaDescription.h"

namespace orvtarn {
namespace {

using orvtest::openMedia;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

std::string describe(const std::string& name) { return describeMedia(*openMedia(name), {}); }

// The pieces joined, as a reader gets them.
std::string joined(const std::string& text) {
    std::string all;
    SubtitleTrackInfo piece;
    for (int i = 0; descriptionRecord(text, i, piece); i++) {
        EXPECT_EQ(piece.mCodec, ORV_DESCRIPTION_CODEC);
        EXPECT_NE(piece.mText[0], '\0');
        all += piece.mText;
    }
    return all;
}

TEST(MediaDescription, BeginsWithTheMediaAndHasEachStream) {
    const std::string text = describe("fonts.mkv");
    EXPECT_THAT(text, StartsWith("[media]\nformat=matroska,webm\nformatName=Matroska / WebM\n"));
    EXPECT_THAT(text, HasSubstr("\nstreams=2\n[stream]\nindex=0\nkind=video\ncodec=h264\n"));
    EXPECT_THAT(text, HasSubstr("\n[stream]\nindex=1\nkind=attachment\n"));
    EXPECT_THAT(text, HasSubstr("\nfileName=Größe ＡＢ.ttf\n"));
    EXPECT_THAT(text, HasSubstr("\nmimeType=application/x-truetype-font\n"));
    EXPECT_THAT(text, EndsWith("\n"));
}

TEST(MediaDescription, SaysHowPicturesAreShown) {
    EXPECT_THAT(describe("lying90mirrored.mp4"),
                HasSubstr("\ndisplayWidth=90\ndisplayHeight=160\npixelAspect=1:1\n"
                          "displayAspect=16:9\nrotation=90\nmirrored=1\n"));
    EXPECT_THAT(describe("wide-pixels.mkv"),
                HasSubstr("\ndisplayWidth=120\ndisplayHeight=90\npixelAspect=3:4\n"));
    const std::string hdr = describe("hdr10.mp4");
    EXPECT_THAT(hdr, HasSubstr("\npixelFormat=yuv420p10le\nbitDepth=10\n"));
    EXPECT_THAT(hdr, HasSubstr("\nmasteringMinLuminance=0.0050\nmasteringMaxLuminance=4000.0000\n"
                               "maxContentLight=4000\nmaxFrameAverageLight=400\n"));
    // Stored with the top field first; versions of ffmpeg differ on what is shown first.
    EXPECT_THAT(describe("fields-top.mkv"), HasSubstr("\nfieldOrder=t"));
}

TEST(MediaDescription, LeavesOutWhatIsUnknown) {
    const std::string text = describe("silent.mkv");
    for (const char* name : {"title", "language", "rotation", "mirrored", "primaries", "bitRate",
                             "masteringMaxLuminance", "sampleRate", "track"}) {
        const size_t streams = text.find("[stream]");
        EXPECT_THAT(text.substr(streams), Not(HasSubstr("\n" + std::string(name) + "="))) << name;
    }
}

TEST(MediaDescription, EscapesLineBreaksInValues) {
    DescriptionWriter writer;
    writer.text("title", std::string_view("a\\b\nc\rd"));
    EXPECT_EQ(writer.take(), "title=a\\\\b\\nc\\rd\n");
}

TEST(MediaDescription, ComesInPiecesThatAreCutBetweenCharacters) {
    std::string text;
    for (int i = 0; i < 200; i++) text += i % 3 == 0 ? "ж" : i % 3 == 1 ? "字" : "x\n";
    EXPECT_EQ(joined(text), text);
    EXPECT_EQ(joined(std::string(127, 'a')), std::string(127, 'a'));
    EXPECT_EQ(joined(std::string(128, 'a')), std::string(128, 'a'));
    EXPECT_EQ(joined(""), "");
    SubtitleTrackInfo untouched;
    untouched.mTrackId = 7;
    EXPECT_FALSE(descriptionRecord("abc", 1, untouched));
    EXPECT_FALSE(descriptionRecord("abc", -1, untouched));
    EXPECT_EQ(untouched.mTrackId, 7);
}

class DescriptionTest : public orvtest::PlayerTest {};

TEST_F(DescriptionTest, IsReadByIndicesPastTheChapters) {
    SubtitleTrackInfo piece;
    EXPECT_FALSE(player->getSubtitleTrackInfo(ORV_DESCRIPTION_INDEX_BASE, piece));
    open("tracks.mkv");
    std::string text;
    int count = 0;
    while (player->getSubtitleTrackInfo(ORV_DESCRIPTION_INDEX_BASE + count, piece)) {
        text += piece.mText;
        count++;
    }
    EXPECT_GT(count, 5);
    EXPECT_THAT(text, StartsWith("[media]\n"));
    EXPECT_THAT(text, HasSubstr("\nkind=audio\n"));
    // The second of each kind.
    EXPECT_THAT(text, HasSubstr("\nsampleRate=44100\n"));
    EXPECT_THAT(text, HasSubstr("\ntrack=1\n"));
    EXPECT_FALSE(player->getSubtitleTrackInfo(ORV_DESCRIPTION_INDEX_BASE - 1, piece));
}

}  // namespace
}  // namespace orvtarn
