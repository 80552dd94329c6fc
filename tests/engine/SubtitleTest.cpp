// SPDX-License-Identifier: Apache-2.0
// Subtitles as they are seen: the pictures change where and as the player is
// told. The media are a grey picture (0x40), on which nothing else moves.
#include "PlayerTest.h"
#include "core/MpvHandle.h"
#include "playback/SubtitleLoader.h"

using namespace android;
using namespace orvtest;

namespace {

constexpr double kGrey = 0x40;

class SubtitleTest : public PlayerTest {
protected:
    static bool isPlain(const Picture& picture) {
        return picture.pixels.empty() ? false : brightPixels(picture) == 0;
    }

    // Pixels brighter than the background by far.
    static int brightPixels(const Picture& picture) {
        int count = 0;
        for (size_t i = 1; i < picture.pixels.size(); i += 4) count += picture.pixels[i] > 200;
        return count;
    }

    // Rows or columns that bright pixels take, and where they begin.
    struct Extent {
        int left = INT32_MAX, top = INT32_MAX, right = -1, bottom = -1;
        int width() const { return right - left + 1; }
        int height() const { return bottom - top + 1; }
    };
    static Extent extentOf(const Picture& picture) {
        Extent extent;
        for (int i = 0; i < picture.width * picture.height; i++) {
            if (picture.pixels[size_t(i) * 4 + 1] <= 200) continue;
            extent.left = std::min(extent.left, i % picture.width);
            extent.right = std::max(extent.right, i % picture.width);
            extent.top = std::min(extent.top, i / picture.width);
            extent.bottom = std::max(extent.bottom, i / picture.width);
        }
        return extent;
    }

    bool sees(const std::function<bool(const Picture&)>& condition) {
        return eventually([&] { return condition(sink->newest()); });
    }
    bool seesText() {
        return sees([](const Picture& p) { return brightPixels(p) > 50; });
    }
    bool seesNothing() { return sees(isPlain); }

    // The bar that the pictures of make-vobsub.py are, of one language's width.
    bool seesBar(int width) {
        return sees([width](const Picture& p) {
            const Extent bar = extentOf(p);
            return std::abs(bar.left - 220) <= 2 && std::abs(bar.top - 300) <= 2 &&
                   std::abs(bar.width() - width) <= 4 && std::abs(bar.height() - 30) <= 4;
        });
    }

    // Copies of a pair that do not find each other by name or place.
    struct Pair {
        std::string pictures, index;
    };
    static Pair pairApart(const std::string& name) {
        const std::string test = testing::UnitTest::GetInstance()->current_test_info()->name();
        Pair pair = {mediaPath(test + name + " pictures.sub"),
                     mediaPath(test + name + "-apart.idx")};
        outputOf("cp '" + mediaPath(name + ".sub") + "' '" + pair.pictures + "'");
        outputOf("cp '" + mediaPath(name + ".idx") + "' '" + pair.index + "'");
        return pair;
    }
    bool setPair(const Pair& pair) {
        return player->setSubtitleDataSourceEx(pair.pictures.c_str(), pair.index.c_str());
    }
    bool setFile(const char* name) {
        return player->setSubtitleDataSource(mediaPath(name).c_str());
    }
    bool addFile(const char* name) { return player->addTimedTextSource(mediaPath(name).c_str()); }

    void setMedia(const char* name) {
        ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath(name).c_str(), nullptr));
    }
    // Playing: a paused core may have drawn its frame before pictures were there.
    void prepareAndStart() {
        ASSERT_EQ(NO_ERROR, player->prepare());
        ASSERT_EQ(NO_ERROR, player->start());
    }
    int trackCount() {
        int count = -1;
        EXPECT_TRUE(player->getSubtitleTrackCount(count));
        return count;
    }
    int selected() {
        int index = -2;
        EXPECT_NE(0, player->getCurrentSubtitleIndex(&index));
        return index;
    }

    // Paused in the middle of a subtitle.
    void openAtLine(const char* name) {
        open(name);
        ASSERT_EQ(NO_ERROR, player->seekTo(4000, 0));
        ASSERT_TRUE(seesNothing()) << "no subtitle is on by itself";
    }

    template <class Record>
    void apply(int type, Record record) {
        ASSERT_TRUE(player->setSubtitleAttr(type, &record));
        ASSERT_TRUE(player->flushSubtitleAttr());
    }
};

