// SPDX-License-Identifier: Apache-2.0
// The dispatcher's worker: order, pauses, and what becomes of each action.
#include <binder/Parcel.h>
#include <errno.h>
#include <sys/prctl.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <memory>
#include <optional>
#include <set>
#include <thread>

#include "DispatcherFixture.h"
#include "MutexProbe.h"
#include "PrivateMember.h"

namespace orvtest {

using DispatchersQueue = os::MessageQueue<ORV::SyncToAsyncAction*>;
ORV_OPEN_MEMBER(DispatcherQueue, ORV::SyncToAsync, m_queue);
ORV_OPEN_MEMBER(DispatcherQueueItems, DispatchersQueue, mQueue);
ORV_OPEN_MEMBER(DispatcherQueueMutex, DispatchersQueue, mMutex);
ORV_OPEN_MEMBER(DispatcherQueueWakeUp, DispatchersQueue, mWakeUp);

namespace {

using android::OrvMediaService;
using testing::ElementsAre;
using testing::IsEmpty;

const ExpectedLine kNotValid = dispatcherInfo("SyncToAsync::Run(): action is not valid");
const ExpectedLine kNoPoster = dispatcherError("SyncToAsync::Run(): prMsgDispatcher==NULL");
const ExpectedLine kNoService =
    dispatcherInfo("SyncToAsync::m_getMsgDispather(): invalid argument");
const ExpectedLine kCancelled = dispatcherInfo("SyncToAsync::Run(): this event has been canceled");
const ExpectedLine kNoPayload = dispatcherError("SyncToAsync::Run(): prMsgWrapper==NULL");

// A service with a registered poster named "one".
class SyncToAsyncTest : public DispatcherFixture {
protected:
    void SetUp() override {
        DispatcherFixture::SetUp();
        service = new OrvMediaService;
        addHandler(service, "one");
        log.clear();
    }
    void TearDown() override {
        dispatcher->delMsgHandler(service);
        EXPECT_EQ(pending(), 0u) << "a deleted action is still listed";
        EXPECT_EQ(service->getStrongCount(), 1) << "an action or a handler was not deleted";
        DispatcherFixture::TearDown();
    }

