// SPDX-License-Identifier: Apache-2.0
// Pointers in Java long fields. The top bit of a 32-bit address is no sign.
#include <gtest/gtest.h>
#include <jni/NativePointer.h>

namespace orvtest {
namespace {

using android::fromJavaLong;
using android::toJavaLong;

const bool k32Bits = sizeof(void*) == 4;

void* pointer(uint64_t address) { return reinterpret_cast<void*>(static_cast<uintptr_t>(address)); }

TEST(NativePointerTest, GoesOutZeroExtended) {
    EXPECT_EQ(toJavaLong(pointer(0x80000010)), 0x80000010LL);
    EXPECT_EQ(toJavaLong(nullptr), 0);
}

TEST(NativePointerTest, ComesInCutToAPointersWidth) {
    EXPECT_EQ(fromJavaLong<void>(0x80000010LL), pointer(0x80000010));
    EXPECT_EQ(fromJavaLong<void>(0x1234567880000010LL),
              pointer(k32Bits ? 0x80000010 : 0x1234567880000010));
    EXPECT_EQ(fromJavaLong<void>(0), nullptr);
}

}  // namespace
}  // namespace orvtest
