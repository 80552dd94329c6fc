// SPDX-License-Identifier: Apache-2.0
// What media say beyond playback: pictures and metadata.
#include <binder/Parcel.h>
#include <stdlib.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <memory>
#include <vector>

#include "KitTest.h"

using android::NO_ERROR;

namespace orvkit {
namespace {

constexpr int kWidth = 33;  // pixels, not of whole rows of 64 bytes
constexpr int kHeight = 20;
constexpr uint8_t kUntouched = 0xA5;

class DescriptionTest : public KitTest {
protected:
    static size_t paddedRow() { return (size_t{kWidth} * 4 + 63) / 64 * 64; }

    bool thumbnail(std::vector<uint8_t>& buffer, int width = kWidth, int height = kHeight) {
        buffer.assign(paddedRow() * kHeight + 64, kUntouched);
        _Media_Thumbnail_Info_T request = {buffer.data(),
                                           static_cast<uint32_t>(paddedRow() * kHeight),
                                           ORV_COLOR_MODE_ARGB8888, width, height};
        return player->getThumbnailInfo(&request);
    }

    static std::string asciiOf(const OrvWideText& text) {
        const auto* end = std::find(text, text + ORV_TEXT_UNITS, uint16_t{0});
        std::string found;
        for (const auto* unit = text; unit != end; unit++) {
            found += *unit < 128 ? static_cast<char>(*unit) : '?';
        }
        return found;
    }
};

TEST_F(DescriptionTest, AThumbnailFillsItsRows) {
    checks("getThumbnailInfo", "The picture of the current position");
    ORV_OPEN();
    std::vector<uint8_t> buffer;
    ORV_NOT_OFFERED_IF(!thumbnail(buffer), "it makes no thumbnails");
    bool colourful = false;
    for (int y = 0; y < kHeight; y++) {
        const uint8_t* row = &buffer[static_cast<size_t>(y) * paddedRow()];
        for (size_t x = 0; x < kWidth; x++) EXPECT_EQ(255, row[4 * x + 3]) << "alpha of row " << y;
        colourful = colourful || std::any_of(row, row + 4 * kWidth, [&](uint8_t byte) {
                        return byte != 255 && byte != row[0];
                    });
        EXPECT_TRUE(std::all_of(row + 4 * kWidth, row + paddedRow(),
                                [](uint8_t byte) { return byte == kUntouched; }))
            << "padding of row " << y;
    }
    EXPECT_TRUE(colourful);
    EXPECT_EQ(kUntouched, buffer[paddedRow() * kHeight]) << "behind the buffer";
}

TEST_F(DescriptionTest, SizesThatDoNotFitAreRefused) {
    checks("getThumbnailInfo", "Sizes go from 1 to 16384");
    ORV_OPEN();
    std::vector<uint8_t> buffer;
    EXPECT_FALSE(thumbnail(buffer, 0, kHeight));
    EXPECT_FALSE(thumbnail(buffer, kWidth, -1));
    EXPECT_FALSE(thumbnail(buffer, kWidth, 16385));
    EXPECT_FALSE(thumbnail(buffer, kWidth, kHeight + 1)) << "the buffer is smaller";
    EXPECT_EQ(kUntouched, buffer[paddedRow() * kHeight]) << "behind the buffer";
}

TEST_F(DescriptionTest, TheCoverIsTheMediasOwnBytes) {
    checks("extractAlbumArt", "An embedded picture as the media's own bytes");
    openFile("covered.mp3");
    if (IsSkipped() || HasFailure()) return;
    const std::unique_ptr<MediaAlbumArt, decltype(&free)> art(player->extractAlbumArt(), free);
    ORV_NOT_OFFERED_IF(art == nullptr, "it extracts no pictures");
    std::ifstream file(mediaPath("front.jpg"), std::ios::binary);
    const std::string expected{std::istreambuf_iterator<char>(file),
                               std::istreambuf_iterator<char>()};
    ASSERT_EQ(expected.size(), art->size());
    EXPECT_TRUE(
        std::equal(expected.begin(), expected.end(), reinterpret_cast<const char*>(art->data())));
}

TEST_F(DescriptionTest, MediaWithoutACoverHaveNone) {
    checks("extractAlbumArt", "The caller frees it; null without a picture");
    EXPECT_EQ(nullptr, player->extractAlbumArt()) << "without media";
    openFile("silent.mp4");
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(nullptr, player->extractAlbumArt());
}

TEST_F(DescriptionTest, TagsAreMetadata) {
    checks("getMetaDataInfo", "pictures, metadata, track and chapter records");
    openFile("tagged.mp3");
    if (IsSkipped() || HasFailure()) return;
    MetaDataInfo info;
    ORV_NOT_OFFERED_IF(!player->getMetaDataInfo(info), "it reads no metadata");
    EXPECT_NEAR(4000, info.mDuration, kNearMs);
    EXPECT_EQ(1824, info.mYear);
    EXPECT_EQ(3, info.mTrackNumber);
    EXPECT_EQ(12, info.mTrackTotal);
    EXPECT_EQ("Ludwig van Beethoven", asciiOf(info.mComposer));
    EXPECT_EQ(0u, asciiOf(info.mTitle).find("Ode an die Freude"));
}

TEST_F(DescriptionTest, RecordsHaveTheirLengths) {
    checks("getMetadata", "Appends media::Metadata records without a header");
    ORV_OPEN();
    android::Parcel records;
    const android::status_t status = player->getMetadata({}, &records);
    ORV_NOT_OFFERED_IF(status == android::INVALID_OPERATION, "it has no such records");
    ASSERT_EQ(NO_ERROR, status);
    records.setDataPosition(0);
    constexpr int kHead = 3 * sizeof(int32_t);  // length, key, type
    while (records.dataAvail() > 0) {
        const size_t begin = records.dataPosition();
        const int32_t length = records.readInt32();
        ASSERT_GE(length, kHead);
        ASSERT_LE(begin + static_cast<size_t>(length), records.dataSize());
        EXPECT_GT(records.readInt32(), 0) << "a key";
        records.setDataPosition(begin + static_cast<size_t>(length));
    }
}

}  // namespace
}  // namespace orvkit
