// SPDX-License-Identifier: Apache-2.0
#include "Events.h"

#include <os/ScopedMutex.h>

#include <thread>

#include "PrivateMember.h"
#include "Progress.h"

namespace orvtest {

ORV_OPEN_MEMBER(StressedMutex, ORV::SyncToAsync, m_mutex);
ORV_OPEN_MEMBER(StressedActions, ORV::SyncToAsync, m_actions);

}  // namespace orvtest

namespace stress {

using android::sp;
using ORV::SyncToAsync;

namespace {

size_t pendingActions() {
    SyncToAsync* dispatcher = SyncToAsync::getInstance();
    const os::ScopedMutex lock(dispatcher->*memberOf(orvtest::StressedMutex{}));
    return (dispatcher->*memberOf(orvtest::StressedActions{})).size();
}

}  // namespace

Events::Events(World& world, size_t senders, std::function<void()> inJava)
    : mWorld(world), mInJava(std::move(inJava)), mSenders(senders), mBefore(logCounts()) {
    for (int32_t word : {1, 2, 3}) mParcel.writeInt32(word);
    world.playerClass
        .findMethod("postEventFromNative", "(Ljava/lang/Object;IIILjava/lang/Object;)V", true)
        ->implementation = [this](const fakejni::Invocation& call) {
        deliver(call);
        return fakejni::Value{};
    };
}

void Events::send(size_t sender, const sp<android::OrvMediaService>& service) {
    Sender& from = mSenders[sender];
    auto* action = new ORV::SyncToAsyncAction;
    const int32_t number = ++from.sent;
    const android::Parcel* parcel = number % 2 == 0 ? &mParcel : nullptr;
    action->payload = new NotifyMessage{static_cast<int32_t>(sender), number, -number, parcel};
    action->service = service;
    action->valid = true;
    from.last = action;
    SyncToAsync::getInstance()->addAction(action);
    step();
}

void Events::abortLast(size_t sender) {
    SyncToAsync::getInstance()->abortAction(mSenders[sender].last);
    step();
}

void Events::deliver(const fakejni::Invocation& call) {
    const size_t sender = static_cast<size_t>(call.args.at(1).integer);
    const int64_t number = call.args.at(2).integer;
    const int64_t negated = call.args.at(3).integer;
    const fakejni::ObjectPtr& payload = call.args.at(4).object;
    if (sender >= mSenders.size() || negated != -number ||
        (payload != nullptr) != (number % 2 == 0) ||
        (payload != nullptr && payload->bytes.size() != 12)) {
        mWorld.faults.add("an event came with other values than it was sent with");
        return;
    }
    const uint32_t player = World::numberOf(call.args.at(0).object);
    if (mWorld.isReleased(player)) mWorld.faults.add("a released player got an event");
    if (number <= mSenders[sender].delivered) {
        mWorld.faults.add("event " + std::to_string(number) + " of thread " +
                          std::to_string(sender) + " came after event " +
                          std::to_string(mSenders[sender].delivered));
    }
    mSenders[sender].delivered = static_cast<int32_t>(number);
    ++mDelivered;
    mInJava();
    if (mWorld.isReleased(player)) mWorld.faults.add("a release did not wait for a delivery");
    step();
}

void Events::settle() {
    while (pendingActions() != 0) std::this_thread::yield();
}

void Events::check() {
    const LogCounts now = logCounts();
    uint64_t sent = now.listenerActions - mBefore.listenerActions;
    for (const Sender& sender : mSenders) sent += sender.sent;
    const uint64_t dropped = now.notValid - mBefore.notValid + now.noPoster - mBefore.noPoster +
                             now.cancelled - mBefore.cancelled;
    if (sent == mDelivered + dropped) return;
    mWorld.faults.add(std::to_string(sent) + " events were sent, " + std::to_string(mDelivered) +
                      " delivered and " + std::to_string(dropped) + " dropped");
}

}  // namespace stress
