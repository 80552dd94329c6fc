// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <memory>
#include <vector>

#include "inspect/PictureCanvas.h"

extern "C" {
#include <libavutil/frame.h>
}

namespace orvtarn {
namespace {

const int32_t kModes[] = {3, 4, 5, 9, 10, 11, 12, 15, 16, 17, 18};

struct FreeFrame {
    void operator()(AVFrame* frame) const { av_frame_free(&frame); }
};
typedef std::unique_ptr<AVFrame, FreeFrame> Frame;

struct Rgba {
    uint8_t r, g, b, a;
};

Frame rgbaFrame(int width, int height) {
    Frame frame(av_frame_alloc());
    frame->format = AV_PIX_FMT_RGBA;
    frame->width = width;
    frame->height = height;
    EXPECT_EQ(av_frame_get_buffer(frame.get(), 0), 0);
    return frame;
}

void setPixel(AVFrame& frame, int x, int y, Rgba color) {
    memcpy(frame.data[0] + y * frame.linesize[0] + 4 * x, &color, 4);
}

Frame solid(int width, int height, Rgba color) {
    Frame frame = rgbaFrame(width, height);
    for (int y = 0; y < height; y++) {
        for (int x = 0; x < width; x++) setPixel(*frame, x, y, color);
    }
    return frame;
}

const uint8_t kUntouched = 0xA5;

// A thumbnail with guard bytes behind its last row.
struct Drawn {
    Drawn(int32_t mode, int32_t width, int32_t height)
        : stride(thumbnailStride(mode, width)),
          buffer(stride * height + 64, kUntouched),
          request{buffer.data(), static_cast<uint32_t>(stride * height), mode, width, height} {}

    // The pixel's bytes as a number, low byte first.
    uint32_t pixel(int x, int y) const {
        uint32_t value = 0;
        const int size = bytesPerPixel(request.i4CanvasColormode);
        memcpy(&value, buffer.data() + y * stride + x * size, size);
        return value;
    }

    size_t stride;
    std::vector<uint8_t> buffer;
    _Media_Thumbnail_Info_T request;
};

uint32_t pixelOf(int32_t mode, Rgba color) {
    Drawn drawn(mode, 4, 4);
    EXPECT_EQ(drawPicture(*solid(16, 16, color), drawn.request), 0);
    return drawn.pixel(2, 2);
}

TEST(PictureCanvas, HasTheBytesOfEachMode) {
    const int expected[20] = {0, 0, 0, 2, 2, 4, 0, 0, 0, 2, 2, 2, 4, 0, 0, 2, 2, 4, 4, 0};
    for (int mode = 0; mode < 20; mode++) EXPECT_EQ(bytesPerPixel(mode), expected[mode]) << mode;
    for (int mode : {-1, 20, 255, INT32_MAX, INT32_MIN}) EXPECT_EQ(bytesPerPixel(mode), 0);
}

TEST(PictureCanvas, PadsRowsTo64Bytes) {
    EXPECT_EQ(thumbnailStride(ORV_COLOR_MODE_RGB565, 1), 64u);
    EXPECT_EQ(thumbnailStride(ORV_COLOR_MODE_RGB565, 32), 64u);
    EXPECT_EQ(thumbnailStride(ORV_COLOR_MODE_RGB565, 33), 128u);
    EXPECT_EQ(thumbnailStride(ORV_COLOR_MODE_ARGB8888, 10), 64u);
    EXPECT_EQ(thumbnailStride(ORV_COLOR_MODE_ARGB8888, 16), 64u);
    EXPECT_EQ(thumbnailStride(ORV_COLOR_MODE_ARGB8888, 17), 128u);
}

TEST(PictureCanvas, DrawsOrangeAsEachModeSays) {
    const Rgba orange = {255, 128, 0, 255};
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB8888, orange), 0xFFFF8000u);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_XRGB8888, orange), 0xFFFF8000u);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_RGBA8888, orange), 0xFF0080FFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ABGR8888, orange), 0xFF8000FFu);
}

// Full and empty channels, which no rounding or dithering moves.
TEST(PictureCanvas, PutsEachChannelInItsBits) {
    struct Expected {
        Rgba color;
        uint32_t rgb565, bgr565, argb1555, argb4444;
    };
    const Expected all[] = {
        {{255, 0, 0, 255}, 0xF800, 0x001F, 0xFC00, 0xFF00},
        {{0, 255, 0, 255}, 0x07E0, 0x07E0, 0x83E0, 0xF0F0},
        {{0, 0, 255, 255}, 0x001F, 0xF800, 0x801F, 0xF00F},
        {{255, 255, 255, 255}, 0xFFFF, 0xFFFF, 0xFFFF, 0xFFFF},
        {{0, 0, 0, 255}, 0x0000, 0x0000, 0x8000, 0xF000},
    };
    for (const Expected& one : all) {
        EXPECT_EQ(pixelOf(ORV_COLOR_MODE_RGB565, one.color), one.rgb565);
        EXPECT_EQ(pixelOf(ORV_COLOR_MODE_BGR565, one.color), one.bgr565);
        EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB1555, one.color), one.argb1555);
        EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB4444, one.color), one.argb4444);
    }
}

