// SPDX-License-Identifier: Apache-2.0
// Events on their way to Java. The dispatcher's own thread is ended first: its
// work is done here, so that one thread does it all, the same each time.
#include "Counting.h"
#include "Machine.h"
#include "Paths.h"
#include "PrivateMember.h"
#include "dispatch/SyncToAsync.h"

namespace orvtest {

ORV_OPEN_MEMBER(DispatcherQueue, ORV::SyncToAsync, m_queue);

}  // namespace orvtest

namespace orvcounts {
namespace {

using android::OrvMediaService;
using android::sp;
using ORV::SyncToAsync;

// Its Run comes back once it has done what was added before.
void endNextRun() {
    (SyncToAsync::getInstance()->*memberOf(orvtest::DispatcherQueue{})).send(nullptr);
}

SyncToAsync& dispatcherWithoutThread() {
    SyncToAsync* dispatcher = SyncToAsync::getInstance();
    endNextRun();
    dispatcher->Wait();
    return *dispatcher;
}

ORV::SyncToAsyncAction* newAction(const sp<OrvMediaService>& service) {
    auto* action = new ORV::SyncToAsyncAction;
    action->payload = new NotifyMessage{1, 2, 3, nullptr};
    action->service = service;
    action->valid = true;
    return action;
}

void delivered(int times) {
    SyncToAsync& dispatcher = dispatcherWithoutThread();
    Machine machine;
    const fakejni::ObjectPtr player = machine.newPlayer();
    machine.vm.onNativeThread([&] {
        repeat(times, [&](const Runner& counted) {
            machine.vm.forgetCalls();
            ORV::SyncToAsyncAction* action = newAction(serviceOf(player));
            counted([&] { dispatcher.addAction(action); });
            endNextRun();
            counted([&] { dispatcher.Run(); });
            require(machine.vm.javaCalls().size() == 1, "the event was not delivered");
        });
    });
    machine.release(player);
}

// Its player is released while it waits.
void dropped(int times) {
    SyncToAsync& dispatcher = dispatcherWithoutThread();
    Machine machine;
    repeat(times, [&](const Runner& counted) {
        const fakejni::ObjectPtr player = machine.newPlayer();
        ORV::SyncToAsyncAction* action = newAction(serviceOf(player));
        counted([&] { dispatcher.addAction(action); });
        machine.release(player);
        machine.vm.forgetCalls();
        endNextRun();
        counted([&] { dispatcher.Run(); });
        require(machine.vm.javaCalls().empty(), "the event was delivered");
    });
}

}  // namespace

const Path kEventPaths[] = {
    {"event_delivered", delivered},
    {"event_dropped", dropped},
};

}  // namespace orvcounts
