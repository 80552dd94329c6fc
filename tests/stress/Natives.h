// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <vector>

#include "Random.h"
#include "World.h"

namespace stress {

// One row of the native method table that any thread may call.
struct Native {
    std::string name;
    // It reads or writes the player's surface, which has no lock: calls that do are
    // made from one thread at a time.
    bool touchesSurface;
    bool releases;
    // Calls it on the player with arguments of the thread's choice.
    void (*call)(World& world, Random& random, const fakejni::ObjectPtr& player, const Native&);
    std::string signature;
};

// All but native_init and native_setup.
const std::vector<Native>& natives();
const Native& native(const std::string& name);

// Calls it, on a thread that runs Java, and takes away the exception that it left; one
// that no player's state explains is a fault.
void callOn(World& world, Random& random, const fakejni::ObjectPtr& player, const Native& row);
void setUp(World& world, const Player& player);

}  // namespace stress
