// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "base/Milliseconds.h"

namespace {

using orvtarn::toMilliseconds;

TEST(Milliseconds, AreRounded) {
    EXPECT_EQ(0, toMilliseconds(0));
    EXPECT_EQ(34, toMilliseconds(0.0336));
    EXPECT_EQ(-2, toMilliseconds(-0.0016));
}

TEST(Milliseconds, OfLongTimesAreTheMostThereAre) {
    EXPECT_EQ(INT32_MAX, toMilliseconds(2147483.648));
    EXPECT_EQ(INT32_MAX, toMilliseconds(1e300));
    EXPECT_EQ(INT32_MIN, toMilliseconds(-1e300));
}

}  // namespace
