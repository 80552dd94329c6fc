// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <chrono>
#include <optional>

namespace orvtarn {

// How long playback has been waiting for data of which nothing came. Used by one thread.
class SilenceWatch {
public:
    using Time = std::chrono::steady_clock::time_point;

    // As the network-timeout of mpv, which then tries to connect again.
    static constexpr std::chrono::seconds kLimit{20};

    // Playback goes on, or there is nothing to play.
    void stop() { mSince.reset(); }
    // It waits, and has got so far. True once for each limit without a change.
    bool isDue(int64_t reached, Time now);
    // Seconds until that may be so, -1 when playback does not wait.
    double remaining(Time now) const;

private:
    std::optional<Time> mSince;
    int64_t mReached = 0;
};

}  // namespace orvtarn
