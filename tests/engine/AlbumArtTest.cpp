// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "TestMedia.h"
#include "inspect/AlbumArt.h"

namespace orvtarn {
namespace {

std::vector<uint8_t> artOf(const std::string& name) {
    const auto file = orvtest::openMedia(name);
    MediaAlbumArt* art = extractAlbumArt(*file);
    if (art == nullptr) return {};
    std::vector<uint8_t> bytes(art->data(), art->data() + art->size());
    free(art);
    return bytes;
}

// Byte for byte, and the front where the back comes first.
TEST(AlbumArt, IsTheFrontCoverThatTheFileHolds) {
    const std::vector<uint8_t> cover = orvtest::bytesOf(orvtest::mediaPath("front.jpg"));
    ASSERT_GT(cover.size(), 1000u);
    for (const char* name : {"covered.mp3", "covered.flac", "covered.m4a", "covered.mkv"}) {
        EXPECT_TRUE(artOf(name) == cover) << name;
    }
}

TEST(AlbumArt, IsNullWithoutAPicture) {
    for (const char* name : {"tagged.mp3", "video.mp4", "still.png"}) {
        EXPECT_EQ(extractAlbumArt(*orvtest::openMedia(name)), nullptr) << name;
    }
}

}  // namespace
}  // namespace orvtarn
