// SPDX-License-Identifier: Apache-2.0
// The times of frames and of positions are the file's own.
#include <media/MediaTrack.h>
#include <orvtarn/PlayerTypes.h>

#include <algorithm>
#include <cmath>

#include "CountedFrames.h"
#include "HttpServer.h"
#include "PlayerTest.h"
#include "inspect/PictureCanvas.h"

using namespace android;
using namespace orvtest;

namespace {

// Media whose frames show their numbers.
struct Counted {
    const char* file;
    double framesPerSecond;  // by which the numbers count
    int last;                // frame
};

void PrintTo(const Counted& media, std::ostream* out) { *out << media.file; }

const Counted kSixty = {"counted-60.mkv", 60, 239};
const Counted kSound = {"counted-sound.mkv", 60, 239};
const Counted kFilm = {"counted-film.mp4", 24000 / 1001.0, 95};
const Counted kVarying = {"counted-varying.mkv", 60, 239};
const Counted kTransport = {"counted.ts", 25, 99};

class TimeTest : public PlayerTest {
protected:
    TimeTest() { player->setVideoSurfaceTexture(frames); }
    ~TimeTest() override { player->release(); }

    static double millisecondsOf(const Counted& media, int number) {
        return number * 1000 / media.framesPerSecond;
    }

    // Whether the frames came with their own times, to a millisecond.
    static void expectOwnTimes(const Counted& media, const std::vector<CountedFrame>& frames) {
        for (const CountedFrame& frame : frames) {
            EXPECT_NEAR(millisecondsOf(media, frame.number),
                        static_cast<double>(frame.timestampUs) / 1000, 1)
                << "frame " << frame.number;
        }
    }

    // Whether the player stands at a frame, and shows it.
    void expectAt(const Counted& media, int number) {
        EXPECT_TRUE(eventually([&] { return frames->last().number == number; }, 5))
            << "frame " << frames->last().number << " in place of " << number;
        EXPECT_NEAR(millisecondsOf(media, number), position(), 1);
        const CountedFrame last = frames->last();
        EXPECT_NEAR(millisecondsOf(media, last.number),
                    static_cast<double>(last.timestampUs) / 1000, 1);
    }

    // Whether the frame that is shown comes to be that of the position.
    void expectShown(const Counted& media) {
        const auto isShown = [&] {
            return std::abs(millisecondsOf(media, frames->last().number) - position()) <= 1;
        };
        EXPECT_TRUE(eventually(isShown, 5))
            << "frame " << frames->last().number << " at " << position() << " ms";
    }

    status_t seekTo(int msec) {
        return player->seekTo(msec, MediaTrack::ReadOptions::SEEK_CLOSEST);
    }

    // Of the frame that a thumbnail shows.
    int thumbnailNumber() {
        const int stride = orvtarn::thumbnailStride(ORV_COLOR_MODE_XRGB8888, kWidth);
        Picture picture = {kWidth, kHeight, 0, std::vector<uint8_t>(stride * kHeight)};
        _Media_Thumbnail_Info_T thumbnail = {picture.pixels.data(),
                                             static_cast<uint32_t>(picture.pixels.size()),
                                             ORV_COLOR_MODE_XRGB8888, kWidth, kHeight};
        EXPECT_TRUE(player->getThumbnailInfo(&thumbnail));
        return numberIn(picture);
    }