TEST(PictureCanvas, KeepsThePicturesAlpha) {
    const Rgba clear = {255, 255, 255, 0};
    const Rgba faint = {255, 255, 255, 0x22};
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB8888, clear), 0x00FFFFFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_RGBA8888, clear), 0x00FFFFFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ABGR8888, clear), 0xFFFFFF00u);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_XRGB8888, clear), 0xFFFFFFFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB1555, {255, 255, 255, 0x90}), 0xFFFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB1555, faint), 0x7FFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB4444, faint), 0x2FFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB4444, clear), 0x0FFFu);
}

TEST(PictureCanvas, RoundsAlphaToTheBitsThatThereAre) {
    const auto white = [](uint8_t alpha) { return Rgba{255, 255, 255, alpha}; };
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB1555, white(0x7F)), 0x7FFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB1555, white(0x80)), 0xFFFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB4444, white(8)), 0x0FFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB4444, white(9)), 0x1FFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB4444, white(244)), 0xEFFFu);
    EXPECT_EQ(pixelOf(ORV_COLOR_MODE_ARGB4444, white(249)), 0xFFFFu);
}

// The red, green and blue of what such a frame of one colour is drawn as.
Rgba rgbOf(AVPixelFormat format, AVColorSpace matrix, AVColorRange range, int y, int u, int v) {
    const Frame frame(av_frame_alloc());
    frame->format = format;
    frame->width = frame->height = 16;
    frame->colorspace = matrix;
    frame->color_range = range;
    EXPECT_EQ(av_frame_get_buffer(frame.get(), 0), 0);
    memset(frame->data[0], y, static_cast<size_t>(frame->linesize[0]) * 16);
    memset(frame->data[1], u, static_cast<size_t>(frame->linesize[1]) * 8);
    memset(frame->data[2], v, static_cast<size_t>(frame->linesize[2]) * 8);
    Drawn drawn(ORV_COLOR_MODE_ARGB8888, 4, 4);
    EXPECT_EQ(drawPicture(*frame, drawn.request), 0);
    const uint32_t pixel = drawn.pixel(2, 2);
    return {static_cast<uint8_t>(pixel >> 16), static_cast<uint8_t>(pixel >> 8),
            static_cast<uint8_t>(pixel), static_cast<uint8_t>(pixel >> 24)};
}

// The red of BT.601 has some green by the matrix of BT.709.
TEST(PictureCanvas, GoesByTheFramesMatrix) {
    const auto green = [](AVColorSpace matrix) {
        return rgbOf(AV_PIX_FMT_YUV420P, matrix, AVCOL_RANGE_MPEG, 81, 90, 240).g;
    };
    EXPECT_NEAR(green(AVCOL_SPC_SMPTE170M), 0, 3);
    EXPECT_NEAR(green(AVCOL_SPC_UNSPECIFIED), 0, 3) << "as its size is usual with";
    EXPECT_NEAR(green(AVCOL_SPC_BT709), 24, 4);
}

TEST(PictureCanvas, GoesByTheFramesRange) {
    const auto gray = [](AVPixelFormat format, AVColorRange range) {
        return rgbOf(format, AVCOL_SPC_SMPTE170M, range, 16, 128, 128).g;
    };
    EXPECT_NEAR(gray(AV_PIX_FMT_YUV420P, AVCOL_RANGE_MPEG), 0, 1);
    EXPECT_NEAR(gray(AV_PIX_FMT_YUV420P, AVCOL_RANGE_UNSPECIFIED), 0, 1);
    EXPECT_NEAR(gray(AV_PIX_FMT_YUV420P, AVCOL_RANGE_JPEG), 16, 1);
    EXPECT_NEAR(gray(AV_PIX_FMT_YUVJ420P, AVCOL_RANGE_UNSPECIFIED), 16, 1);
}

