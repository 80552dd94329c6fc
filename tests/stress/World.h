// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/Surface.h>
#include <os/Relaxed.h>

#include <array>
#include <atomic>
#include <mutex>
#include <string>
#include <vector>

#include "FakeJni/Vm.h"
#include "PlayerClasses.h"

namespace stress {

// A Java player and its number, which is the same for no other of its world.
struct Player {
    fakejni::ObjectPtr object;  // null for none
    uint32_t number = 0;
};

// What went wrong, from any thread.
class Faults {
public:
    void add(const std::string& text);
    std::vector<std::string> take();

private:
    std::mutex mMutex;
    std::vector<std::string> mTexts;
};

// The fake Java machine of one round with the library loaded, and what its players
// draw on. Made and destroyed on the round's main thread.
class World {
public:
    World();
    ~World();

    // One that is not set up. Its stream fields and read buffer carry its number.
    Player newPlayer();
    // The Java side's weak reference to it, with its number.
    fakejni::ObjectPtr newWeakReference(const Player& player);
    static uint32_t numberOf(const fakejni::ObjectPtr& weakReference);

    // From the end of its release on.
    void markReleased(const Player& player) { flagOf(player.number) = true; }
    bool isReleased(uint32_t player) { return flagOf(player); }

    // A Java object for a native method's parameter of that class path.
    fakejni::ObjectPtr newArgument(const std::string& path, uint32_t choice);
    // Of the surfaces: every reference that the library took was dropped.
    bool surfacesAreFree() const;

    fakejni::Vm vm;
    fakejni::Class& playerClass;
    Faults faults;

private:
    // Relaxed, as an order on the threads would hide what they lack.
    os::Relaxed<bool>& flagOf(uint32_t player) { return mReleased.at(player % mReleased.size()); }
    fakejni::ObjectPtr newRecord(const std::string& path, uint32_t choice);

    std::vector<android::sp<android::Surface>> mSurfaces;
    std::vector<int32_t> mSurfaceCounts;
    std::atomic<uint32_t> mPlayers{0};
    std::array<os::Relaxed<bool>, 65536> mReleased;
};

// Drops the calling thread's local references that were made while it lives.
class LocalFrame {
public:
    explicit LocalFrame(fakejni::Vm& vm);
    ~LocalFrame();
    LocalFrame(const LocalFrame&) = delete;
    LocalFrame& operator=(const LocalFrame&) = delete;

private:
    fakejni::Vm& mVm;
    size_t mMark;
};

const int kReadBufferSize = 16;

}  // namespace stress