    static constexpr int kWidth = 128;
    static constexpr int kHeight = 32;
    sp<CountingSink> frames = new CountingSink;
};

class FrameTimeTest : public TimeTest,
                      public testing::WithParamInterface<std::tuple<Counted, int>> {};

TEST_P(FrameTimeTest, IsTheFilesOwn) {
    const Counted& media = std::get<0>(GetParam());
    const int speed = std::get<1>(GetParam());
    open(media.file);
    ASSERT_EQ(NO_ERROR, player->setSpeed(speed));
    playToEnd();
    EXPECT_TRUE(eventually([&] { return frames->last().number == media.last; }, 3));
    const std::vector<CountedFrame> seen = frames->take();
    EXPECT_GT(seen.size(), 20u);
    expectOwnTimes(media, seen);
}

std::string nameOf(const testing::TestParamInfo<std::tuple<Counted, int>>& info) {
    return testName(std::get<0>(info.param).file) + "_" + std::to_string(std::get<1>(info.param));
}

INSTANTIATE_TEST_SUITE_P(Speeds, FrameTimeTest,
                         testing::Combine(testing::Values(kSixty, kFilm, kVarying, kTransport),
                                          testing::Values(500, 1000, 1500)),
                         nameOf);
// Of up to a hundred frames a second: busy machines leave frames out beyond.
INSTANTIATE_TEST_SUITE_P(FastSpeeds, FrameTimeTest,
                         testing::Combine(testing::Values(kFilm, kTransport),
                                          testing::Values(4000)),
                         nameOf);

TEST_F(TimeTest, FramesOfALoopHaveTheirOwnTimes) {
    open(kSixty.file);
    ASSERT_EQ(NO_ERROR, player->setLooping(true));
    ASSERT_EQ(NO_ERROR, player->setSpeed(2000));
    ASSERT_EQ(NO_ERROR, player->start());
    for (int round = 0; round < 2; round++) {
        ASSERT_TRUE(eventually([&] { return frames->last().number > 200; }));
        ASSERT_TRUE(eventually([&] { return frames->last().number < 100; }));
    }
    ASSERT_EQ(NO_ERROR, player->pause());
    expectOwnTimes(kSixty, frames->take());
}

TEST_F(TimeTest, FramesOfARepeatedSectionHaveTheirOwnTimes) {
    open(kSixty.file);
    ASSERT_EQ(NO_ERROR, seekTo(1000));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_A));
    ASSERT_EQ(NO_ERROR, seekTo(2000));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B));
    ASSERT_EQ(NO_ERROR, seekTo(1000));
    ASSERT_EQ(NO_ERROR, player->start());
    for (int round = 0; round < 2; round++) {
        ASSERT_TRUE(eventually([&] { return frames->last().number > 110; }));
        ASSERT_TRUE(eventually([&] { return frames->last().number < 80; }));
    }
    ASSERT_EQ(NO_ERROR, player->pause());
    expectOwnTimes(kSixty, frames->take());
}

TEST_F(TimeTest, FramesPlayedBackwardHaveTheirOwnTimes) {
    open(kSixty.file);
    ASSERT_EQ(NO_ERROR, seekTo(3500));
    ASSERT_EQ(NO_ERROR, player->setSpeed(-1000));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return frames->last().number < 60; }));
    ASSERT_EQ(NO_ERROR, player->pause());
    expectOwnTimes(kSixty, frames->take());
}

TEST_F(TimeTest, FramesAfterPausesAndSeeksHaveTheirOwnTimes) {
    open(kSixty.file);
    for (const int msec : {500, 3000, 1200, 2000}) {
        ASSERT_EQ(NO_ERROR, seekTo(msec));
        ASSERT_EQ(NO_ERROR, player->start());
        ASSERT_TRUE(eventually([&] { return position() > msec + 300; }));
        ASSERT_EQ(NO_ERROR, player->seekTo(msec, 0));
        ASSERT_TRUE(eventually([&] { return position() > msec; }));
        ASSERT_EQ(NO_ERROR, player->pause());
    }
    expectOwnTimes(kSixty, frames->take());
}

TEST_F(TimeTest, StepsCountFramesOfAVaryingRate) {
    open(kVarying.file);
    // Of ten frames the first, second, third, ninth and tenth are there.
    ASSERT_TRUE(player->step(5));
    expectAt(kVarying, 10);
    ASSERT_TRUE(player->step(27));
    expectAt(kVarying, 62);
    ASSERT_TRUE(player->step(-28));
    expectAt(kVarying, 9);
}

// Beside sound the frames of a file need not begin at its time zero.
TEST_F(TimeTest, StepsAndThumbnailsBesideSoundAreOfThoseFrames) {
    open(kSound.file);
    ASSERT_TRUE(player->step(40));
    expectAt(kSound, 40);
    EXPECT_EQ(40, thumbnailNumber());
    ASSERT_TRUE(player->step(-17));
    expectAt(kSound, 23);
    EXPECT_EQ(23, thumbnailNumber());
    ASSERT_EQ(NO_ERROR, player->seekTo(2500, MediaTrack::ReadOptions::SEEK_PREVIOUS_SYNC));
    expectAt(kSound, 120);
    EXPECT_EQ(120, thumbnailNumber());
    ASSERT_EQ(NO_ERROR, player->seekTo(2900, MediaTrack::ReadOptions::SEEK_CLOSEST_SYNC));
    expectAt(kSound, 180);
}

