// SPDX-License-Identifier: Apache-2.0
#include "core/SilenceWatch.h"

#include <algorithm>

namespace orvtarn {

bool SilenceWatch::isDue(int64_t reached, Time now) {
    if (!mSince || reached != mReached) {
        mSince = now;
        mReached = reached;
        return false;
    }
    if (now - *mSince < kLimit) return false;
    mSince = now;
    return true;
}

double SilenceWatch::remaining(Time now) const {
    if (!mSince) return -1;
    const std::chrono::duration<double> left = *mSince + kLimit - now;
    return std::max(left.count(), 0.0);
}

}  // namespace orvtarn
