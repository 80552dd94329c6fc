// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <random>
#include <vector>

#include "Histogram.h"

namespace orvtrace {
namespace {

TEST(HistogramTest, NothingHasNoQuantile) {
    const Histogram histogram;
    EXPECT_EQ(histogram.count(), 0u);
    EXPECT_EQ(histogram.quantile(0.5), 0u);
}

TEST(HistogramTest, ShortTimesAreExact) {
    for (uint64_t time = 0; time < 128; ++time) {
        Histogram histogram;
        histogram.add(time);
        EXPECT_EQ(histogram.quantile(0), time);
        EXPECT_EQ(histogram.quantile(1), time);
    }
}

TEST(HistogramTest, AnyTimeIsWithinOneIn128) {
    for (int bit = 7; bit < 64; ++bit) {
        const uint64_t power = uint64_t{1} << bit;
        for (const uint64_t time : {power, power + 1, power + power / 3, power + (power - 1)}) {
            Histogram histogram;
            histogram.add(time);
            const double found = static_cast<double>(histogram.quantile(0.5));
            EXPECT_NEAR(found / static_cast<double>(time), 1, 1.0 / 128) << time;
        }
    }
}

TEST(HistogramTest, QuantilesAreThoseOfTheSortedTimes) {
    std::mt19937_64 random(7);
    std::vector<uint64_t> times(10007);
    Histogram histogram;
    for (uint64_t& time : times) {
        time = static_cast<uint64_t>(std::exp(static_cast<double>(random() % 2000) / 100));
        histogram.add(time);
    }
    std::sort(times.begin(), times.end());
    EXPECT_EQ(histogram.count(), times.size());
    for (const double share : {0.01, 0.5, 0.9, 0.99, 1.0}) {
        const size_t rank = static_cast<size_t>(std::ceil(share * times.size()));
        const double expected = static_cast<double>(times[rank - 1]);
        EXPECT_NEAR(static_cast<double>(histogram.quantile(share)), expected, expected / 128);
    }
}

}  // namespace
}  // namespace orvtrace