    Service service;
};

TEST_F(SyncToAsyncTest, IsOnePerProcess) { EXPECT_EQ(ORV::SyncToAsync::getInstance(), dispatcher); }

TEST_F(SyncToAsyncTest, ActionsAreDeliveredInOrderWithAPauseBehindEach) {
    for (int msg : {1, 2, 3}) dispatcher->addAction(action(service, msg));
    waitForPauses(3);
    EXPECT_THAT(posted(), ElementsAre("\"one\" 1", "\"one\" 2", "\"one\" 3"));
    ASSERT_EQ(pauses().size(), 3u);
    for (const timespec& pause : pauses()) {
        EXPECT_EQ(pause.tv_sec, 0);
        EXPECT_EQ(pause.tv_nsec, 50000000);
    }
    EXPECT_THAT(dispatcherLines(), IsEmpty());
}

TEST_F(SyncToAsyncTest, AllOfTheMessageReachesJava) {
    android::Parcel parcel;
    for (int32_t word : {1, 2, 3}) parcel.writeInt32(word);
    auto* sent = action(service, 5);
    *sent->payload = NotifyMessage{5, -6, 7, &parcel};
    dispatcher->addAction(sent);
    waitForPauses(1);
    EXPECT_THAT(vm.javaCallTexts(),
                ElementsAre("postEventFromNative(\"one\", 5, -6, 7, byte[12])"));
}

TEST_F(SyncToAsyncTest, OneNamedWorkerDeliversEverything) {
    std::set<std::thread::id> threads;
    std::set<std::string> names;
    duringPause = [&] {
        char name[16] = {};
        prctl(PR_GET_NAME, name, 0, 0, 0);
        names.insert(name);
    };
    for (int msg : {1, 2}) dispatcher->addAction(action(service, msg));
    waitForPauses(2);
    for (const fakejni::JavaCall& call : vm.javaCalls()) threads.insert(call.thread);
    EXPECT_EQ(threads.size(), 1u);
    EXPECT_EQ(threads.count(std::this_thread::get_id()), 0u);
    EXPECT_THAT(names, ElementsAre("thread"));
}

TEST_F(SyncToAsyncTest, OrderIsThatOfAllServicesTogether) {
    Service other = new OrvMediaService;
    addHandler(other, "two");
    for (int msg : {1, 2}) {
        dispatcher->addAction(action(service, msg));
        dispatcher->addAction(action(other, msg));
    }
    waitForPauses(4);
    EXPECT_THAT(posted(), ElementsAre("\"one\" 1", "\"two\" 1", "\"one\" 2", "\"two\" 2"));
    dispatcher->delMsgHandler(other);
}

TEST_F(SyncToAsyncTest, ActionIsDeletedBeforeThePause) {
    int countInPause = 0;
    duringPause = [&] { countInPause = service->getStrongCount(); };
    dispatcher->addAction(action(service, 1));
    waitForPauses(1);
    EXPECT_EQ(countInPause, 2);  // the test's and the handler's
}

TEST_F(SyncToAsyncTest, UnknownKindIsDeletedWithoutDelivery) {
    auto* other = action(service, 1);
    other->kind = 1;
    dispatcher->addAction(other);
    waitForPauses(1);
    EXPECT_THAT(posted(), IsEmpty());
    EXPECT_THAT(dispatcherLines(), IsEmpty());
}

TEST_F(SyncToAsyncTest, MissingPayloadIsAnErrorWithAPause) {
    auto* empty = action(service, 1);
    delete empty->payload;
    empty->payload = nullptr;
    dispatcher->addAction(empty);
    waitForPauses(1);
    EXPECT_THAT(posted(), IsEmpty());
    EXPECT_THAT(dispatcherLines(), LinesAre({kNoPayload}));
}

TEST_F(SyncToAsyncTest, UnknownKindNeedsNoPayload) {
    auto* other = action(service, 1);
    delete other->payload;
    other->payload = nullptr;
    other->kind = -1;
    dispatcher->addAction(other);
    waitForPauses(1);
    EXPECT_THAT(dispatcherLines(), IsEmpty());
}

TEST_F(SyncToAsyncTest, CancelledActionIsLoggedAndPaused) {
    auto* cancelled = action(service, 1);
    cancelled->cancelled = -1;
    dispatcher->addAction(cancelled);
    waitForPauses(1);
    EXPECT_THAT(posted(), IsEmpty());
    EXPECT_THAT(dispatcherLines(), LinesAre({kCancelled}));
}

TEST_F(SyncToAsyncTest, InvalidActionIsDeletedWithoutPause) {
    auto* invalid = action(service, 1);
    invalid->valid = false;
    invalid->cancelled = 1;
    dispatcher->addAction(invalid);
    waitFor(kNotValid);
    EXPECT_THAT(posted(), IsEmpty());
    EXPECT_THAT(pauses(), IsEmpty());
    EXPECT_THAT(dispatcherLines(), LinesAre({kNotValid}));
}

TEST_F(SyncToAsyncTest, ActionWithoutServiceFindsNoPoster) {
    dispatcher->addAction(action(nullptr, 1));
    waitFor(kNoPoster);
    EXPECT_THAT(pauses(), IsEmpty());
    EXPECT_THAT(dispatcherLines(), LinesAre({kNoService, kNoPoster}));
}

TEST_F(SyncToAsyncTest, ActionOfAnUnregisteredServiceFindsNoPoster) {
    Service stranger = new OrvMediaService;
    dispatcher->addAction(action(stranger, 1));
    waitFor(kNoPoster);
    EXPECT_THAT(pauses(), IsEmpty());
    EXPECT_THAT(dispatcherLines(), LinesAre({kNoPoster}));
    EXPECT_EQ(stranger->getStrongCount(), 1);
}

TEST_F(SyncToAsyncTest, AbortAllKeepingThemValidCancelsEachWithAPause) {
    {
        const Hold held = hold();
        for (int msg : {1, 2}) dispatcher->addAction(action(service, msg));
        dispatcher->abortAllActions(service, true);
    }
    waitForPauses(2);
    EXPECT_THAT(posted(), IsEmpty());
    EXPECT_THAT(dispatcherLines(),
                LinesAre({dispatcherInfo("SyncToAsync::abortAllActions(): Enter"),
                          dispatcherInfo("SyncToAsync::abortAllActions(): Leave"), kCancelled,
                          kCancelled}));
}

TEST_F(SyncToAsyncTest, AbortAllMakesThemInvalidAndTheyGoWithoutPause) {
    {
        const Hold held = hold();
        for (int msg : {1, 2}) dispatcher->addAction(action(service, msg));
        dispatcher->abortAllActions(service, false);
    }
    waitFor(kNotValid, 2);
    EXPECT_THAT(posted(), IsEmpty());
    EXPECT_THAT(pauses(), IsEmpty());
    EXPECT_THAT(
        dispatcherLines(),
        LinesAre({dispatcherInfo("SyncToAsync::abortAllActions(): Enter"),
                  dispatcherInfo("SyncToAsync::abortAllActions(): Leave"), kNotValid, kNotValid}));
}

// It sets both marks, whatever they were before.
TEST_F(SyncToAsyncTest, AbortAllMarksEachPendingAction) {
    {
        const Hold held = hold();
        auto* marked = action(service, 1);
        marked->valid = false;
        dispatcher->addAction(marked);
        for (const bool keepValid : {false, true}) {
            marked->cancelled = 0;
            dispatcher->abortAllActions(service, keepValid);
            EXPECT_EQ(marked->cancelled, 1);
            EXPECT_EQ(marked->valid, keepValid);
        }
        log.clear();
    }
    waitForPauses(1);
    EXPECT_THAT(dispatcherLines(), LinesAre({kCancelled}));
}

TEST_F(SyncToAsyncTest, AbortAllLeavesOtherServicesAndLaterActionsAlone) {
    Service other = new OrvMediaService;
    addHandler(other, "two");
    {
        const Hold held = hold();
        dispatcher->addAction(action(other, 1));
        dispatcher->addAction(action(service, 2));
        dispatcher->addAction(action(other, 3));
        dispatcher->abortAllActions(service, false);
        dispatcher->addAction(action(service, 4));
    }
    waitForPauses(3);
    EXPECT_THAT(posted(), ElementsAre("\"two\" 1", "\"two\" 3", "\"one\" 4"));
    dispatcher->delMsgHandler(other);
}

TEST_F(SyncToAsyncTest, AbortOneCancelsThatOneOnly) {
    {
        const Hold held = hold();
        auto* first = action(service, 1);
        dispatcher->addAction(first);
        dispatcher->addAction(action(service, 2));
        dispatcher->abortAction(first);
    }
    waitForPauses(2);
    EXPECT_THAT(posted(), ElementsAre("\"one\" 2"));
    EXPECT_THAT(dispatcherLines(), LinesAre({kCancelled}));
}

TEST_F(SyncToAsyncTest, AbortOfADeliveredActionChangesNothing) {
    auto* delivered = action(service, 1);
    dispatcher->addAction(delivered);
    waitForPauses(1);
    ASSERT_EQ(pending(), 0u);  // else the next line writes to what was deleted
    dispatcher->abortAction(delivered);
    EXPECT_THAT(posted(), ElementsAre("\"one\" 1"));
    EXPECT_THAT(dispatcherLines(), IsEmpty());
}

TEST_F(SyncToAsyncTest, EachChangeWaitsForTheMutex) {
    const android::sp<ORV::MsgDispatcher> poster =
        new ORV::MsgDispatcher(vm.env(), vm.local(player), string("two"));
    ORV::SyncToAsyncAction unlisted;
    const std::pair<const char*, std::function<void()>> changes[] = {
        {"addAction", [&] { dispatcher->addAction(action(service, 1)); }},
        {"abortAction", [&] { dispatcher->abortAction(&unlisted); }},
        {"abortAllActions", [&] { dispatcher->abortAllActions(service, true); }},
        {"addMsgHandler", [&] { dispatcher->addMsgHandler(service, poster); }},
        {"delMsgHandler", [&] { dispatcher->delMsgHandler(service); }}};
    for (const auto& [name, change] : changes) {
        SCOPED_TRACE(name);
        expectToWaitFor(dispatcherMutex(), change);
    }
    waitForPauses(1);
}

// What they look for is what there is once they have the mutex.
TEST_F(SyncToAsyncTest, NothingIsLookedUpBeforeTheMutexIsTaken) {
    ORV::SyncToAsyncAction late;  // listed alone: the worker does not get it
    late.cancelled = 0;
    expectToWaitFor(
        dispatcherMutex(), [&] { dispatcher->abortAction(&late); },
        [&] { actions().push_back(&late); });
    EXPECT_EQ(late.cancelled, 1);
    {
        const Hold held = hold();
        actions().remove(&late);
    }
    dispatcher->delMsgHandler(service);
    const size_t before = handlers();
    expectToWaitFor(
        dispatcherMutex(), [&] { dispatcher->delMsgHandler(service); },
        [&] { addHandler(service, "late"); });
    EXPECT_EQ(handlers(), before);
}

// The sender judges whether the queue is empty when it has the queue's mutex.
TEST_F(SyncToAsyncTest, TheWorkerIsNotWokenForAQueueThatHasAnItem) {
    auto& queue = dispatcher->*memberOf(DispatcherQueue{});
    std::atomic<int> wakeUps{0};
    std::optional<OtherThread> adding;
    {
        const auto count = semPostCall.replace([&](sem_t* semaphore) {
            wakeUps++;
            return semPostCall.real(semaphore);
        });
        {
            const os::ScopedMutex held(queue.*memberOf(DispatcherQueueMutex{}));
            adding.emplace([&] { dispatcher->addAction(action(service, 2)); });
            EXPECT_TRUE(adding->isStopped());
            (queue.*memberOf(DispatcherQueueItems{})).push(action(service, 1));
        }
        adding->join();
    }
    EXPECT_EQ(wakeUps, 0);
    (queue.*memberOf(DispatcherQueueWakeUp{})).release();
    waitForPauses(2);
    EXPECT_THAT(posted(), ElementsAre("\"one\" 1", "\"one\" 2"));
}

TEST_F(SyncToAsyncTest, TheWorkerTakesAnItemWithTheQueuesMutex) {
    auto& queue = dispatcher->*memberOf(DispatcherQueue{});
    os::Mutex& mutex = queue.*memberOf(DispatcherQueueMutex{});
    {
        const os::ScopedMutex held(mutex);
        dispatcher->addAction(action(service, 1));
        while (!isAwaited(mutex) && pauses().empty()) std::this_thread::yield();
        EXPECT_THAT(pauses(), IsEmpty()) << "it does not wait";
    }
    waitForPauses(1);
}

TEST_F(SyncToAsyncTest, TheWorkerSleepsWhileThereIsNothingToDo) {
    auto& queue = dispatcher->*memberOf(DispatcherQueue{});
    const void* wakeUp = &(queue.*memberOf(DispatcherQueueWakeUp{}));
    // The worker may go through its wait again at any time.
    const auto sleeps = std::make_shared<std::atomic<bool>>(false);
    const auto look = semWaitCall.replace([wakeUp, sleeps](sem_t* semaphore) {
        if (semaphore == wakeUp) *sleeps = true;
        return semWaitCall.real(semaphore);
    });
    dispatcher->addAction(action(service, 1));
    waitForPauses(1);
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(10);
    while (!*sleeps && std::chrono::steady_clock::now() < end) std::this_thread::yield();
    EXPECT_TRUE(*sleeps);
}

// An argument that is refused needs no mutex.
TEST_F(SyncToAsyncTest, NullIsRefusedWithoutWaiting) {
    const std::pair<const char*, std::function<void()>> refusals[] = {
        {"addAction", [&] { dispatcher->addAction(nullptr); }},
        {"abortAction", [&] { dispatcher->abortAction(nullptr); }},
        {"abortAllActions", [&] { dispatcher->abortAllActions(nullptr, true); }},
        {"addMsgHandler", [&] { dispatcher->addMsgHandler(service, nullptr); }},
        {"delMsgHandler", [&] { dispatcher->delMsgHandler(nullptr); }}};
    for (const auto& [name, refusal] : refusals) {
        SCOPED_TRACE(name);
        std::optional<OtherThread> refused;
        const Hold held = hold();
        refused.emplace(refusal);
        EXPECT_FALSE(refused->isStopped());
        refused->join();
    }
}

// The last line of an operation comes when all of it is done.
TEST_F(SyncToAsyncTest, LeaveLinesComeBehindTheChange) {
    size_t handlersAtTheEnd = 0;
    log.whenLogged(dispatcherInfo("SyncToAsync::addMsgHandler(): Leave"),
                   [&] { handlersAtTheEnd = handlers(); });
    const size_t before = handlers();
    addHandler(service, "two");
    EXPECT_EQ(handlersAtTheEnd, before + 1);
    dispatcher->delMsgHandler(service);

    int32_t cancelledAtTheEnd = 0;
    {
        const Hold held = hold();
        auto* marked = action(service, 1);
        dispatcher->addAction(marked);
        log.whenLogged(dispatcherInfo("SyncToAsync::abortAllActions(): Leave"),
                       [&] { cancelledAtTheEnd = marked->cancelled; });
        dispatcher->abortAllActions(service, true);
    }
    EXPECT_EQ(cancelledAtTheEnd, 1);
    waitForPauses(1);
}

TEST_F(SyncToAsyncTest, DiscardedActionsAreDeletedBehindTheirLine) {
    size_t pendingAtTheLine = 0;
    auto* invalid = action(service, 1);
    invalid->valid = false;
    for (const auto& [line, discarded] :
         {std::pair(kNotValid, invalid), std::pair(kNoPoster, action(new OrvMediaService, 2))}) {
        SCOPED_TRACE(line.text);
        log.whenLogged(line, [&] { pendingAtTheLine = pending(); });
        dispatcher->addAction(discarded);
        waitFor(line);
        EXPECT_EQ(pendingAtTheLine, 1u);
    }
}

TEST_F(SyncToAsyncTest, CancelledActionOfAnUnknownKindIsLoggedAsCancelled) {
    auto* both = action(service, 1);
    both->kind = 1;
    both->cancelled = 1;
    dispatcher->addAction(both);
    waitForPauses(1);
    EXPECT_THAT(dispatcherLines(), LinesAre({kCancelled}));
}

// Waiting is not enough: what is done before it would not be guarded.
TEST_F(SyncToAsyncTest, NothingChangesBeforeTheMutexIsTaken) {
    const android::sp<ORV::MsgDispatcher> poster =
        new ORV::MsgDispatcher(vm.env(), vm.local(player), string("two"));
    ORV::SyncToAsyncAction* listed = nullptr;
    const std::pair<const char*, std::function<void()>> changes[] = {
        {"addAction", [&] { dispatcher->addAction(action(service, 1)); }},
        {"abortAction", [&] { dispatcher->abortAction(listed); }},
        {"abortAllActions", [&] { dispatcher->abortAllActions(service, true); }},
        {"addMsgHandler", [&] { dispatcher->addMsgHandler(service, poster); }},
        {"delMsgHandler", [&] { dispatcher->delMsgHandler(service); }}};
    for (const auto& [name, change] : changes) {
        SCOPED_TRACE(name);
        std::optional<OtherThread> changing;
        {
            const Hold held = hold();
            listed = action(service, 2);
            dispatcher->addAction(listed);
            const size_t actions = pending();
            const size_t posters = handlers();
            changing.emplace(change);
            EXPECT_TRUE(changing->isStopped());
            EXPECT_EQ(pending(), actions);
            EXPECT_EQ(listed->cancelled, 0);
            EXPECT_EQ(handlers(), posters);
        }
        changing->join();
        while (pending() != 0) std::this_thread::yield();
    }
}

TEST_F(SyncToAsyncTest, MutexIsHeldWhileJavaRunsAndInThePause) {
    std::vector<int> held;
    const auto look = [&] { held.push_back(tryFromAnotherThread(dispatcherMutex())); };
    playerClass
        .findMethod("postEventFromNative", "(Ljava/lang/Object;IIILjava/lang/Object;)V", true)
        ->implementation = [&](const fakejni::Invocation&) {
        look();
        return fakejni::Value{};
    };
    duringPause = look;
    dispatcher->addAction(action(service, 1));
    waitForPauses(1);
    EXPECT_THAT(held, ElementsAre(EBUSY, EBUSY));
    EXPECT_EQ(tryFromAnotherThread(dispatcherMutex()), 0);
}

}  // namespace
}  // namespace orvtest
