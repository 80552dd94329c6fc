// SPDX-License-Identifier: Apache-2.0
// Where packets lie and when they begin, without a player.
#include <gtest/gtest.h>

#include <algorithm>

#include "MediaPackets.h"
#include "TestMedia.h"
#include "inspect/PacketPosition.h"

namespace orvtarn {
namespace {

using orvtest::MediaPacket;
using orvtest::openMedia;
using orvtest::packetsOf;

struct Leading {
    const char* file;
    const char* stream;  // that playback goes by
};
void PrintTo(const Leading& leading, std::ostream* out) { *out << leading.file; }

class PacketPlaceTest : public testing::TestWithParam<Leading> {};

TEST_P(PacketPlaceTest, IsThatOfTheLeadingStream) {
    const std::vector<MediaPacket> packets = packetsOf(GetParam().file, GetParam().stream);
    ASSERT_GT(packets.size(), 49u);
    const std::unique_ptr<MediaFile> file = openMedia(GetParam().file);
    for (size_t i : {5u, 31u, 40u, 49u, 12u, 0u}) {
        SCOPED_TRACE(i);
        // A little late, as playback is between two frames; times are rounded.
        EXPECT_EQ(packets[i].position, byteAtTime(*file, packets[i].time + 0.002).value_or(-1));
        EXPECT_EQ(packets[i].position, byteAtTime(*file, packets[i].time - 0.0002).value_or(-1));
        // What is decoded ahead of the start begins with it.
        const double time = std::max(packets[i].time, 0.0);
        EXPECT_NEAR(time, timeAtByte(*file, packets[i].position).value_or(-1), 0.0015);
        EXPECT_NEAR(time, timeAtByte(*file, packets[i].position + 1).value_or(-1), 0.0015);
    }
}

TEST_P(PacketPlaceTest, BeforeTheFirstIsTheFirstOnes) {
    const std::vector<MediaPacket> packets = packetsOf(GetParam().file, GetParam().stream);
    ASSERT_FALSE(packets.empty());
    const std::unique_ptr<MediaFile> file = openMedia(GetParam().file);
    const double first =
        std::min_element(packets.begin(), packets.end(), [](auto& one, auto& other) {
            return one.time < other.time;
        })->time;
    EXPECT_NEAR(std::max(first, 0.0), timeAtByte(*file, 0).value_or(-1), 0.03);
}

TEST_P(PacketPlaceTest, BehindTheLastIsTheLastOnes) {
    const std::vector<MediaPacket> packets = packetsOf(GetParam().file, GetParam().stream);
    ASSERT_FALSE(packets.empty());
    const std::unique_ptr<MediaFile> file = openMedia(GetParam().file);
    EXPECT_NEAR(packets.back().time, timeAtByte(*file, int64_t{1} << 40).value_or(-1), 0.0015);
}

INSTANTIATE_TEST_SUITE_P(Files, PacketPlaceTest,
                         testing::Values(Leading{"short.mp4", "v:0"}, Leading{"short.ts", "v:0"},
                                         Leading{"feature.mkv", "v:0"}, Leading{"video.mkv", "v:0"},
                                         Leading{"tone.mp3", "a:0"}, Leading{"covered.mp3", "a:0"},
                                         Leading{"covered.m4a", "a:0"}),
                         [](const auto& info) { return orvtest::testName(info.param.file); });

TEST(PacketPositionTest, IsUnknownWhereNothingPlays) {
    const std::unique_ptr<MediaFile> file = openMedia("lines.srt");
    ASSERT_NE(nullptr, file);
    EXPECT_FALSE(byteAtTime(*file, 1).has_value());
    EXPECT_FALSE(timeAtByte(*file, 10).has_value());
}

}  // namespace
}  // namespace orvtarn
