// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace android {

// The part of the platform's track interface that a player's seek names.
struct MediaTrack {
    struct ReadOptions {
        enum SeekMode : int {
            SEEK_PREVIOUS_SYNC = 0,
            SEEK_NEXT_SYNC = 1,
            SEEK_CLOSEST_SYNC = 2,
            SEEK_CLOSEST = 3,
        };
    };
};

}  // namespace android
