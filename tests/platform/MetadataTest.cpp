// SPDX-License-Identifier: Apache-2.0
#include <binder/Parcel.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <media/Metadata.h>

#include <vector>

namespace android {
namespace {

using media::Metadata;
using testing::ElementsAre;

constexpr int32_t kMarker = 0x4d455441;  // 'M' 'E' 'T' 'A'

std::vector<int32_t> wordsOf(const Parcel& parcel) {
    std::vector<int32_t> words;
    parcel.setDataPosition(0);
    while (parcel.dataAvail() > 0) words.push_back(parcel.readInt32());
    return words;
}

TEST(MetadataTest, TheHeaderIsALengthOfZeroAndTheMarker) {
    Parcel parcel;
    Metadata metadata(&parcel);
    EXPECT_TRUE(metadata.appendHeader());
    EXPECT_THAT(wordsOf(parcel), ElementsAre(0, kMarker));
}

TEST(MetadataTest, RecordsCarryTheirLengthKeyAndType) {
    Parcel parcel;
    Metadata metadata(&parcel);
    metadata.appendHeader();
    EXPECT_TRUE(metadata.appendInt32(Metadata::kDuration, 61000));
    EXPECT_TRUE(metadata.appendBool(Metadata::kPauseAvailable, true));
    EXPECT_TRUE(metadata.appendBool(Metadata::kSeekAvailable, false));
    EXPECT_THAT(wordsOf(parcel), ElementsAre(0, kMarker,        //
                                             16, 14, 2, 61000,  //
                                             16, 1, 3, 1,       //
                                             16, 4, 3, 0));
}

TEST(MetadataTest, UpdateLengthCountsFromTheHeaderAndReturnsToTheEnd) {
    Parcel parcel;
    parcel.writeInt32(-1);
    Metadata metadata(&parcel);
    metadata.appendHeader();
    metadata.appendInt32(Metadata::kNumTracks, 3);
    metadata.updateLength();
    EXPECT_EQ(parcel.dataPosition(), parcel.dataSize());
    EXPECT_THAT(wordsOf(parcel), ElementsAre(-1, 24, kMarker, 16, 30, 2, 3));
}

TEST(MetadataTest, ResetDropsWhatWasAppendedAndNothingBefore) {
    Parcel parcel;
    parcel.writeInt32(-1);
    Metadata metadata(&parcel);
    metadata.appendHeader();
    metadata.appendInt32(Metadata::kNumTracks, 3);
    metadata.resetParcel();
    EXPECT_EQ(parcel.dataPosition(), 4u);
    EXPECT_THAT(wordsOf(parcel), ElementsAre(-1));
}

TEST(MetadataTest, AParcelThatRefusesIsReported) {
    Parcel parcel;
    parcel.setDataPosition(INT32_MAX);
    Metadata metadata(&parcel);
    EXPECT_FALSE(metadata.appendHeader());
    EXPECT_FALSE(metadata.appendInt32(Metadata::kNumTracks, 3));
    EXPECT_EQ(parcel.dataSize(), 0u);
}

}  // namespace
}  // namespace android
