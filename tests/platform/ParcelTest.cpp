// SPDX-License-Identifier: Apache-2.0
#include <binder/Parcel.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <utils/String16.h>

#include <cstring>
#include <limits>
#include <string>
#include <vector>

namespace android {
namespace {

using Bytes = std::vector<uint8_t>;
using testing::ElementsAre;

Bytes bytesOf(const Parcel& parcel) {
    return Bytes(parcel.data(), parcel.data() + parcel.dataSize());
}

Parcel parcelOf(const Bytes& bytes) {
    Parcel parcel;
    EXPECT_EQ(parcel.setData(bytes.data(), bytes.size()), NO_ERROR);
    return parcel;
}

// The bytes of a value in this machine's order.
template <typename T>
Bytes native(T value) {
    Bytes bytes(sizeof(value));
    memcpy(bytes.data(), &value, sizeof(value));
    return bytes;
}

Bytes operator+(Bytes left, const Bytes& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

TEST(ParcelTest, StartsEmpty) {
    const Parcel parcel;
    EXPECT_EQ(parcel.dataSize(), 0u);
    EXPECT_EQ(parcel.dataPosition(), 0u);
    EXPECT_EQ(parcel.dataAvail(), 0u);
}

TEST(ParcelTest, WritesNumbersInNativeByteOrder) {
    Parcel parcel;
    EXPECT_EQ(parcel.writeInt32(-2), NO_ERROR);
    EXPECT_EQ(parcel.writeInt64(0x0102030405060708), NO_ERROR);
    EXPECT_EQ(parcel.writeFloat(1.5f), NO_ERROR);
    EXPECT_EQ(parcel.writeDouble(-0.25), NO_ERROR);
    EXPECT_EQ(bytesOf(parcel), native(int32_t{-2}) + native(int64_t{0x0102030405060708}) +
                                   native(1.5f) + native(-0.25));
}

TEST(ParcelTest, ReadsBackWhatWasWritten) {
    Parcel parcel;
    parcel.writeInt32(std::numeric_limits<int32_t>::min());
    parcel.writeInt64(std::numeric_limits<int64_t>::max());
    parcel.writeFloat(0.1f);
    parcel.writeDouble(0.2);
    parcel.writeString16(String16(u"h\u00e9\U0001F3AC"));
    parcel.setDataPosition(0);

    int64_t wide = 0;
    float single = 0;
    double real = 0;
    String16 text;
    EXPECT_EQ(parcel.readInt32(), std::numeric_limits<int32_t>::min());
    EXPECT_EQ(parcel.readInt64(&wide), NO_ERROR);
    EXPECT_EQ(parcel.readFloat(&single), NO_ERROR);
    EXPECT_EQ(parcel.readDouble(&real), NO_ERROR);
    EXPECT_EQ(parcel.readString16(&text), NO_ERROR);
    EXPECT_EQ(wide, std::numeric_limits<int64_t>::max());
    EXPECT_EQ(single, 0.1f);
    EXPECT_EQ(real, 0.2);
    EXPECT_EQ(text, String16(u"h\u00e9\U0001F3AC"));
    EXPECT_EQ(parcel.dataAvail(), 0u);
}

TEST(ParcelTest, PadsBlocksWithZerosToFourBytes) {
    Parcel parcel;
    parcel.write("abcde", 5);
    EXPECT_THAT(bytesOf(parcel), ElementsAre('a', 'b', 'c', 'd', 'e', 0, 0, 0));
    EXPECT_EQ(parcel.dataPosition(), 8u);
}

TEST(ParcelTest, PaddingOverwritesWhatStoodThere) {
    Parcel parcel = parcelOf(Bytes(8, 0xff));
    parcel.write("a", 1);
    EXPECT_THAT(bytesOf(parcel), ElementsAre('a', 0, 0, 0, 0xff, 0xff, 0xff, 0xff));
}

TEST(ParcelTest, OverwritesAtThePositionAndKeepsTheRest) {
    Parcel parcel;
    for (int i = 1; i <= 3; ++i) parcel.writeInt32(i);
    parcel.setDataPosition(4);
    parcel.writeInt32(20);
    EXPECT_EQ(bytesOf(parcel), native(int32_t{1}) + native(int32_t{20}) + native(int32_t{3}));
    EXPECT_EQ(parcel.dataPosition(), 8u);
}

TEST(ParcelTest, WritingBehindTheEndFillsTheGapWithZeros) {
    Parcel parcel;
    parcel.setDataPosition(4);
    parcel.writeInt32(1);
    EXPECT_EQ(bytesOf(parcel), native(int32_t{0}) + native(int32_t{1}));
}

TEST(ParcelTest, WritesStringsWithLengthAndTerminator) {
    Parcel parcel;
    parcel.writeString16(String16(u"ab"));
    EXPECT_EQ(bytesOf(parcel),
              native(int32_t{2}) + native(u'a') + native(u'b') + native(u'\0') + native(u'\0'));
}

TEST(ParcelTest, AShortReadLeavesPositionAndResult) {
    const Parcel parcel = parcelOf({1, 2, 3});
    int32_t number = 7;
    int64_t wide = 7;
    EXPECT_EQ(parcel.readInt32(&number), NOT_ENOUGH_DATA);
    EXPECT_EQ(parcel.readInt64(&wide), NOT_ENOUGH_DATA);
    EXPECT_EQ(parcel.readInt32(), 0);
    EXPECT_EQ(number, 7);
    EXPECT_EQ(wide, 7);
    EXPECT_EQ(parcel.dataPosition(), 0u);
}

TEST(ParcelTest, AWideReadNeedsAllItsBytes) {
    Parcel parcel;
    parcel.writeInt32(5);
    parcel.setDataPosition(0);
    int64_t wide = 7;
    double real = 7;
    EXPECT_EQ(parcel.readInt64(&wide), NOT_ENOUGH_DATA);
    EXPECT_EQ(parcel.readDouble(&real), NOT_ENOUGH_DATA);
    EXPECT_EQ(parcel.readInt32(), 5);
}

TEST(ParcelTest, ReadInplacePointsIntoTheParcelAndSkipsThePadding) {
    Parcel parcel;
    parcel.write("abcde", 5);
    parcel.writeInt32(9);
    parcel.setDataPosition(0);
    EXPECT_EQ(parcel.readInplace(5), parcel.data());
    EXPECT_EQ(parcel.readInt32(), 9);
}

TEST(ParcelTest, ReadInplaceOfTooMuchIsNullAndLeavesThePosition) {
    const Parcel parcel = parcelOf({1, 2, 3, 4});
    EXPECT_EQ(parcel.readInplace(5), nullptr);
    EXPECT_EQ(parcel.readInplace(std::numeric_limits<size_t>::max()), nullptr);
    EXPECT_EQ(parcel.dataPosition(), 0u);
}

TEST(ParcelTest, TheLastValueMayLackItsPadding) {
    const Parcel parcel = parcelOf({1, 2, 3, 4, 5});
    EXPECT_EQ(parcel.readInplace(5), parcel.data());
    EXPECT_EQ(parcel.dataAvail(), 0u);
}

TEST(ParcelTest, APositionBehindTheEndLeavesNothingToRead) {
    const Parcel parcel = parcelOf({1, 2, 3, 4});
    parcel.setDataPosition(8);
    EXPECT_EQ(parcel.dataAvail(), 0u);
    EXPECT_EQ(parcel.readInt32(), 0);
    EXPECT_EQ(parcel.readInplace(1), nullptr);
}

TEST(ParcelTest, SetDataSizeCutsExtendsAndKeepsThePositionInside) {
    Parcel parcel = parcelOf({1, 2, 3, 4, 5, 6, 7, 8});
    parcel.setDataPosition(8);
    EXPECT_EQ(parcel.setDataSize(4), NO_ERROR);
    EXPECT_EQ(parcel.dataPosition(), 4u);
    EXPECT_EQ(parcel.setDataSize(6), NO_ERROR);
    EXPECT_THAT(bytesOf(parcel), ElementsAre(1, 2, 3, 4, 0, 0));
    EXPECT_EQ(parcel.dataPosition(), 4u);
}

TEST(ParcelTest, SetDataReplacesAndRewinds) {
    Parcel parcel;
    parcel.writeInt64(1);
    const Bytes bytes = {9, 8, 7};
    EXPECT_EQ(parcel.setData(bytes.data(), bytes.size()), NO_ERROR);
    EXPECT_EQ(bytesOf(parcel), bytes);
    EXPECT_EQ(parcel.dataPosition(), 0u);
    EXPECT_EQ(parcel.setData(nullptr, 0), NO_ERROR);
    EXPECT_EQ(parcel.dataSize(), 0u);
}

TEST(ParcelTest, SetDataMayTakeAPieceOfItself) {
    Parcel parcel = parcelOf({1, 2, 3, 4, 5, 6, 7, 8});
    EXPECT_EQ(parcel.setData(parcel.data() + 4, 4), NO_ERROR);
    EXPECT_THAT(bytesOf(parcel), ElementsAre(5, 6, 7, 8));
}

TEST(ParcelTest, ImpossibleSizesAreRefusedAndChangeNothing) {
    Parcel parcel = parcelOf({1, 2, 3, 4});
    constexpr size_t kTooMuch = std::numeric_limits<int32_t>::max() + size_t{1};
    EXPECT_EQ(parcel.setDataSize(kTooMuch), BAD_VALUE);
    EXPECT_EQ(parcel.setData(parcel.data(), kTooMuch), BAD_VALUE);
    EXPECT_EQ(parcel.setData(nullptr, 1), BAD_VALUE);
    EXPECT_EQ(parcel.write(parcel.data(), kTooMuch), BAD_VALUE);
    EXPECT_EQ(parcel.write(nullptr, 1), BAD_VALUE);
    EXPECT_EQ(parcel.dataPosition(), 0u);
    for (const size_t position : {kTooMuch, kTooMuch - 1, kTooMuch - 4}) {
        parcel.setDataPosition(position);
        EXPECT_EQ(parcel.writeInt32(1), BAD_VALUE);
    }
    EXPECT_THAT(bytesOf(parcel), ElementsAre(1, 2, 3, 4));
}

TEST(ParcelTest, MemoryThatCannotBeHadIsReportedAndNothingLost) {
    // The test program has no block that large: see BlockLimit.cpp.
    Parcel parcel = parcelOf({1, 2, 3, 4});
    constexpr size_t kHuge = std::numeric_limits<int32_t>::max() - size_t{3};
    EXPECT_EQ(parcel.setDataSize(kHuge), NO_MEMORY);
    EXPECT_EQ(parcel.setData(parcel.data(), kHuge), NO_MEMORY);
    parcel.setDataPosition(kHuge - 8);
    EXPECT_EQ(parcel.writeInt32(1), NO_MEMORY);
    EXPECT_THAT(bytesOf(parcel), ElementsAre(1, 2, 3, 4));
}

struct BrokenString {
    std::string name;
    int32_t length;
    status_t expected;
};

void PrintTo(const BrokenString& param, std::ostream* out) { *out << param.name; }

class ParcelStringTest : public testing::TestWithParam<BrokenString> {};

TEST_P(ParcelStringTest, ABrokenStringLeavesThePosition) {
    const Parcel parcel = parcelOf(native(GetParam().length) + Bytes(4, 0));
    String16 text(u"before");
    EXPECT_EQ(parcel.readString16(&text), GetParam().expected);
    EXPECT_EQ(parcel.dataPosition(), 0u);
    EXPECT_EQ(text, String16(u"before"));
}

INSTANTIATE_TEST_SUITE_P(
    Lengths, ParcelStringTest,
    testing::Values(BrokenString{"Null", -1, UNEXPECTED_NULL},
                    BrokenString{"Negative", -2, BAD_VALUE},
                    BrokenString{"OneTooLong", 2, NOT_ENOUGH_DATA},
                    BrokenString{"Largest", std::numeric_limits<int32_t>::max(), NOT_ENOUGH_DATA}),
    [](const auto& info) { return info.param.name; });

}  // namespace
}  // namespace android
