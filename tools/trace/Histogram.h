// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <array>
#include <cstdint>

namespace orvtrace {

// How many durations were how long, in buckets of which each power of two has 64. The
// error of a quantile is half a bucket: at most 1/128 of it, 0.8 %; of durations below
// 128 ns none.
class Histogram {
public:
    void add(uint64_t nanoseconds);
    uint64_t count() const { return mCount; }
    // The duration that so many of all do not exceed, between 0 and 1. 0 for none at all.
    uint64_t quantile(double share) const;

private:
    static constexpr int kBits = 6;
    static constexpr int kBuckets = (64 - kBits + 1) << kBits;

    static int bucketOf(uint64_t nanoseconds);
    static uint64_t middleOf(int bucket);

    std::array<uint64_t, kBuckets> mBuckets{};
    uint64_t mCount = 0;
};

}  // namespace orvtrace
