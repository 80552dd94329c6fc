// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>
#include <orvtarn/TrackRecords.h>

#include <string>

#include "records/CodecFourCC.h"

namespace orvtarn {
namespace {

std::string textOf(int32_t code) {
    std::string text;
    for (int i = 0; i < 4; i++) text += static_cast<char>(code >> (8 * i));
    return text;
}

TEST(CodecFourCC, KnowsTheRegisteredCodes) {
    EXPECT_EQ(codecFourCC("h264"), 'h' | '2' << 8 | '6' << 16 | '4' << 24);
    const std::string pairs[][2] = {{"hevc", "hevc"},       {"aac", "mp4a"},
                                    {"flac", "fLaC"},       {"mov_text", "tx3g"},
                                    {"mpeg2video", "mp2v"}, {"dvd_subtitle", "vobs"}};
    for (const auto& pair : pairs) EXPECT_EQ(textOf(codecFourCC(pair[0])), pair[1]);
}

TEST(CodecFourCC, TakesTheNameOfOthers) {
    EXPECT_EQ(textOf(codecFourCC("pcm_s16le")), "s16l");
    EXPECT_EQ(textOf(codecFourCC("pcm_s24be")), "s24b");
    EXPECT_EQ(textOf(codecFourCC("pcm_u8")), "u8  ");
    EXPECT_EQ(textOf(codecFourCC("ass")), "ass ");
    EXPECT_EQ(textOf(codecFourCC("cinepak")), "cine");
    EXPECT_EQ(codecFourCC(""), 0);
}

}  // namespace
}  // namespace orvtarn
