// SPDX-License-Identifier: Apache-2.0
// What comes of a call of libav's that fails: an error, and nothing is broken for the next.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <orvtarn/PlayerTypes.h>

#include "LibavFailure.h"
#include "TestMedia.h"
#include "inspect/PacketPosition.h"
#include "inspect/Thumbnailer.h"

namespace orvtarn {
namespace {

using android::NO_MEMORY;
using android::OK;
using android::status_t;
using orvtest::bytesOf;
using orvtest::LibavFailure;
using orvtest::mediaPath;
using orvtest::MemorySource;
using orvtest::openMedia;

struct Failing {
    const char* function;
    status_t status;
    int call = 1;
};
void PrintTo(const Failing& failing, std::ostream* out) { *out << failing.function; }

std::string nameOf(const testing::TestParamInfo<Failing>& info) {
    return std::string(info.param.function) + "_" + std::to_string(info.param.call);
}

class LibavFailureTest : public testing::TestWithParam<Failing> {
protected:
    // Runs the operation with the failure, and sees that it came to it.
    template <class Operation>
    status_t failing(Operation operation) {
        const LibavFailure failure(GetParam().function, GetParam().call);
        const status_t status = operation();
        EXPECT_GT(failure.count(), 0) << "it was not called so often";
        return status;
    }
};

class OpeningTest : public LibavFailureTest {};

TEST_P(OpeningTest, IsAnError) {
    std::unique_ptr<MediaFile> file;
    const auto open = [&] {
        auto source = std::make_unique<MemorySource>(bytesOf(mediaPath("video.mp4")));
        return MediaFile::open(std::move(source), {}, file);
    };
    EXPECT_EQ(GetParam().status, failing(open));
    EXPECT_EQ(nullptr, file);
    EXPECT_EQ(OK, open());
}

INSTANTIATE_TEST_SUITE_P(Functions, OpeningTest,
                         testing::Values(Failing{"av_malloc", NO_MEMORY},
                                         Failing{"avio_alloc_context", NO_MEMORY},
                                         Failing{"avformat_alloc_context", NO_MEMORY},
                                         Failing{"avformat_find_stream_info", NO_MEMORY}),
                         nameOf);

class ThumbnailerFailureTest : public LibavFailureTest {};

TEST_P(ThumbnailerFailureTest, IsAnError) {
    std::unique_ptr<Thumbnailer> thumbnailer;
    const auto create = [&] {
        return Thumbnailer::create(openMedia("video.mp4"), -1, thumbnailer);
    };
    EXPECT_EQ(GetParam().status, failing(create));
    EXPECT_EQ(nullptr, thumbnailer);
    EXPECT_EQ(OK, create());
}

INSTANTIATE_TEST_SUITE_P(
    Functions, ThumbnailerFailureTest,
    testing::Values(Failing{"av_packet_alloc", NO_MEMORY}, Failing{"av_frame_alloc", NO_MEMORY},
                    Failing{"av_frame_alloc", NO_MEMORY, 2},
                    Failing{"av_frame_alloc", NO_MEMORY, 3},
                    Failing{"avcodec_alloc_context3", ORV_ERROR_UNSUPPORTED},
                    Failing{"avcodec_parameters_to_context", ORV_ERROR_UNSUPPORTED},
                    Failing{"avcodec_open2", ORV_ERROR_UNSUPPORTED}),
    nameOf);

constexpr int kWidth = 16;
constexpr int kHeight = 9;

// Draws a picture of media, once with the failure and once without.
class DrawingTest : public LibavFailureTest {
protected:
    void expectFailure(const char* name) {
        ASSERT_EQ(OK, Thumbnailer::create(openMedia(name), -1, thumbnailer));
        EXPECT_EQ(GetParam().status, failing([&] { return draw(); }));
        EXPECT_EQ(std::vector<uint8_t>(pixels.size()), pixels) << "nothing is drawn";
        EXPECT_EQ(OK, draw());
        EXPECT_NE(std::vector<uint8_t>(pixels.size()), pixels);
    }
    status_t draw() {
        return thumbnailer->draw(1000, {pixels.data(), static_cast<uint32_t>(pixels.size()),
                                        ORV_COLOR_MODE_ARGB1555, kWidth, kHeight});
    }

