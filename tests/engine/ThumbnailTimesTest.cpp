// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <cmath>

#include "ThumbnailPictures.h"

namespace orvtarn {
namespace {

using orvtest::decodedAt;
using orvtest::openThumbnailer;
using orvtest::psnr;
using orvtest::thumbnailAt;

// The frame beside the right one has less than 25 dB.
const double kSamePicture = 30;  // dB

struct Media {
    const char* name;
    std::vector<double> seconds;
};

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

}  // namespace
}  // namespace orvtarn
