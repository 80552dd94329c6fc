// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stream/IOrvStreamSource.h>

#include <memory>
#include <mutex>
#include <vector>

#include "Random.h"
#include "World.h"

namespace stress {

// The streams that engine players got, used as an engine does: on threads that are not
// attached, several at once. Nothing in the product deletes them; this does.
class Streams {
public:
    explicit Streams(World& world) : mWorld(world) {}
    // On a thread that runs Java, after all use.
    ~Streams();

    // Takes it over. Any thread.
    void add(IOrvStreamSource* stream);
    // One operation on one of the latest, on an engine's thread.
    void use(Random& random);

private:
    struct Held;

    std::shared_ptr<Held> pick(Random& random);
    void read(Held& held);
    void checkNumber(const char* what, uint32_t value, uint32_t base, Held& held);

    World& mWorld;
    std::mutex mMutex;
    std::vector<std::shared_ptr<Held>> mStreams;
};

}  // namespace stress