    std::vector<uint8_t> pixels = std::vector<uint8_t>(64 * kHeight);
    std::unique_ptr<Thumbnailer> thumbnailer;
};

TEST_P(DrawingTest, IsAnError) { expectFailure("video.mp4"); }

INSTANTIATE_TEST_SUITE_P(Functions, DrawingTest,
                         testing::Values(Failing{"av_read_frame", ORV_ERROR_MALFORMED},
                                         Failing{"avcodec_send_packet", ORV_ERROR_MALFORMED},
                                         Failing{"av_frame_alloc", ORV_ERROR_UNSUPPORTED},
                                         Failing{"av_frame_get_buffer", ORV_ERROR_UNSUPPORTED},
                                         Failing{"sws_getContext", ORV_ERROR_UNSUPPORTED},
                                         Failing{"sws_scale", ORV_ERROR_UNSUPPORTED}),
                         nameOf);

// One that fails at each frame does not come to an end in FFmpeg 5: the time limit is the
// end. FFmpeg 7 gives the media up at once.
TEST(DecoderFailureTest, IsGivenUpInTime) {
    MediaOpenOptions options;
    options.timeLimit = std::chrono::milliseconds(300);
    std::unique_ptr<MediaFile> file;
    ASSERT_EQ(OK, MediaFile::open(mediaPath("video.mp4"), options, file));
    std::unique_ptr<Thumbnailer> thumbnailer;
    ASSERT_EQ(OK, Thumbnailer::create(std::move(file), -1, thumbnailer));
    std::vector<uint8_t> pixels(64 * kHeight);
    const LibavFailure failure("avcodec_receive_frame");
    const status_t status =
        thumbnailer->draw(1000, {pixels.data(), static_cast<uint32_t>(pixels.size()),
                                 ORV_COLOR_MODE_RGB565, kWidth, kHeight});
    EXPECT_THAT(status, testing::AnyOf(ORV_ERROR_IO, ORV_ERROR_MALFORMED));
    EXPECT_GT(failure.count(), 0);
}

// The second conversion is that of the alpha.
class AlphaDrawingTest : public DrawingTest {};

TEST_P(AlphaDrawingTest, IsAnError) { expectFailure("alpha.mov"); }

INSTANTIATE_TEST_SUITE_P(Functions, AlphaDrawingTest,
                         testing::Values(Failing{"av_frame_alloc", ORV_ERROR_UNSUPPORTED, 2},
                                         Failing{"sws_getContext", ORV_ERROR_UNSUPPORTED, 2},
                                         Failing{"sws_scale", ORV_ERROR_UNSUPPORTED, 2}),
                         nameOf);

class FilteredDrawingTest : public DrawingTest {};

TEST_P(FilteredDrawingTest, IsAnError) { expectFailure("turned-90.mp4"); }

INSTANTIATE_TEST_SUITE_P(
    Functions, FilteredDrawingTest,
    testing::Values(Failing{"av_frame_clone", ORV_ERROR_UNSUPPORTED},
                    Failing{"av_frame_clone", ORV_ERROR_UNSUPPORTED, 2},
                    Failing{"avfilter_graph_alloc", ORV_ERROR_UNSUPPORTED},
                    Failing{"avfilter_graph_alloc_filter", ORV_ERROR_UNSUPPORTED},
                    Failing{"av_buffersrc_parameters_alloc", ORV_ERROR_UNSUPPORTED},
                    Failing{"av_buffersrc_parameters_set", ORV_ERROR_UNSUPPORTED},
                    Failing{"avfilter_init_str", ORV_ERROR_UNSUPPORTED},
                    Failing{"avfilter_graph_create_filter", ORV_ERROR_UNSUPPORTED},
                    Failing{"avfilter_graph_parse2", ORV_ERROR_UNSUPPORTED},
                    Failing{"avfilter_link", ORV_ERROR_UNSUPPORTED},
                    Failing{"avfilter_link", ORV_ERROR_UNSUPPORTED, 2},
                    Failing{"avfilter_graph_config", ORV_ERROR_UNSUPPORTED},
                    Failing{"av_buffersrc_add_frame", ORV_ERROR_UNSUPPORTED},
                    Failing{"av_buffersrc_add_frame", ORV_ERROR_UNSUPPORTED, 2},
                    Failing{"av_buffersink_get_frame", ORV_ERROR_UNSUPPORTED}),
    nameOf);

// What libav refuses is not known.
TEST(PacketPositionTest, IsUnknownWhenAFunctionFails) {
    for (const char* function : {"av_packet_alloc", "av_seek_frame", "av_read_frame"}) {
        SCOPED_TRACE(function);
        const std::unique_ptr<MediaFile> file = openMedia("video.mp4");
        {
            const LibavFailure failure(function);
            EXPECT_FALSE(byteAtTime(*file, 1).has_value());
        }
        EXPECT_TRUE(byteAtTime(*file, 1).has_value());
    }
}

// Without a packet before it a byte is the first one's; without a seek it is none's.
TEST(PacketPositionTest, ABytesTimeIsTheFirstOnesWhenNothingCanBeRead) {
    for (const char* name : {"video.mp4", "video.ts"}) {
        SCOPED_TRACE(name);
        const std::unique_ptr<MediaFile> file = openMedia(name);
        const double whole = timeAtByte(*file, 50000).value_or(-1);
        EXPECT_GT(whole, 0);
        for (const char* function : {"av_packet_alloc", "av_seek_frame", "av_read_frame"}) {
            SCOPED_TRACE(function);
            const LibavFailure failure(function);
            EXPECT_LT(timeAtByte(*file, 50000).value_or(-1), 0.1);
            EXPECT_GT(failure.count(), 0);
        }
        EXPECT_EQ(whole, timeAtByte(*file, 50000).value_or(-1));
    }
}

}  // namespace
}  // namespace orvtarn
