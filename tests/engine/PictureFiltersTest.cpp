// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>

#include "base/PictureFilters.h"

extern "C" {
#include <libavfilter/avfilter.h>
#include <libavutil/display.h>
}

namespace orvtarn {
namespace {

using testing::HasSubstr;
using testing::Not;

struct FreeGraph {
    void operator()(AVFilterGraph* graph) const { avfilter_graph_free(&graph); }
};
struct FreeEnds {
    void operator()(AVFilterInOut* ends) const { avfilter_inout_free(&ends); }
};

// libavfilter knows the filters and their options, and one picture goes in and
// one comes out.
bool isGraph(const std::string& text) {
    const std::unique_ptr<AVFilterGraph, FreeGraph> graph(avfilter_graph_alloc());
    AVFilterInOut* inputs = nullptr;
    AVFilterInOut* outputs = nullptr;
    const int error = avfilter_graph_parse2(graph.get(), text.c_str(), &inputs, &outputs);
    const std::unique_ptr<AVFilterInOut, FreeEnds> in(inputs);
    const std::unique_ptr<AVFilterInOut, FreeEnds> out(outputs);
    return error >= 0 && in != nullptr && in->next == nullptr && out != nullptr &&
           out->next == nullptr;
}

PictureTraits hdr(AVColorTransferCharacteristic transfer) {
    PictureTraits traits;
    traits.width = 160;
    traits.height = 90;
    traits.transfer = transfer;
    traits.primaries = AVCOL_PRI_BT2020;
    traits.matrix = AVCOL_SPC_BT2020_NCL;
    traits.range = AVCOL_RANGE_MPEG;
    return traits;
}

std::string filtersOf(Orientation orientation) {
    PictureTraits traits;
    traits.orientation = orientation;
    return pictureFilters(traits);
}

TEST(PictureFilters, AreNoneForAnUprightProgressivePicture) {
    EXPECT_EQ(pictureFilters({}), "");
    PictureTraits usual = hdr(AVCOL_TRC_BT709);
    EXPECT_EQ(pictureFilters(usual), "");
}

TEST(PictureFilters, TurnAndMirror) {
    EXPECT_EQ(filtersOf({90, false}), "transpose=clock");
    EXPECT_EQ(filtersOf({180, false}), "hflip,vflip");
    EXPECT_EQ(filtersOf({270, false}), "transpose=cclock");
    EXPECT_EQ(filtersOf({0, true}), "hflip");
    EXPECT_EQ(filtersOf({90, true}), "transpose=cclock_flip");
    EXPECT_EQ(filtersOf({180, true}), "vflip");
    EXPECT_EQ(filtersOf({270, true}), "transpose=clock_flip");
}

TEST(PictureFilters, DeinterlaceBeforeAllElse) {
    PictureTraits traits = hdr(AVCOL_TRC_ARIB_STD_B67);
    traits.isInterlaced = true;
    traits.orientation.rotation = 90;
    const std::string text = pictureFilters(traits);
    EXPECT_EQ(text.find("bwdif=mode=send_frame"), 0u) << text;
    EXPECT_LT(text.find("tonemap"), text.find("transpose=clock")) << text;
    EXPECT_TRUE(isGraph(text)) << text;
}

TEST(PictureFilters, MapTheTonesOfPqByItsPeakAndThoseOfHlgByItsOwn) {
    PictureTraits pq = hdr(AVCOL_TRC_SMPTE2084);
    EXPECT_THAT(pictureFilters(pq), HasSubstr("peak=4.9261"));
    pq.peakLuminance = 4000;
    EXPECT_THAT(pictureFilters(pq), HasSubstr("peak=19.7044"));
    for (double odd : {1.0, 203.0}) {
        pq.peakLuminance = odd;
        EXPECT_THAT(pictureFilters(pq), HasSubstr("peak=1.0000")) << odd;
    }
    pq.peakLuminance = 1e30;
    EXPECT_THAT(pictureFilters(pq), HasSubstr("peak=49.2611"));
    PictureTraits hlg = hdr(AVCOL_TRC_ARIB_STD_B67);
    hlg.peakLuminance = 4000;
    EXPECT_THAT(pictureFilters(hlg), HasSubstr("peak=4.9261"));
}

// zscale fails on a picture whose input it does not know.
TEST(PictureFilters, AlwaysNameTheInput) {
    PictureTraits traits = hdr(AVCOL_TRC_SMPTE2084);
    EXPECT_THAT(pictureFilters(traits), HasSubstr("tin=16:pin=9:min=9:rin=limited"));
    traits.primaries = AVCOL_PRI_UNSPECIFIED;
    traits.matrix = AVCOL_SPC_UNSPECIFIED;
    traits.range = AVCOL_RANGE_UNSPECIFIED;
    EXPECT_THAT(pictureFilters(traits), HasSubstr("tin=16:pin=9:min=9:rin=limited"));
    traits.primaries = AVCOL_PRI_NB;
    traits.matrix = AVCOL_SPC_NB;
    traits.range = AVCOL_RANGE_JPEG;
    EXPECT_THAT(pictureFilters(traits), HasSubstr("tin=16:pin=9:min=9:rin=full"));
    traits.matrix = AVCOL_SPC_RGB;
    traits.primaries = AVCOL_PRI_SMPTE432;
    EXPECT_THAT(pictureFilters(traits), HasSubstr("pin=12:min=0:"));
}

TEST(PictureFilters, SpreadChromaOverOddSizes) {
    PictureTraits traits = hdr(AVCOL_TRC_SMPTE2084);
    EXPECT_THAT(pictureFilters(traits), Not(HasSubstr("yuv444p16")));
    traits.width = 161;
    EXPECT_EQ(pictureFilters(traits).find("format=yuv444p16,zscale"), 0u);
    EXPECT_TRUE(isGraph(pictureFilters(traits)));
    traits.matrix = AVCOL_SPC_RGB;
    EXPECT_THAT(pictureFilters(traits), Not(HasSubstr("yuv444p16")));
}

TEST(PictureFilters, TakeTheOrientationFromTheMatrix) {
    for (int degrees : {0, 90, 180, 270}) {
        for (bool isMirrored : {false, true}) {
            int32_t matrix[9];
            av_display_rotation_set(matrix, degrees);
            av_display_matrix_flip(matrix, isMirrored, 0);
            const Orientation read = orientationOf(matrix);
            EXPECT_EQ(read.rotation, degrees) << isMirrored;
            EXPECT_EQ(read.isMirrored, isMirrored) << degrees;
        }
    }
    int32_t tilted[9];
    av_display_rotation_set(tilted, 100);
    EXPECT_EQ(orientationOf(tilted).rotation, 90);
    const int32_t flat[9] = {};
    EXPECT_TRUE(orientationOf(flat).isUpright());
    EXPECT_TRUE(orientationOf(nullptr).isUpright());
}

}  // namespace
}  // namespace orvtarn
