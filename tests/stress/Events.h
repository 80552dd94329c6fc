// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <binder/Parcel.h>
#include <dispatch/SyncToAsync.h>

#include <atomic>
#include <functional>
#include <vector>

#include "LogCounts.h"
#include "World.h"

namespace stress {

// The events of one round: each is either delivered to Java, in the order of its
// sender, or dropped with a line in the log.
class Events {
public:
    // inJava runs inside each delivery, on the dispatcher's thread.
    Events(World& world, size_t senders, std::function<void()> inJava);

    // Hands an event to the dispatcher for that service; the sender's number is msg.
    void send(size_t sender, const android::sp<android::OrvMediaService>& service);
    // Aborts the sender's last event, which may be gone.
    void abortLast(size_t sender);

    // Waits until the dispatcher has nothing left to do.
    void settle();
    // After that: reports events that were lost or came twice.
    void check();

private:
    void deliver(const fakejni::Invocation& call);

    struct Sender {
        int32_t sent = 0;
        int32_t delivered = 0;  // on the dispatcher's thread
        ORV::SyncToAsyncAction* last = nullptr;
    };

    World& mWorld;
    std::function<void()> mInJava;
    std::vector<Sender> mSenders;
    uint64_t mDelivered = 0;
    android::Parcel mParcel;
    const LogCounts mBefore;
};

}  // namespace stress