TEST_F(SubtitleTest, AppearsAndDisappearsOnScreen) {
    openAtLine("plain.mkv");
    ASSERT_TRUE(player->onSubtitleTrack(0));
    EXPECT_TRUE(seesText());
    EXPECT_GT(extentOf(sink->newest()).top, 180) << "in the lower half";
    ASSERT_TRUE(player->offSubtitleTrack());
    EXPECT_TRUE(seesNothing());
    ASSERT_TRUE(player->onSubtitleTrack(0));
    EXPECT_TRUE(seesText()) << "the same line comes back";
}

// Without a font, each of these would be one and the same box.
TEST_F(SubtitleTest, OtherScriptsHaveLetters) {
    if (sizeof(void*) == 4) GTEST_SKIP() << "no fonts of the other machine's";
    const std::string file = mediaPath("script.srt");
    const auto pictureOf = [&](const char* letter) {
        outputOf("printf '1\\n00:00:00,000 --> 00:00:20,000\\n%s\\n' '" + std::string(letter) +
                 "' >'" + file + "'");
        player->reset();
        open("plain.mp4");
        EXPECT_TRUE(player->setSubtitleDataSource(file.c_str()));
        EXPECT_TRUE(sees([](const Picture& p) { return brightPixels(p) > 0; })) << letter;
        return sink->newest().pixels;
    };
    for (const auto& [one, other] : std::initializer_list<std::pair<const char*, const char*>>{
             {"国", "电"}, {"ひ", "カ"}, {"한", "글"}, {"ع", "ف"}, {"ह", "क"}}) {
        EXPECT_NE(pictureOf(one), pictureOf(other)) << one << " and " << other;
    }
}

TEST_F(SubtitleTest, TheOtherTrackIsAnotherText) {
    openAtLine("plain.mkv");
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(seesText());
    const int width = extentOf(sink->newest()).width();
    ASSERT_TRUE(player->onSubtitleTrack(1));
    EXPECT_TRUE(sees([&](const Picture& p) { return extentOf(p).width() > 2 * width; }));
}

class ExternalSubtitleTest : public SubtitleTest,
                             public testing::WithParamInterface<const char*> {};

TEST_P(ExternalSubtitleTest, IsDrawn) {
    openAtLine("plain.mp4");
    ASSERT_TRUE(player->setSubtitleDataSource(mediaPath(GetParam()).c_str()));
    EXPECT_TRUE(seesText());
    EXPECT_EQ(1, trackCount());
    SubtitleTrackInfo info;
    ASSERT_TRUE(player->getSubtitleTrackInfo(0, info));
    EXPECT_TRUE(info.mFlags & ORV_TRACK_FLAG_EXTERNAL);
    EXPECT_TRUE(info.mFlags & ORV_TRACK_FLAG_SELECTED);
}

INSTANTIATE_TEST_SUITE_P(Formats, ExternalSubtitleTest,
                         testing::Values("lines.srt", "lines.ass", "latin1.srt", "words.idx"),
                         [](const auto& info) {
                             std::string name = info.param;
                             name[name.find('.')] = '_';
                             return name;
                         });

TEST_F(SubtitleTest, APairMayLieInTwoPlaces) {
    openAtLine("plain.mp4");
    ASSERT_TRUE(setPair(pairApart("words")));
    EXPECT_TRUE(seesBar(200));
}

TEST_F(SubtitleTest, APairNamedBeforePreparingComesWithTheMedia) {
    setMedia("plain.mp4");
    ASSERT_TRUE(setPair(pairApart("words")));
    prepareAndStart();
    EXPECT_TRUE(seesBar(200));
}

TEST_F(SubtitleTest, EachPairHasItsOwnPictures) {
    setMedia("plain.mp4");
    ASSERT_TRUE(setPair(pairApart("languages")));
    ASSERT_TRUE(setPair(pairApart("words")));
    ASSERT_TRUE(addFile("words.idx"));
    prepareAndStart();
    EXPECT_EQ(4, trackCount());
    EXPECT_EQ(2, selected()) << "the last one to be turned on";
    EXPECT_TRUE(seesBar(200));
    ASSERT_TRUE(player->onSubtitleTrack(1));
    EXPECT_TRUE(seesBar(100)) << "only the first pair has a second language";
    ASSERT_TRUE(player->onSubtitleTrack(3));
    EXPECT_TRUE(seesBar(200)) << "the pictures beside the index";
}

TEST_F(SubtitleTest, APairThatIsRefusedLeavesNothingBehind) {
    const Pair pair = pairApart("words");
    EXPECT_FALSE(setPair(pair)) << "no media yet";
    openAtLine("plain.mp4");
    EXPECT_FALSE(player->setSubtitleDataSource(pair.index.c_str())) << "no pictures beside it";
    EXPECT_EQ(0, trackCount());
}

