// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <cmath>

#include "TestMedia.h"
#include "ThumbnailPictures.h"

namespace orvtarn {
namespace {

using orvtest::decodedAt;
using orvtest::kSamePicture;
using orvtest::openThumbnailer;
using orvtest::psnr;
using orvtest::thumbnailAt;

// The frame beside the right one has less than 25 dB.

struct Media {
    const char* name;
    std::vector<double> seconds;
};
void PrintTo(const Media& media, std::ostream* out) { *out << media.name; }

// Formats without an index, whose times do not begin at 0. Behind the second key
// frame there is little left: guesses tend to land there.
const Media kMedia[] = {
    {"stream.ts", {0, 0.7, 1.9, 2, 5.3, 7.3, 8.9}},
    {"stream.m2ts", {0, 0.7, 1.9, 2, 5.3, 7.3, 8.9}},
    {"stream.mpg", {0, 0.72, 1.92, 2, 5.32, 7.32, 8.6}},
    {"stream.vob", {0, 0.72, 1.92, 2, 5.32, 7.32, 8.6}},
    {"distant.ts", {0.1, 7.3, 13.3, 19.9, 20, 23.9}},
    {"distant.m2ts", {0.1, 7.3, 13.3, 19.9, 20, 23.9}},
    {"distant.mpg", {0.12, 7.32, 13.32, 19.72, 20.12, 23.52}},
    {"distant.vob", {0.12, 7.32, 13.32, 19.72, 20.12, 23.52}},
};

class ThumbnailTimes : public testing::TestWithParam<Media> {};

TEST_P(ThumbnailTimes, AreThoseOfTheFramesThatFfmpegDecodes) {
    const Media& media = GetParam();
    const auto thumbnailer = openThumbnailer(media.name);
    ASSERT_NE(thumbnailer, nullptr);
    for (const double time : media.seconds) {
        EXPECT_GE(psnr(thumbnailAt(*thumbnailer, std::lround(1000 * time), 160, 90),
                       decodedAt(media.name, time, "", 160, 90)),
                  kSamePicture)
            << media.name << " at " << time;
    }
}

INSTANTIATE_TEST_SUITE_P(Broadcast, ThumbnailTimes, testing::ValuesIn(kMedia),
                         [](const auto& info) {
                             std::string name = info.param.name;
                             name[name.find('.')] = '_';
                             return name;
                         });

// Frame by frame, in leaps, in one place, back and on again.
const std::vector<int64_t> kWalk = {0,    0,    20,   40,   80,   81,   700,  700,
                                    1960, 2000, 2040, 2041, 3900, 1300, 1340, 1380,
                                    5300, 8560, 9960, 9990, 9999, 8000};

class ThumbnailsInOrder : public testing::TestWithParam<const char*> {};

TEST_P(ThumbnailsInOrder, AreThoseThatAreDrawnOnTheirOwn) {
    const auto thumbnailer = openThumbnailer(GetParam());
    ASSERT_NE(thumbnailer, nullptr);
    for (const int64_t position : kWalk) {
        const auto alone = openThumbnailer(GetParam());
        ASSERT_NE(alone, nullptr);
        EXPECT_EQ(thumbnailAt(*thumbnailer, position, 160, 90),
                  thumbnailAt(*alone, position, 160, 90))
            << GetParam() << " at " << position;
    }
}

INSTANTIATE_TEST_SUITE_P(All, ThumbnailsInOrder,
                         testing::Values("video.mp4", "video.mkv", "video.avi", "stream.ts",
                                         "stream.mpg", "counted-varying.mkv", "slides.mkv",
                                         "still.png"),
                         [](const auto& info) { return orvtest::testName(info.param); });

// A thumbnailer of a file in memory, and what it reads from.
struct InMemory {
    explicit InMemory(const std::string& name) : bytes(orvtest::bytesOf(orvtest::mediaPath(name))) {
        auto memory = std::make_unique<orvtest::MemorySource>(bytes);
        source = memory.get();
        std::unique_ptr<MediaFile> file;
        EXPECT_EQ(MediaFile::open(std::move(memory), {}, file), 0);
        EXPECT_EQ(Thumbnailer::create(std::move(file), -1, thumbnailer), 0);
    }

    const std::vector<uint8_t> bytes;
    orvtest::MemorySource* source;  // the thumbnailer's
    std::unique_ptr<Thumbnailer> thumbnailer;
};

TEST(ThumbnailTimes, InOrderReadTheMediaOnce) {
    const InMemory media("distant.mkv");
    ASSERT_NE(media.thumbnailer, nullptr);
    // Before the second key frame; each on its own reads half of that.
    for (int64_t position = 0; position < 14000; position += 250) {
        thumbnailAt(*media.thumbnailer, position, 160, 90);
    }
    EXPECT_LT(media.source->mBytesRead, 2 * static_cast<int64_t>(media.bytes.size()));
}

TEST(ThumbnailTimes, AreRightAgainWhenTheMediaCanBeReadAgain) {
    const InMemory media("distant.mkv");
    ASSERT_NE(media.thumbnailer, nullptr);
    media.source->mFailsAt = static_cast<int64_t>(media.bytes.size() / 4);
    thumbnailAt(*media.thumbnailer, 12000, 160, 90);
    media.source->mFailsAt = -1;
    EXPECT_EQ(thumbnailAt(*media.thumbnailer, 12500, 160, 90),
              thumbnailAt(*openThumbnailer("distant.mkv"), 12500, 160, 90));
}

}  // namespace
}  // namespace orvtarn