// Luma and chroma of BT.601 in limited range: red is Y 81, U 90, V 240.
TEST(PictureCanvas, DrawsYuvInItsByteOrder) {
    const auto near = [](int value, int expected) { return abs(value - expected) <= 2; };
    Drawn uyvy(ORV_COLOR_MODE_UYVY422, 4, 4);
    Drawn yuyv(ORV_COLOR_MODE_YUYV422, 4, 4);
    const Frame red = solid(16, 16, {255, 0, 0, 255});
    ASSERT_EQ(drawPicture(*red, uyvy.request), 0);
    ASSERT_EQ(drawPicture(*red, yuyv.request), 0);
    const int expected[] = {90, 81, 240, 81};
    for (int i = 0; i < 4; i++) {
        EXPECT_PRED2(near, uyvy.buffer[i], expected[i]) << i;
        EXPECT_PRED2(near, yuyv.buffer[i ^ 1], expected[i]) << i;
    }
}

TEST(PictureCanvas, DrawsGrayInFullRange) {
    EXPECT_LE(pixelOf(ORV_COLOR_MODE_GRAY16, {0, 0, 0, 255}), 0x0200u);
    EXPECT_GE(pixelOf(ORV_COLOR_MODE_GRAY16, {255, 255, 255, 255}), 0xFD00u);
    const int gray = static_cast<int>(pixelOf(ORV_COLOR_MODE_GRAY16, {128, 128, 128, 255}));
    EXPECT_NEAR(gray, 0x8080, 0x200);
}

TEST(PictureCanvas, WritesNothingBesideThePixels) {
    const Frame frame = solid(64, 48, {255, 255, 255, 255});
    for (int32_t mode : kModes) {
        for (int width : {1, 2, 15, 16, 17, 32, 33, 64}) {
            Drawn drawn(mode, width, 3);
            ASSERT_EQ(drawPicture(*frame, drawn.request), 0) << mode << ", " << width;
            const size_t used = static_cast<size_t>(width) * bytesPerPixel(mode);
            for (size_t i = 0; i < drawn.buffer.size(); i++) {
                if (i >= drawn.stride * 3 || i % drawn.stride >= used) {
                    ASSERT_EQ(drawn.buffer[i], kUntouched) << mode << ", " << width << ", " << i;
                }
            }
        }
    }
}

TEST(PictureCanvas, DrawsEverySizeFromThinToLarge) {
    const Frame frame = solid(1920, 1080, {10, 200, 30, 255});
    const int sizes[][2] = {{1, 1}, {1, 255}, {4096, 1}, {255, 255}, {2, 2}, {1921, 3}};
    for (int32_t mode : kModes) {
        for (const auto& size : sizes) {
            Drawn drawn(mode, size[0], size[1]);
            ASSERT_EQ(drawPicture(*frame, drawn.request), 0) << mode << ", " << size[0];
            EXPECT_EQ(drawn.buffer[drawn.stride * size[1]], kUntouched);
        }
    }
    Drawn drawn(ORV_COLOR_MODE_ARGB8888, 255, 1);
    ASSERT_EQ(drawPicture(*frame, drawn.request), 0);
    const int expected[] = {30, 200, 10, 255};
    for (int i = 0; i < 255 * 4; i++) EXPECT_NEAR(drawn.buffer[i], expected[i % 4], 2) << i;
}

bool isRefused(int32_t mode, int32_t width, int32_t height, uint32_t size, bool hasBuffer = true) {
    uint8_t byte = 0;
    return checkThumbnail({hasBuffer ? &byte : nullptr, size, mode, width, height}) ==
           android::BAD_VALUE;
}

TEST(PictureCanvas, RefusesWhatCannotBeDrawn) {
    EXPECT_FALSE(isRefused(ORV_COLOR_MODE_ARGB8888, 10, 2, 128));
    EXPECT_FALSE(isRefused(ORV_COLOR_MODE_RGB565, 16384, 1, 32768));
    EXPECT_FALSE(isRefused(ORV_COLOR_MODE_RGB565, 1, 16384, 64 * 16384));
    EXPECT_TRUE(isRefused(ORV_COLOR_MODE_ARGB8888, 10, 2, 127));
    EXPECT_TRUE(isRefused(ORV_COLOR_MODE_ARGB8888, 10, 2, 128, false));
    for (int mode : {-1, 0, 1, 2, 6, 7, 8, 13, 14, 19, INT32_MAX}) {
        EXPECT_TRUE(isRefused(mode, 10, 2, 4096)) << mode;
    }
    for (int size : {INT32_MIN, -1, 0, 16385, INT32_MAX}) {
        EXPECT_TRUE(isRefused(ORV_COLOR_MODE_RGB565, size, 1, UINT32_MAX)) << size;
        EXPECT_TRUE(isRefused(ORV_COLOR_MODE_RGB565, 1, size, UINT32_MAX)) << size;
    }
}

}  // namespace
}  // namespace orvtarn
