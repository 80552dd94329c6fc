// SPDX-License-Identifier: Apache-2.0
#include "Histogram.h"

#include <algorithm>
#include <cmath>

namespace orvtrace {

namespace {
constexpr int kWidth = 64;
}

void Histogram::add(uint64_t nanoseconds) {
    ++mBuckets[bucketOf(nanoseconds)];
    ++mCount;
}

uint64_t Histogram::quantile(double share) const {
    if (mCount == 0) return 0;
    const uint64_t rank = std::clamp<uint64_t>(
        static_cast<uint64_t>(std::ceil(share * static_cast<double>(mCount))), 1, mCount);
    uint64_t before = 0;
    int bucket = 0;
    while (before + mBuckets[bucket] < rank) before += mBuckets[bucket++];
    return middleOf(bucket);
}

// The first 2^(kBits+1) buckets are of one nanosecond; from there on the highest kBits + 1
// bits are the bucket's.
int Histogram::bucketOf(uint64_t nanoseconds) {
    const int length = nanoseconds == 0 ? 0 : kWidth - __builtin_clzll(nanoseconds);
    const int shift = std::max(0, length - kBits - 1);
    return (shift << kBits) + static_cast<int>(nanoseconds >> shift);
}

uint64_t Histogram::middleOf(int bucket) {
    const int shift = std::max(0, (bucket >> kBits) - 1);
    const uint64_t low = static_cast<uint64_t>(bucket - (shift << kBits)) << shift;
    return low + ((uint64_t{1} << shift) >> 1);
}

}  // namespace orvtrace
