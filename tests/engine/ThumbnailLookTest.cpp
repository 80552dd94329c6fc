// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "TestMedia.h"
#include "ThumbnailPictures.h"

namespace orvtarn {
namespace {

using orvtest::decodedAt;
using orvtest::kSamePicture;
using orvtest::openThumbnailer;
using orvtest::psnr;
using orvtest::thumbnailAt;

struct Look {
    const char* name;
    const char* filters;  // what ffmpeg is to do, which does nothing by itself here
    int width;
    int height;
};
void PrintTo(const Look& look, std::ostream* out) { *out << look.name; }

// Half a second into a second of 160x90 (160x96 interlaced).
const Look kLooks[] = {
    {"lying90.mp4", "transpose=clock", 90, 160},
    {"lying180.mp4", "hflip,vflip", 160, 90},
    {"lying270.mp4", "transpose=cclock", 90, 160},
    {"mirrored.mp4", "hflip", 160, 90},
    {"flipped.mp4", "vflip", 160, 90},
    {"lying90mirrored.mp4", "transpose=cclock_flip", 90, 160},
    {"wide-pixels.mkv", "", 120, 90},
    {"deep-422.mkv", "", 160, 90},
    {"full-444.mkv", "", 160, 90},
    {"fields-top.mkv", "bwdif=mode=send_frame:parity=tff", 160, 96},
    {"fields-bottom.mpg", "bwdif=mode=send_frame:parity=bff", 160, 96},
    {"hdr-pq.mkv",
     "zscale=t=linear:npl=203:p=bt709,tonemap=mobius:desat=0:peak=4.9261,"
     "zscale=t=bt709:m=bt709:r=limited,format=yuv444p",
     160, 90},
    {"hdr-hlg.mkv",
     "zscale=t=linear:npl=203:p=bt709,tonemap=mobius:desat=0:peak=4.9261,"
     "zscale=t=bt709:m=bt709:r=limited,format=yuv444p",
     160, 90},
};

class ThumbnailLook : public testing::TestWithParam<Look> {};

TEST_P(ThumbnailLook, IsWhatFfmpegMakesOfTheFrame) {
    const Look& look = GetParam();
    const auto thumbnailer = openThumbnailer(look.name);
    ASSERT_NE(thumbnailer, nullptr);
    const auto drawn = thumbnailAt(*thumbnailer, 480, look.width, look.height);
    EXPECT_GE(psnr(drawn, decodedAt(look.name, 0.48, look.filters, look.width, look.height)),
              kSamePicture);
    // The same without the filters would be another picture.
    if (*look.filters != '\0') {
        EXPECT_LT(psnr(drawn, decodedAt(look.name, 0.48, "", look.width, look.height)),
                  kSamePicture);
    }
}

INSTANTIATE_TEST_SUITE_P(Stored, ThumbnailLook, testing::ValuesIn(kLooks),
                         [](const auto& info) { return orvtest::testName(info.param.name); });

// The metadata in the frames say that the content goes up to 4000 cd/m².
TEST(ThumbnailLook, TakesThePeakOfHdrFromTheMetadata) {
    const auto mastered = thumbnailAt(*openThumbnailer("hdr10.mp4"), 480, 160, 90);
    const auto filtered = [](const std::string& peak) {
        return decodedAt("hdr10.mp4", 0.48,
                         "zscale=t=linear:npl=203:p=bt709,tonemap=mobius:desat=0:peak=" + peak +
                             ",zscale=t=bt709:m=bt709:r=limited,format=yuv444p",
                         160, 90);
    };
    const double byMetadata = psnr(mastered, filtered("19.7044"));
    EXPECT_GE(byMetadata, kSamePicture);
    // Few pixels are bright enough to differ.
    EXPECT_GT(byMetadata, psnr(mastered, filtered("4.9261")) + 3);
}

}  // namespace
}  // namespace orvtarn
