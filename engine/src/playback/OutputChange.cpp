// SPDX-License-Identifier: Apache-2.0
#include "playback/OutputChange.h"

#include <stdint.h>

#include <optional>

namespace orvtarn {

void OutputChange::run(bool onWindow, const std::function<void()>& change) {
    const std::optional<int64_t> track = mMpv.getInt("vid");
    const std::optional<double> position = mMpv.getDouble("time-pos");
    const auto exchange = [&] {
        if (track) mMpv.set("vid", "no");
        change();
        mDecoding.setOnWindow(onWindow);
        if (track) mMpv.set("vid", *track);
    };
    // Without a picture, media without sound would be at its end: a seek is not.
    bool isDone = false;
    if (track && position) {
        mEvents.seekUnattended([&] {
            isDone = true;
            exchange();
            return mMpv.seek(*position, "absolute+exact");
        });
    }
    if (!isDone) exchange();
}

}  // namespace orvtarn