TEST_F(SubtitleTest, TheFirstOfSeveralLanguagesIsTurnedOn) {
    openAtLine("plain.mp4");
    ASSERT_TRUE(setFile("languages.idx"));
    EXPECT_EQ(2, trackCount());
    EXPECT_EQ(0, selected());
    EXPECT_TRUE(seesBar(200));
    ASSERT_TRUE(player->onSubtitleTrack(1));
    EXPECT_TRUE(seesBar(100));
}

TEST_F(SubtitleTest, ATimedTextSourceWaitsToBeSelected) {
    openAtLine("plain.mp4");
    ASSERT_TRUE(player->addTimedTextSource(mediaPath("lines.srt").c_str()));
    EXPECT_EQ(-1, selected());
    EXPECT_TRUE(isPlain(sink->newest()));
    ASSERT_TRUE(player->selectTrack(1));
    EXPECT_TRUE(seesText());
}

TEST_F(SubtitleTest, AFileNamedBeforePreparingComesWithTheMedia) {
    ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath("plain.mp4").c_str(), nullptr));
    ASSERT_TRUE(player->setSubtitleDataSource(mediaPath("lines.srt").c_str()));
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_TRUE(seesText());
}

TEST_F(SubtitleTest, OfSeveralFilesNamedBeforeTheOneToBeOnIsOn) {
    for (const bool first : {false, true}) {
        SCOPED_TRACE(first);
        setMedia("plain.mp4");
        ASSERT_TRUE(first ? setFile("words.idx") : addFile("lines.srt"));
        ASSERT_TRUE(first ? addFile("lines.srt") : setFile("words.idx"));
        prepareAndStart();
        EXPECT_EQ(2, trackCount());
        EXPECT_EQ(first ? 0 : 1, selected());
        EXPECT_TRUE(seesBar(200));
        player->reset();
    }
}

TEST_F(SubtitleTest, FilesStayUntilReset) {
    setMedia("plain.mkv");
    ASSERT_TRUE(addFile("lines.srt"));
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(-1, selected());
    ASSERT_TRUE(setPair(pairApart("words")));
    EXPECT_EQ(4, trackCount());
    ASSERT_EQ(NO_ERROR, player->stop());
    ASSERT_TRUE(addFile("lines.ass"));
    prepareAndStart();
    EXPECT_EQ(5, trackCount());
    EXPECT_EQ(3, selected());
    EXPECT_TRUE(seesBar(200));
    player->reset();
    open("plain.mkv");
    EXPECT_EQ(2, trackCount());
    EXPECT_EQ(-1, selected());
}

TEST_F(SubtitleTest, AFileThatIsNoneDoesNotKeepTheMediaFromPreparing) {
    setMedia("plain.mp4");
    ASSERT_TRUE(setFile("lines.srt"));
    ASSERT_TRUE(setFile("garbage.bin")) << "only opened with the media";
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(1, trackCount());
    EXPECT_TRUE(seesText());
}

TEST_F(SubtitleTest, TurnedOnAtTheEndThePlayerStaysThere) {
    open("plain.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(19000, 0));
    playToEnd();
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(setFile("lines.srt"));
    EXPECT_EQ(duration(), position());
    EXPECT_FALSE(player->isPlaying());
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return position() < 5000; })) << "from the start";
    EXPECT_TRUE(seesText());
}

TEST_F(SubtitleTest, RefusesFilesThatAreNone) {
    EXPECT_FALSE(player->setSubtitleDataSource(mediaPath("lines.srt").c_str())) << "no media yet";
    openAtLine("plain.mp4");
    EXPECT_FALSE(player->setSubtitleDataSource(mediaPath("missing.srt").c_str()));
    EXPECT_FALSE(player->setSubtitleDataSource(mediaPath("garbage.bin").c_str()));
    EXPECT_FALSE(player->setSubtitleDataSource(nullptr));
    EXPECT_FALSE(player->addTimedTextSource(""));
    EXPECT_FALSE(player->setSubtitleDataSourceEx(nullptr, nullptr));
    EXPECT_FALSE(player->setSubtitleDataSourceEx(mediaPath("words.sub").c_str(), "/nowhere.idx"));
    EXPECT_EQ(0, trackCount());
}

