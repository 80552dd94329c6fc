// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>
#include <orvtarn/PlayerTypes.h>

#include <atomic>
#include <cmath>

#include "TestMedia.h"
#include "inspect/PictureCanvas.h"
#include "inspect/Thumbnailer.h"

namespace orvtarn {
namespace {

using orvtest::mediaPath;
using orvtest::openMedia;
using orvtest::outputOf;

// Both pictures come from the same decoder and scaler, so that what is left is
// rounding; the frame beside the right one has less than 25 dB.
const double kSameDrawing = 40;  // dB

struct Mode {
    int32_t colorMode;
    const char* pixelFormat;  // ffmpeg's
    std::vector<int> bits;    // of the channels, low bits first, 0 skips one
    int skip = 0;             // undefined high bits in ffmpeg's picture
};

const Mode kModes[] = {
    {ORV_COLOR_MODE_RGB565, "rgb565le", {5, 6, 5}},
    {ORV_COLOR_MODE_BGR565, "bgr565le", {5, 6, 5}},
    {ORV_COLOR_MODE_ARGB1555, "rgb555le", {5, 5, 5}, 1},
    {ORV_COLOR_MODE_ARGB4444, "rgb444le", {4, 4, 4}, 4},
    {ORV_COLOR_MODE_UYVY422, "uyvy422", {8, 8}},
    {ORV_COLOR_MODE_YUYV422, "yuyv422", {8, 8}},
    {ORV_COLOR_MODE_GRAY16, "gray16le", {16}},
    {ORV_COLOR_MODE_ARGB8888, "bgra", {8, 8, 8, 8}},
    {ORV_COLOR_MODE_RGBA8888, "rgba", {8, 8, 8, 8}},
    {ORV_COLOR_MODE_ABGR8888, "abgr", {8, 8, 8, 8}},
    {ORV_COLOR_MODE_XRGB8888, "bgra", {8, 8, 8, 8}},
};
const Mode& kBgra = kModes[7];

// Each channel of each pixel, scaled to 0..1.
std::vector<double> channels(const Mode& mode, const std::vector<uint8_t>& pixels) {
    const int size = bytesPerPixel(mode.colorMode);
    std::vector<double> values;
    for (size_t i = 0; i + size <= pixels.size(); i += size) {
        uint32_t pixel = 0;
        memcpy(&pixel, &pixels[i], size);
        for (int bits : mode.bits) {
            values.push_back((pixel & ((1u << bits) - 1)) / static_cast<double>((1u << bits) - 1));
            pixel >>= bits;
        }
    }
    return values;
}

double psnr(const Mode& mode, const std::vector<uint8_t>& one, const std::vector<uint8_t>& other) {
    const std::vector<double> a = channels(mode, one), b = channels(mode, other);
    EXPECT_EQ(a.size(), b.size());
    if (a.empty() || a.size() != b.size()) return 0;
    double sum = 0;
    for (size_t i = 0; i < a.size(); i++) sum += (a[i] - b[i]) * (a[i] - b[i]);
    return sum == 0 ? 100 : -10 * std::log10(sum / static_cast<double>(a.size()));
}

struct Size {
    int width, height;
};

// The frame that ffmpeg takes at a time, or the first, as packed rows.
std::vector<uint8_t> reference(const std::string& name, const std::string& seconds, Size size,
                               const Mode& mode = kBgra, const std::string& matrix = "") {
    const std::string filter = "scale=" + std::to_string(size.width) + ":" +
                               std::to_string(size.height) + ":flags=bicubic+accurate_rnd" +
                               (mode.bits.size() == 2 ? ":out_color_matrix=bt601" : "") + matrix +
                               ",format=" + mode.pixelFormat;
    std::vector<uint8_t> pixels =
        outputOf("ffmpeg -nostdin -v error " + (seconds.empty() ? "" : "-ss " + seconds) + " -i '" +
                 mediaPath(name) + "' -frames:v 1 -vf " + filter + " -f rawvideo -");
    EXPECT_EQ(pixels.size(),
              static_cast<size_t>(size.width) * size.height * bytesPerPixel(mode.colorMode));
    return pixels;
}

// The picture's rows without what is between them.
std::vector<uint8_t> draw(Thumbnailer& thumbnailer, int64_t positionMs, Size size,
                          const Mode& mode = kBgra) {
    const size_t stride = thumbnailStride(mode.colorMode, size.width);
    const size_t used = static_cast<size_t>(size.width) * bytesPerPixel(mode.colorMode);
    std::vector<uint8_t> buffer(stride * size.height);
    EXPECT_EQ(thumbnailer.draw(positionMs, {buffer.data(), static_cast<uint32_t>(buffer.size()),
                                            mode.colorMode, size.width, size.height}),
              0);
    std::vector<uint8_t> packed;
    for (int y = 0; y < size.height; y++) {
        packed.insert(packed.end(), &buffer[y * stride], &buffer[y * stride] + used);
    }
    return packed;
}

std::unique_ptr<Thumbnailer> open(const std::string& name, int stream = -1) {
    std::unique_ptr<Thumbnailer> thumbnailer;
    EXPECT_EQ(Thumbnailer::create(openMedia(name), stream, thumbnailer), 0) << name;
    return thumbnailer;
}

TEST(Thumbnailer, DrawsWhatFfmpegExtractsInEveryMode) {
    const auto thumbnailer = open("video.mp4");
    for (const Mode& mode : kModes) {
        // Rows with padding and without, in modes of two and of four bytes. To fewer
        // rows libswscale goes in two steps, on machines of 64 bits alone.
        for (const Size size : {Size{150, 9}, Size{96, 255}}) {
            EXPECT_GT(psnr(mode, draw(*thumbnailer, 3480, size, mode),
                           reference("video.mp4", "3.48", size, mode)),
                      kSameDrawing)
                << mode.pixelFormat << " " << size.width << "x" << size.height;
        }
    }
}

// Times on frames, between them, at key frames, at both ends.
TEST(Thumbnailer, FindsTheFrameOfATimeInEveryContainer) {
    const char* const seconds[] = {"0", "0.04", "1.96", "2", "2.04", "1.3", "3.99", "4.88"};
    for (const char* name : {"video.mp4", "video.mkv", "video.ts", "video.avi"}) {
        const auto thumbnailer = open(name);
        for (const char* time : seconds) {
            const auto position = static_cast<int64_t>(std::lround(1000 * std::atof(time)));
            // ffmpeg itself misses frames of a transport stream that it seeks.
            const bool isTs = std::string(name) == "video.ts";
            EXPECT_GT(psnr(kBgra, draw(*thumbnailer, position, {160, 90}),
                           reference(isTs ? "video.mp4" : name, time, {160, 90})),
                      isTs ? 30 : kSameDrawing)
                << name << " at " << time;
        }
    }
}

TEST(Thumbnailer, DrawsTheLastFramePastTheEndAndTheFirstBeforeTheStart) {
    const auto thumbnailer = open("video.mp4");
    const auto last = reference("video.mp4", "9.96", {160, 90});
    for (int64_t position : {int64_t{9960}, int64_t{9990}, int64_t{10000}, int64_t{1} << 40}) {
        EXPECT_GT(psnr(kBgra, draw(*thumbnailer, position, {160, 90}), last), kSameDrawing);
    }
    // Broadcast formats cannot even be sought past the end.
    EXPECT_GT(psnr(kBgra, draw(*open("video.ts"), 60000, {160, 90}), last), 30);
    const auto first = reference("video.mp4", "0", {160, 90});
    for (int64_t position : {int64_t{0}, int64_t{-1}, INT64_MIN}) {
        EXPECT_GT(psnr(kBgra, draw(*thumbnailer, position, {160, 90}), first), kSameDrawing);
    }
}

// A slide that shows for a second is on screen all that time.
TEST(Thumbnailer, DrawsTheSlideOnScreen) {
    const auto thumbnailer = open("slides.mkv");
    for (int64_t position : {3000, 3500, 3880}) {
        EXPECT_GT(psnr(kBgra, draw(*thumbnailer, position, {160, 90}),
                       reference("slides.mkv", "3", {160, 90})),
                  kSameDrawing)
            << position;
    }
}

// Where ffmpeg turns before it spreads the colours over the pixels, this does so
// afterwards: the rows of 4:2:0 video make a difference of some dB at its edges.
TEST(Thumbnailer, TurnsVideoThatIsStoredLying) {
    const auto upright = draw(*open("rotated.mp4"), 2000, {180, 320});
    EXPECT_GT(psnr(kBgra, upright, reference("rotated.mp4", "2", {180, 320})), 27);
    const std::vector<uint8_t> otherWay =
        reference("rotated.mp4", "2", {180, 320}, kBgra, ",hflip,vflip");
    EXPECT_LT(psnr(kBgra, upright, otherWay), 15);
}

TEST(Thumbnailer, TakesTheMatrixFromTheTagOrTheSize) {
    for (const char* name : {"hd.mp4", "hd709.mp4"}) {
        EXPECT_GT(psnr(kBgra, draw(*open(name), 400, {160, 90}),
                       reference(name, "0.4", {160, 90}, kBgra, ":in_color_matrix=bt709")),
                  kSameDrawing)
            << name;
        const Mode& uyvy = kModes[4];
        EXPECT_GT(psnr(uyvy, draw(*open(name), 400, {160, 90}, uyvy),
                       reference(name, "0.4", {160, 90}, uyvy, ":in_color_matrix=bt709")),
                  kSameDrawing)
            << name;
    }
}

TEST(Thumbnailer, DrawsOddSizesAndOtherFormats) {
    EXPECT_GT(
        psnr(kBgra, draw(*open("odd.mkv"), 400, {161, 91}), reference("odd.mkv", "0.4", {161, 91})),
        kSameDrawing);
    const auto alpha = open("alpha.mov");
    const std::vector<uint8_t> pixels = draw(*alpha, 0, {64, 64});
    EXPECT_EQ(pixels[3], 0);
    EXPECT_EQ(pixels[63 * 4 + 3], 255);
}

TEST(Thumbnailer, DrawsAStillPictureAgainAndAgain) {
    const auto thumbnailer = open("still.png");
    const auto expected = reference("still.png", "0", {160, 90});
    for (int64_t position : {0, 5000, 0}) {
        EXPECT_GT(psnr(kBgra, draw(*thumbnailer, position, {160, 90}), expected), kSameDrawing);
    }
}

TEST(Thumbnailer, DrawsTheCoverOfMusicAndTheVideoOfVideo) {
    const auto cover = reference("front.jpg", "", {96, 64});
    EXPECT_GT(psnr(kBgra, draw(*open("covered.m4a"), 1000, {96, 64}), cover), kSameDrawing);
    EXPECT_LT(psnr(kBgra, draw(*open("covered.mkv"), 1000, {96, 64}), cover), 20);
    EXPECT_GT(psnr(kBgra, draw(*open("covered.mkv"), 1000, {96, 64}),
                   reference("covered.mkv", "1", {96, 64})),
              kSameDrawing);
}

TEST(Thumbnailer, ReadsFromSourcesOfEveryKind) {
    const auto expected = reference("video.mkv", "3.48", {160, 90});
    for (bool isSeekable : {true, false}) {
        for (bool hasSize : {true, false}) {
            auto source =
                std::make_unique<orvtest::MemorySource>(orvtest::bytesOf(mediaPath("video.mkv")));
            source->mIsSeekable = isSeekable;
            source->mHasSize = hasSize;
            source->mLongestRead = 777;
            std::unique_ptr<MediaFile> file;
            ASSERT_EQ(MediaFile::open(std::move(source), {}, file), 0);
            std::unique_ptr<Thumbnailer> thumbnailer;
            ASSERT_EQ(Thumbnailer::create(std::move(file), -1, thumbnailer), 0);
            EXPECT_GT(psnr(kBgra, draw(*thumbnailer, 3480, {160, 90}), expected), kSameDrawing)
                << isSeekable << hasSize;
        }
    }
}

TEST(Thumbnailer, RefusesMediaWithoutPicturesAndOtherStreams) {
    std::unique_ptr<Thumbnailer> thumbnailer;
    EXPECT_EQ(Thumbnailer::create(openMedia("tagged.mp3"), -1, thumbnailer), ORV_ERROR_UNSUPPORTED);
    EXPECT_EQ(Thumbnailer::create(openMedia("video.mp4"), 1, thumbnailer), ORV_ERROR_UNSUPPORTED);
    EXPECT_EQ(Thumbnailer::create(openMedia("video.mp4"), 99, thumbnailer), ORV_ERROR_UNSUPPORTED);
    EXPECT_EQ(thumbnailer, nullptr);
    EXPECT_NE(open("video.mp4", 0), nullptr);
}

TEST(Thumbnailer, LeavesTheBufferAloneWhenItFails) {
    std::vector<uint8_t> buffer(64 * 4, 0xA5);
    const std::vector<uint8_t> untouched = buffer;
    const auto thumbnailer = open("video.mp4");
    EXPECT_EQ(thumbnailer->draw(0, {buffer.data(), 255, 5, 16, 4}), android::BAD_VALUE);
    std::atomic<bool> cancel{false};
    MediaOpenOptions options;
    options.cancel = &cancel;
    std::unique_ptr<MediaFile> file;
    ASSERT_EQ(MediaFile::open(mediaPath("video.mp4"), options, file), 0);
    std::unique_ptr<Thumbnailer> cancelled;
    ASSERT_EQ(Thumbnailer::create(std::move(file), -1, cancelled), 0);
    cancel = true;
    EXPECT_EQ(cancelled->draw(0, {buffer.data(), 256, 5, 16, 4}), ORV_ERROR_IO);
    EXPECT_EQ(buffer, untouched);
}

}  // namespace
}  // namespace orvtarn
