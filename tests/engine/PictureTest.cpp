// SPDX-License-Identifier: Apache-2.0
// What is seen of media of every kind: in playback, and as a thumbnail, what
// ffmpeg makes of the same frame.
#include <media/MediaTrack.h>
#include <orvtarn/PictureRecords.h>
#include <orvtarn/PlayerTypes.h>

#include <cmath>

#include "PlayerTest.h"
#include "inspect/PictureCanvas.h"

using namespace android;
using namespace orvtest;

namespace {

// Another scaler fills in the colours that are left out between pixels. The frame
// beside the right one has less than 25 dB.
constexpr double kSameColours = 30;  // dB

constexpr char kDeinterlace[] = "bwdif=mode=send_frame:deint=interlaced,";
// Up to 1000 cd/m², of which 203 are white.
constexpr char kTonesOfPq[] =
    "zscale=tin=smpte2084:pin=bt2020:min=bt2020nc:rin=tv:t=linear:npl=203:p=bt709,"
    "tonemap=mobius:desat=0:peak=4.9261,"
    "zscale=tin=linear:pin=bt709:t=bt709:p=bt709:m=bt709:r=tv,format=yuv444p,";
constexpr char kTonesOfHlg[] =
    "zscale=tin=arib-std-b67:pin=bt2020:min=bt2020nc:rin=tv:t=linear:npl=203:p=bt709,"
    "tonemap=mobius:desat=0:peak=4.9261,"
    "zscale=tin=linear:pin=bt709:t=bt709:p=bt709:m=bt709:r=tv,format=yuv444p,";

struct Kind {
    const char* file;
    int width;  // as it is to be seen
    int height;
    double seconds = 1.0;
    const char* filters = "";  // that ffmpeg does not apply by itself
};

void PrintTo(const Kind& kind, std::ostream* out) { *out << kind.file; }

// B, G, R and X of each pixel that ffmpeg makes of the frame.
std::vector<uint8_t> reference(const Kind& kind) {
    const std::string size = std::to_string(kind.width) + ":" + std::to_string(kind.height);
    // ffmpeg finds nothing in a still picture that it is to seek in.
    const std::string seek = kind.seconds > 0 ? " -ss " + std::to_string(kind.seconds) : "";
    return outputOf("ffmpeg -nostdin -v error" + seek + " -i '" + mediaPath(kind.file) +
                    "' -frames:v 1 -vf '" + kind.filters + "scale=" + size +
                    ":flags=bicubic+accurate_rnd+full_chroma_int,format=bgr0' -f rawvideo -");
}

double psnr(const std::vector<uint8_t>& one, const std::vector<uint8_t>& other) {
    if (one.empty() || one.size() != other.size()) return 0;
    double sum = 0;
    for (size_t i = 0; i < one.size(); i++) {
        const bool isColour = i % 4 != 3;
        const double difference = isColour ? one[i] - other[i] : 0;
        sum += difference * difference;
    }
    const double mean = sum / (static_cast<double>(one.size()) * 3 / 4);
    return mean == 0 ? 100 : 10 * std::log10(255 * 255 / mean);
}

// A player of which thumbnails are looked at.
class ThumbnailedTest : public PlayerTest {
protected:
    // The rows without what is between them.
    std::vector<uint8_t> drawThumbnail(int width, int height) {
        constexpr int kMode = ORV_COLOR_MODE_XRGB8888;
        const size_t stride = orvtarn::thumbnailStride(kMode, width);
        std::vector<uint8_t> rows(stride * height);
        _Media_Thumbnail_Info_T info = {rows.data(), static_cast<uint32_t>(rows.size()), kMode,
                                        width, height};
        EXPECT_TRUE(player->getThumbnailInfo(&info));
        std::vector<uint8_t> packed;
        for (int y = 0; y < height; y++) {
            const auto row = rows.begin() + static_cast<ptrdiff_t>(stride * y);
            packed.insert(packed.end(), row, row + width * 4);
        }
        return packed;
    }
};

class PictureTracksTest : public ThumbnailedTest {};

class PictureTest : public ThumbnailedTest, public testing::WithParamInterface<Kind> {
protected:
    void show(const Kind& kind) {
        open(kind.file);
        const int msec = static_cast<int>(std::lround(kind.seconds * 1000));
        const uint64_t before = sink->frameCount();
        if (msec == 0) return;
        ASSERT_EQ(NO_ERROR, player->seekTo(msec, MediaTrack::ReadOptions::SEEK_CLOSEST));
        ASSERT_TRUE(sink->waitFor(before, [&](const Picture& picture) {
            return std::abs(picture.timestampUs - msec * 1000) < 1000;
        }));
    }
};

TEST_P(PictureTest, IsTheFrameThatFfmpegGives) {
    const Kind& kind = GetParam();
    ASSERT_NO_FATAL_FAILURE(show(kind));
    const std::vector<uint8_t> expected = reference(kind);
    const Picture shown = sink->newest();
    EXPECT_EQ(kind.width, shown.width);
    EXPECT_EQ(kind.height, shown.height);
    EXPECT_GE(psnr(shown.pixels, expected), kSameColours);
    const std::vector<uint8_t> drawn = drawThumbnail(kind.width, kind.height);
    EXPECT_GE(psnr(drawn, expected), kSameColours) << "the thumbnail";
    EXPECT_GE(psnr(drawn, shown.pixels), kSameColours) << "the thumbnail and the frame";
}

TEST_F(PictureTracksTest, FollowsTheSelectedTrack) {
    open("turned-and-not.mp4");
    EXPECT_EQ(108, sink->newest().width) << "the usual one is turned";
    ASSERT_TRUE(player->selectTrack(0));
    ASSERT_TRUE(sink->waitFor(0, [](const Picture& picture) { return picture.width == 192; }));
    ASSERT_TRUE(player->selectTrack(1));
    ASSERT_TRUE(sink->waitFor(0, [](const Picture& picture) { return picture.width == 108; }));
}

TEST_F(PictureTracksTest, ACoverIsAThumbnailAndNoFrame) {
    const std::vector<uint8_t> cover = reference({"front.jpg", 96, 64, 0});
    for (const char* name : {"covered.mp3", "covered.flac", "covered.m4a"}) {
        SCOPED_TRACE(name);
        player->reset();
        open(name);
        EXPECT_GE(psnr(drawThumbnail(96, 64), cover), kSameColours);
        playToEnd();
        EXPECT_EQ(0u, sink->frameCount());
    }
}

std::string nameOf(const testing::TestParamInfo<Kind>& info) { return testName(info.param.file); }

INSTANTIATE_TEST_SUITE_P(Turned, PictureTest,
                         testing::Values(Kind{"turned-90.mp4", 108, 192},
                                         Kind{"turned-180.mp4", 192, 108},
                                         Kind{"turned-270.mp4", 108, 192}),
                         nameOf);
INSTANTIATE_TEST_SUITE_P(Shape, PictureTest,
                         testing::Values(Kind{"soft.mp4", 192, 108},
                                         Kind{"anamorphic.mkv", 192, 108},
                                         Kind{"odd.mkv", 161, 91, 0.4},
                                         Kind{"one-frame.mkv", 192, 108, 0}),
                         nameOf);
INSTANTIATE_TEST_SUITE_P(
    Pixels, PictureTest,
    testing::Values(Kind{"yuv420p10.mkv", 192, 108}, Kind{"yuv422p.mkv", 192, 108},
                    Kind{"yuv422p10.mkv", 192, 108}, Kind{"yuv444p.mkv", 192, 108},
                    Kind{"yuv444p12.mkv", 192, 108}, Kind{"alpha.mov", 64, 64, 0.4}),
    nameOf);
INSTANTIATE_TEST_SUITE_P(Colours, PictureTest,
                         testing::Values(Kind{"bt601.mkv", 192, 108},
                                         Kind{"bt601-full.mkv", 192, 108},
                                         Kind{"bt709.mkv", 192, 108},
                                         Kind{"bt709-full.mkv", 192, 108},
                                         Kind{"bt2020.mkv", 192, 108}),
                         nameOf);
INSTANTIATE_TEST_SUITE_P(Interlaced, PictureTest,
                         testing::Values(Kind{"top-first.ts", 192, 108, 1.0, kDeinterlace},
                                         Kind{"bottom-first.ts", 192, 108, 1.0, kDeinterlace}),
                         nameOf);
INSTANTIATE_TEST_SUITE_P(HighDynamicRange, PictureTest,
                         testing::Values(Kind{"pq.mkv", 192, 108, 1.0, kTonesOfPq},
                                         Kind{"hlg.mkv", 192, 108, 1.0, kTonesOfHlg}),
                         nameOf);

}  // namespace