TEST_F(SubtitleTest, ColoursTheText) {
    openAtLine("plain.mkv");
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(seesText());
    apply(E_SUBTITLE_ATTR_TYPE_TEXT_COLOR, Subtitle_Color{255, 255, 0, 0});
    EXPECT_TRUE(sees([](const Picture& p) {
        int red = 0;
        for (size_t i = 0; i < p.pixels.size(); i += 4) {
            red += p.pixels[i + 2] > 200 && p.pixels[i + 1] < 60 && p.pixels[i] < 60;
        }
        return red > 50;
    }));
}

TEST_F(SubtitleTest, SizesTheText) {
    openAtLine("plain.mkv");
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(seesText());
    const int usual = extentOf(sink->newest()).height();
    apply(E_SUBTITLE_ATTR_TYPE_FONT_INFO, Subtitle_FontInfo{ORV_SUBTITLE_FONT_CUSTOM, 110});
    EXPECT_TRUE(sees([&](const Picture& p) { return extentOf(p).height() > usual * 1.6; }));
}

TEST_F(SubtitleTest, MovesTheText) {
    openAtLine("plain.mkv");
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(seesText());
    const int usual = extentOf(sink->newest()).top;
    apply(E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET, Subtitle_TimeOffset{0, -500});
    EXPECT_TRUE(sees([&](const Picture& p) {
        const Extent extent = extentOf(p);
        return extent.right >= 0 && std::abs(usual - extent.top - 180) < 20;
    }));
}

// What the media may open is another matter.
TEST_F(SubtitleTest, AFileLeavesTheReachOfTheMediaAsItWas) {
    constexpr char kOptions[] = "demuxer-lavf-o";
    orvtarn::MpvHandle mpv;
    ASSERT_TRUE(mpv.create());
    ASSERT_EQ(0, mpv.set(kOptions, "protocol_whitelist=[file,http],seekable=0"));
    const std::optional<std::string> before = mpv.getString(kOptions);
    orvtarn::SubtitleLoader loader(mpv);
    loader.open({mediaPath("lines.srt"), "", false});
    EXPECT_EQ(before, mpv.getString(kOptions));
    EXPECT_NE("", before);
    mpv.destroy();
}

TEST_F(SubtitleTest, DelaysTheText) {
    openAtLine("plain.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(0, 0));
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(seesText());
    apply(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET,
          Subtitle_TimeOffset{ORV_SUBTITLE_TIME_OFFSET_DELAY, 1000});
    EXPECT_TRUE(seesNothing());
}

TEST_F(SubtitleTest, StagedAttributesWaitForTheFlush) {
    openAtLine("plain.mkv");
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(seesText());
    const Picture before = sink->newest();
    Subtitle_FontInfo font{ORV_SUBTITLE_FONT_CUSTOM, 110};
    Subtitle_Color colour{255, 255, 0, 0};
    ASSERT_TRUE(player->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &font));
    ASSERT_TRUE(player->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_TEXT_COLOR, &colour));
    // Drawn anew, it looks as it did.
    const uint64_t frames = sink->frameCount();
    ASSERT_EQ(NO_ERROR, player->seekTo(4000, 0));
    ASSERT_TRUE(sink->waitFor(frames));
    EXPECT_EQ(0, sink->newest().differences(before));
    ASSERT_TRUE(player->flushSubtitleAttr());
    EXPECT_TRUE(sees([&](const Picture& p) { return p.differences(before) > 500; }));
    EXPECT_FALSE(player->setSubtitleAttr(99, &font));
    EXPECT_FALSE(player->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_FONT_INFO, nullptr));
}

TEST_F(SubtitleTest, ResetForgetsTheLook) {
    openAtLine("plain.mkv");
    ASSERT_TRUE(player->onSubtitleTrack(0));
    ASSERT_TRUE(seesText());
    const Picture usual = sink->newest();
    apply(E_SUBTITLE_ATTR_TYPE_FONT_INFO, Subtitle_FontInfo{ORV_SUBTITLE_FONT_CUSTOM, 110});
    ASSERT_TRUE(sees([&](const Picture& p) { return p.differences(usual) > 500; }));
    player->reset();
    openAtLine("plain.mkv");
    ASSERT_TRUE(player->onSubtitleTrack(0));
    EXPECT_TRUE(sees([&](const Picture& p) { return p.differences(usual) == 0; }));
}

TEST_F(SubtitleTest, TheGreyIsGrey) {
    openAtLine("plain.mkv");
    EXPECT_NEAR(kGrey, sink->newest().brightness(), 4);
}

}  // namespace
