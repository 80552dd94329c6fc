// SPDX-License-Identifier: Apache-2.0
// What the engine's records hold when they are constructed over used memory.
#include <gmock/gmock.h>
#include <orvtarn/DivxRecords.h>
#include <orvtarn/MetaDataInfo.h>
#include <orvtarn/PcmRecords.h>
#include <orvtarn/SubtitleRecords.h>
#include <orvtarn/TrackRecords.h>
#include <string.h>

#include <array>
#include <new>
#include <set>

namespace orvtest {
namespace {

using testing::Each;

const uint8_t kUsed = 0xa5;

template <typename Record>
using Bytes = std::array<uint8_t, sizeof(Record)>;

// The compiler may take memory for undefined before a constructor and leave
// stores to it out; it must believe that somebody looks at the bytes.
void lookAt(void* memory) { asm volatile("" : : "r"(memory) : "memory"); }

// The bytes of a record that was constructed, not value-initialised.
template <typename Record>
Bytes<Record> constructed() {
    alignas(Record) unsigned char memory[sizeof(Record)];
    memset(memory, kUsed, sizeof(memory));
    lookAt(memory);
    Record* record = new (memory) Record;
    lookAt(record);
    Bytes<Record> bytes;
    memcpy(bytes.data(), memory, sizeof(memory));
    return bytes;
}

// Zero but for the second halves of the wide texts at these offsets.
template <typename Record>
Bytes<Record> halfCleared(const std::set<size_t>& texts) {
    const size_t half = sizeof(OrvWideText) / 2;
    Bytes<Record> bytes{};
    for (size_t text : texts) memset(&bytes[text + half], kUsed, half);
    return bytes;
}

template <typename Record>
class ZeroedRecordTest : public testing::Test {};

using ZeroedRecords =
    testing::Types<VideoCodecInfo, SubtitleTrackInfo, Subtitle_TimeOffset, Subtitle_Color,
                   DivxTitleInfo, DivxChapInfo, DivxLastMemoryFilePosition>;
TYPED_TEST_SUITE(ZeroedRecordTest, ZeroedRecords);

TYPED_TEST(ZeroedRecordTest, IsAllZero) { EXPECT_THAT(constructed<TypeParam>(), Each(0)); }

TEST(RecordConstructorsTest, FontInfosFieldsAreZero) {
    const auto bytes = constructed<Subtitle_FontInfo>();  // three bytes of padding follow
    EXPECT_THAT(std::vector<uint8_t>(bytes.begin(), bytes.begin() + 5), Each(0));
}

TEST(RecordConstructorsTest, AudioTrackKeepsTheSecondHalvesOfItsTexts) {
    EXPECT_EQ(constructed<AudioTrackInfo>(),
              halfCleared<AudioTrackInfo>({24, 280, 536, 792, 1052, 1308, 1564}));
}

TEST(RecordConstructorsTest, MetaDataKeepsTheSecondHalvesOfItsTexts) {
    EXPECT_EQ(constructed<MetaDataInfo>(),
              halfCleared<MetaDataInfo>({24, 280, 536, 792, 1052, 1308, 1564}));
}

TEST(RecordConstructorsTest, DivxDisplayKeepsTheSecondHalvesOfItsTexts) {
    EXPECT_EQ(constructed<DivxDisplayInfo>(), halfCleared<DivxDisplayInfo>({24, 284}));
}

// It is not cleared: what nobody fills keeps what the memory held.
TEST(RecordConstructorsTest, PcmDescriptionKeepsEverything) {
    EXPECT_THAT(constructed<IORV_PB_CTRL_SET_MEDIA_INFO_T>(), Each(kUsed));
}

}  // namespace
}  // namespace orvtest
