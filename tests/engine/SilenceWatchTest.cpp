// SPDX-License-Identifier: Apache-2.0
// When a server is asked whether it is still there.
#include <gtest/gtest.h>

#include "core/SilenceWatch.h"

using namespace std::chrono_literals;
using orvtarn::SilenceWatch;

namespace {

class SilenceWatchTest : public testing::Test {
protected:
    SilenceWatch watch;
    const SilenceWatch::Time begin{1000s};
    const SilenceWatch::Time end = begin + SilenceWatch::kLimit;
};

TEST_F(SilenceWatchTest, IsDueOnceForEachLimitWithoutData) {
    EXPECT_FALSE(watch.isDue(5, begin));
    EXPECT_FALSE(watch.isDue(5, end - 1ms));
    EXPECT_TRUE(watch.isDue(5, end));
    EXPECT_FALSE(watch.isDue(5, end + 1ms));
    EXPECT_TRUE(watch.isDue(5, end + SilenceWatch::kLimit));
}

TEST_F(SilenceWatchTest, BeginsAnewWithData) {
    EXPECT_FALSE(watch.isDue(5, begin));
    EXPECT_FALSE(watch.isDue(6, end));
    EXPECT_FALSE(watch.isDue(6, end + 1ms));
    EXPECT_TRUE(watch.isDue(6, end + SilenceWatch::kLimit));
}

TEST_F(SilenceWatchTest, BeginsAnewWhenPlaybackHasGoneOn) {
    EXPECT_FALSE(watch.isDue(5, begin));
    watch.stop();
    EXPECT_FALSE(watch.isDue(5, end));
}

TEST_F(SilenceWatchTest, NamesTheTimeThatIsLeft) {
    EXPECT_EQ(-1, watch.remaining(begin)) << "nothing waits";
    EXPECT_FALSE(watch.isDue(5, begin));
    EXPECT_EQ(20, watch.remaining(begin));
    EXPECT_EQ(5, watch.remaining(begin + 15s));
    EXPECT_EQ(0, watch.remaining(end + 1s));
    watch.stop();
    EXPECT_EQ(-1, watch.remaining(end));
}

}  // namespace