TEST_F(TimeTest, StepsFromAServerCountByTheRate) {
    HttpServer server(mediaPath(kFilm.file));
    ASSERT_EQ(NO_ERROR, player->setDataSource(server.url().c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, player->prepare());
    ASSERT_TRUE(player->step(40));
    expectAt(kFilm, 40);
    ASSERT_TRUE(player->step(-12));
    expectAt(kFilm, 28);
    EXPECT_FALSE(player->step(1000));
    expectAt(kFilm, kFilm.last);
}

TEST_F(TimeTest, AStepAfterBackwardPlayIsDone) {
    open(kSixty.file);
    ASSERT_EQ(NO_ERROR, seekTo(3000));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_EQ(NO_ERROR, player->setSpeed(-1000));
    ASSERT_TRUE(eventually([&] { return position() < 2700; }));
    ASSERT_EQ(NO_ERROR, player->setSpeed(1000));
    ASSERT_TRUE(player->step(1));
    expectShown(kSixty);
    EXPECT_LT(position(), 2900);
    EXPECT_GT(position(), 1000);
}

TEST_F(TimeTest, PlaybackBeginsAgainAtItsFirstFrame) {
    open(kFilm.file);
    ASSERT_EQ(NO_ERROR, player->setSpeed(4000));
    playToEnd();
    frames->take();
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(player->step(1));
    expectShown(kFilm);
    EXPECT_LT(position(), 2000);
}

// After a seek its frame is shown, however busy the machine is.
TEST_F(TimeTest, AfterTheEndItBeginsWithFrameZero) {
    open(kFilm.file);
    ASSERT_EQ(NO_ERROR, player->setSpeed(4000));
    playToEnd();
    ASSERT_EQ(NO_ERROR, player->setSpeed(1000));
    ASSERT_TRUE(eventually([&] { return frames->last().number == kFilm.last; }));
    frames->take();
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return frames->last().number != kFilm.last; }));
    const std::vector<CountedFrame> seen = frames->take();
    const auto first = std::find_if(seen.begin(), seen.end(), [](const CountedFrame& frame) {
        return frame.number != kFilm.last;  // which may be drawn once more
    });
    ASSERT_NE(seen.end(), first);
    EXPECT_EQ(0, first->number);
}

// At the start of the media the direction turns.
class TurningTest : public TimeTest, public testing::WithParamInterface<int> {};

TEST_P(TurningTest, BackwardToTheStartItGoesOnFromFrameZero) {
    open(kFilm.file);
    ASSERT_EQ(NO_ERROR, seekTo(2000));
    ASSERT_EQ(NO_ERROR, player->setSpeed(GetParam()));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return speed() == 1000; }));
    ASSERT_TRUE(eventually([&] { return position() > 1500; }));
    ASSERT_EQ(NO_ERROR, player->pause());
    int lowest = kFilm.last;
    const std::vector<CountedFrame> seen = frames->take();
    for (const CountedFrame& frame : seen) lowest = std::min(lowest, frame.number);
    EXPECT_EQ(0, lowest);
    EXPECT_GT(seen.back().number, lowest);
}

INSTANTIATE_TEST_SUITE_P(Speeds, TurningTest, testing::Values(-1000, -16000),
                         [](const auto& info) { return "Minus" + std::to_string(-info.param); });

class PositionTest : public TimeTest, public testing::WithParamInterface<Counted> {};

TEST_P(PositionTest, OfAnExactSeekIsItsFrames) {
    const Counted& media = GetParam();
    open(media.file);
    for (const int number : {75, 15, 90, 1, 0}) {
        const int msec = static_cast<int>(std::lround(millisecondsOf(media, number)));
        ASSERT_EQ(NO_ERROR, seekTo(msec));
        expectAt(media, number);
    }
}

TEST_P(PositionTest, OfASteppedFrameIsItsOwn) {
    const Counted& media = GetParam();
    open(media.file);
    int number = 0;
    for (const int amount : {1, 3, 40, -2, -30, 60, -71}) {
        ASSERT_TRUE(player->step(amount)) << amount;
        number += amount;
        expectAt(media, number);
    }
    EXPECT_FALSE(player->step(1000));
    expectAt(media, media.last);
    EXPECT_FALSE(player->step(-1000));
    expectAt(media, 0);
}

TEST_P(PositionTest, StaysWhenTheDirectionTurns) {
    const Counted& media = GetParam();
    open(media.file);
    const int number = 60;
    ASSERT_EQ(NO_ERROR, seekTo(static_cast<int>(std::lround(millisecondsOf(media, number)))));
    ASSERT_EQ(NO_ERROR, player->setSpeed(-1000));
    ASSERT_TRUE(player->step(1)) << "frames are counted forward";
    expectAt(media, number + 1);
    ASSERT_EQ(NO_ERROR, player->setSpeed(1000));
    expectAt(media, number + 1);
    ASSERT_TRUE(player->step(-1));
    expectAt(media, number);
}

INSTANTIATE_TEST_SUITE_P(Media, PositionTest, testing::Values(kSixty, kSound, kFilm, kTransport),
                         [](const auto& info) { return testName(info.param.file); });

}  // namespace
