// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mutex>
#include <utility>

#include "World.h"

namespace stress {

// One Java player after another, as programs make them: an object is set up once.
class Slot {
public:
    explicit Slot(bool binds) : bindsSurfaces(binds) {}

    // The present player; it may have been released. None before the first.
    Player player() {
        std::lock_guard<std::mutex> lock(mMutex);
        return mPlayer;
    }
    // Returns the one before.
    Player replace(Player next) {
        std::lock_guard<std::mutex> lock(mMutex);
        return std::exchange(mPlayer, std::move(next));
    }

    // Players of some slots draw on surfaces: calls that touch them are made with the
    // turn held, from one thread at a time. On those of the others any call may meet
    // any other.
    const bool bindsSurfaces;
    std::mutex turn;

private:
    std::mutex mMutex;
    Player mPlayer;
};

}  // namespace stress
