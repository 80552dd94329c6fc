// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>
#include <string.h>

#include <array>

#include "base/PictureFilters.h"
#include "inspect/FilterGraph.h"

namespace orvtarn {
namespace {

constexpr int kWidth = 32;
constexpr int kHeight = 16;

Frame grayFrame() {
    Frame frame(av_frame_alloc());
    frame->format = AV_PIX_FMT_GRAY8;
    frame->width = kWidth;
    frame->height = kHeight;
    EXPECT_EQ(av_frame_get_buffer(frame.get(), 0), 0);
    return frame;
}

Frame solid(uint8_t level) {
    Frame frame = grayFrame();
    for (int y = 0; y < kHeight; y++) {
        memset(frame->data[0] + y * frame->linesize[0], level, kWidth);
    }
    return frame;
}

// One level in each quarter: left and right above, left and right below.
Frame quarters(const std::array<uint8_t, 4>& levels) {
    Frame frame = grayFrame();
    for (int y = 0; y < kHeight; y++) {
        for (int x = 0; x < kWidth; x++) {
            frame->data[0][y * frame->linesize[0] + x] =
                levels[(y < kHeight / 2 ? 0 : 2) + (x < kWidth / 2 ? 0 : 1)];
        }
    }
    return frame;
}

std::array<uint8_t, 4> corners(const AVFrame& frame) {
    const uint8_t* bottom = frame.data[0] + (frame.height - 1) * frame.linesize[0];
    return {frame.data[0][0], frame.data[0][frame.width - 1], bottom[0], bottom[frame.width - 1]};
}

TEST(FilterGraph, TurnsAndMirrorsAsTheOrientationSays) {
    const Frame frame = quarters({1, 2, 3, 4});
    struct Expected {
        Orientation orientation;
        std::array<uint8_t, 4> corners;
    };
    const Expected all[] = {
        {{90, false}, {3, 1, 4, 2}}, {{180, false}, {4, 3, 2, 1}}, {{270, false}, {2, 4, 1, 3}},
        {{0, true}, {2, 1, 4, 3}},   {{90, true}, {1, 3, 2, 4}},   {{180, true}, {3, 4, 1, 2}},
        {{270, true}, {4, 2, 3, 1}},
    };
    for (const Expected& one : all) {
        PictureTraits traits;
        traits.orientation = one.orientation;
        const Frame turned = filterFrames(pictureFilters(traits), {frame.get()}, 0);
        ASSERT_NE(turned, nullptr);
        EXPECT_EQ(turned->width, one.orientation.isLying() ? kHeight : kWidth);
        EXPECT_EQ(corners(*turned), one.corners)
            << one.orientation.rotation << one.orientation.isMirrored;
    }
}

TEST(FilterGraph, TakesTheFrameThatBelongsToTheWantedOne) {
    const Frame frames[] = {solid(10), solid(20), solid(30)};
    for (size_t wanted = 0; wanted < 3; wanted++) {
        for (const char* graph : {"hflip", "bwdif=mode=send_frame:deint=all"}) {
            const Frame one =
                filterFrames(graph, {frames[0].get(), frames[1].get(), frames[2].get()}, wanted);
            ASSERT_NE(one, nullptr) << graph << wanted;
            EXPECT_NEAR(one->data[0][0], 10 * static_cast<int>(wanted + 1), 1) << graph;
        }
    }
    EXPECT_EQ(frames[0]->data[0][0], 10);
}

TEST(FilterGraph, IsNothingWhereItCannotBeBuiltOrFed) {
    const Frame frame = solid(10);
    EXPECT_EQ(filterFrames("nosuchfilter", {frame.get()}, 0), nullptr);
    EXPECT_EQ(filterFrames("hflip", {}, 0), nullptr);
    EXPECT_EQ(filterFrames("hflip", {frame.get()}, 1), nullptr);
    // Larger than the picture.
    EXPECT_EQ(filterFrames("crop=1000:1000", {frame.get()}, 0), nullptr);
}

}  // namespace
}  // namespace orvtarn
