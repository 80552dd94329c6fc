// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "core/MpvHandle.h"
#include "playback/HardwareDecoding.h"

namespace orvtarn {
namespace {

class HardwareDecodingTest : public testing::Test {
protected:
    HardwareDecodingTest() { EXPECT_TRUE(mpv.create()); }
    ~HardwareDecodingTest() override { mpv.destroy(); }

    std::string setting() { return mpv.getString("hwdec").value_or("none"); }

    MpvHandle mpv;
};

TEST_F(HardwareDecodingTest, CopiesUnlessOpenGlAloneSeesThePictures) {
    HardwareDecoding decoding(mpv, "vaapi-copy");
    decoding.setOnWindow(true);
    EXPECT_EQ("vaapi", setting());
    decoding.setFiltered(true);
    EXPECT_EQ("vaapi-copy", setting());
    decoding.setFiltered(false);
    EXPECT_EQ("vaapi", setting());
    decoding.setOnWindow(false);
    EXPECT_EQ("vaapi-copy", setting());
}

TEST_F(HardwareDecodingTest, StaysOffWithoutADecoder) {
    mpv.set("hwdec", "no");
    HardwareDecoding decoding(mpv, "no");
    decoding.setOnWindow(true);
    EXPECT_EQ("no", setting());
}

}  // namespace
}  // namespace orvtarn
