// SPDX-License-Identifier: Apache-2.0
// The dispatcher's handlers, its refusals, and its life.
#include <android/log.h>
#include <errno.h>
#include <jni/PlayerContext.h>
#include <stdlib.h>
#include <unistd.h>

#include "Deletion.h"
#include "DispatcherFixture.h"
#include "MutexProbe.h"
#include "PrivateMember.h"

namespace orvtest {

ORV_OPEN_MEMBER(GlobalMutex, ORV::SyncToAsync, s_mutexGlobal);
ORV_OPEN_MEMBER(Handlers, ORV::SyncToAsync, m_handlers);

namespace {

using android::OrvMediaService;
using testing::ElementsAre;
using testing::IsEmpty;

class SyncToAsyncHandlersTest : public DispatcherFixture {
protected:
    Service service = new OrvMediaService;
};

TEST_F(SyncToAsyncHandlersTest, AddLogsEnterAndLeave) {
    addHandler(service, "one");
    EXPECT_THAT(dispatcherLines(),
                LinesAre({dispatcherInfo("SyncToAsync::addMsgHandler(): Enter"),
                          dispatcherInfo("SyncToAsync::addMsgHandler(): Leave")}));
    dispatcher->delMsgHandler(service);
}

TEST_F(SyncToAsyncHandlersTest, DeletesTheHandler) {
    addHandler(service, "one");
    const Deletion handler((dispatcher->*memberOf(Handlers{})).back());
    EXPECT_FALSE(handler.happened());
    dispatcher->delMsgHandler(service);
    EXPECT_TRUE(handler.happened());
}

TEST_F(SyncToAsyncHandlersTest, DeletesEachActionAndItsPayloadWhenItIsDone) {
    addHandler(service, "one");
    ORV::SyncToAsyncAction* valid = action(service, 1);
    ORV::SyncToAsyncAction* invalid = action(service, 2);
    invalid->valid = false;
    ORV::SyncToAsyncAction* strangers = action(new OrvMediaService, 3);
    const Deletion deletions[] = {Deletion(valid),     Deletion(valid->payload),
                                  Deletion(invalid),   Deletion(invalid->payload),
                                  Deletion(strangers), Deletion(strangers->payload)};
    for (ORV::SyncToAsyncAction* one : {valid, invalid, strangers}) dispatcher->addAction(one);
    waitFor(dispatcherError("SyncToAsync::Run(): prMsgDispatcher==NULL"));
    for (const Deletion& deletion : deletions) EXPECT_TRUE(deletion.happened());
    dispatcher->delMsgHandler(service);
}

// What letting go of the references leads to does not meet it any more.
TEST_F(SyncToAsyncHandlersTest, HandlerIsTakenOutBeforeItIsDeleted) {
    const size_t before = handlers();
    addHandler(service, "one");
    size_t during = before + 1;
    vm.whenCalled("DeleteGlobalRef", [&] { during = handlers(); });
    dispatcher->delMsgHandler(service);
    vm.whenCalled("DeleteGlobalRef", [] {});
    EXPECT_EQ(during, before);
    EXPECT_EQ(handlers(), before);
}

TEST_F(SyncToAsyncHandlersTest, DeleteLogsItsSteps) {
    addHandler(service, "one");
    log.clear();
    dispatcher->delMsgHandler(service);
    EXPECT_THAT(dispatcherLines(),
                LinesAre({dispatcherInfo("SyncToAsync::delMsgHandler(): Enter"),
                          dispatcherInfo("SyncToAsync::m_deleteMsgHandler(): Enter"),
                          dispatcherInfo("SyncToAsync::m_deleteMsgHandler(): Leave"),
                          dispatcherInfo("SyncToAsync::delMsgHandler(): leave")}));
}

TEST_F(SyncToAsyncHandlersTest, DeleteOfAnUnknownServiceOnlyLogsItsEnds) {
    addHandler(service, "one");
    Service stranger = new OrvMediaService;
    log.clear();
    dispatcher->delMsgHandler(stranger);
    EXPECT_THAT(dispatcherLines(),
                LinesAre({dispatcherInfo("SyncToAsync::delMsgHandler(): Enter"),
                          dispatcherInfo("SyncToAsync::delMsgHandler(): leave")}));
    EXPECT_EQ(service->getStrongCount(), 2);
    dispatcher->delMsgHandler(service);
}

TEST_F(SyncToAsyncHandlersTest, FirstOfTwoHandlersGetsTheEventsAndGoesFirst) {
    addHandler(service, "one");
    addHandler(service, "two");
    dispatcher->addAction(action(service, 1));
    waitForPauses(1);
    dispatcher->delMsgHandler(service);
    dispatcher->addAction(action(service, 2));
    waitForPauses(2);
    EXPECT_THAT(posted(), ElementsAre("\"one\" 1", "\"two\" 2"));
    dispatcher->delMsgHandler(service);
    dispatcher->addAction(action(service, 3));
    waitFor(dispatcherError("SyncToAsync::Run(): prMsgDispatcher==NULL"));
    EXPECT_EQ(posted().size(), 2u);
}

TEST_F(SyncToAsyncHandlersTest, HandlerLetsGoOfThePosterFirst) {
    auto* handler = new ORV::MsgHandler{
        service, new ORV::MsgDispatcher(vm.env(), vm.local(player), string("one"))};
    service.clear();
    log.clear();
    delete handler;
    EXPECT_THAT(log.take(), LinesAre({bridgeInfo("MsgDispatcher::~MsgDispatcher(): Enter\n"),
                                      bridgeInfo("MsgDispatcher::~MsgDispatcher(): Leave\n"),
                                      serviceInfo("OrvMediaService::~OrvMediaService()")}));
}

TEST_F(SyncToAsyncHandlersTest, NullArgumentsAreLoggedAndIgnored) {
    dispatcher->addAction(nullptr);
    dispatcher->abortAction(nullptr);
    dispatcher->abortAllActions(nullptr, true);
    dispatcher->delMsgHandler(nullptr);
    EXPECT_THAT(dispatcherLines(),
                LinesAre({dispatcherInfo("SyncToAsync::addAction(): invalid argument"),
                          dispatcherInfo("SyncToAsync::abortAction(): invalid argument"),
                          dispatcherInfo("SyncToAsync::abortAllActions(): Enter"),
                          dispatcherInfo("SyncToAsync::abortAllActions(): invalid argument"),
                          dispatcherInfo("SyncToAsync::delMsgHandler(): Enter"),
                          dispatcherInfo("SyncToAsync::delMsgHandler(): invalid argument")}));
}

TEST_F(SyncToAsyncHandlersTest, HandlerNeedsBothOfItsParts) {
    const std::vector<ExpectedLine> refused = {
        dispatcherInfo("SyncToAsync::addMsgHandler(): Enter"),
        dispatcherInfo("SyncToAsync::addMsgHandler(): invalid argument")};
    addHandler(nullptr, "one");
    EXPECT_THAT(dispatcherLines(), LinesAre(refused));
    log.clear();
    dispatcher->addMsgHandler(service, nullptr);
    EXPECT_THAT(dispatcherLines(), LinesAre(refused));
    EXPECT_EQ(service->getStrongCount(), 1);
}

TEST_F(SyncToAsyncHandlersTest, AbortOfAnUnknownActionChangesNothing) {
    ORV::SyncToAsyncAction stranger;
    dispatcher->abortAction(&stranger);
    EXPECT_EQ(stranger.cancelled, 0);
    EXPECT_THAT(dispatcherLines(), IsEmpty());
}

TEST_F(SyncToAsyncHandlersTest, ManyThreadsMayAddAndAbort) {
    addHandler(service, "one");
    std::vector<std::thread> threads;
    for (int t = 0; t < 4; t++) {
        threads.emplace_back([&] {
            for (int i = 0; i < 50; i++) {
                dispatcher->addAction(action(service, i));
                if (i % 10 == 0) dispatcher->abortAllActions(service, true);
            }
        });
    }
    for (std::thread& thread : threads) thread.join();
    waitForPauses(200);
    EXPECT_EQ(pauses().size(), 200u);
    dispatcher->delMsgHandler(service);
    EXPECT_EQ(service->getStrongCount(), 1);
}

// A program that gives its player up in the player's own event: the poster goes
// on the worker, behind the delivery. In a process of its own, for it may crash.
TEST_F(SyncToAsyncHandlersTest, PlayerMayBeReleasedInsideItsOwnEvent) {
    testing::FLAGS_gtest_death_test_style = "threadsafe";
    const auto releaseInEvent = [this] {
        setUpPlayer();
        playerClass
            .findMethod("postEventFromNative", "(Ljava/lang/Object;IIILjava/lang/Object;)V", true)
            ->implementation = [this](const fakejni::Invocation&) {
            fakejni::callNative<void>(vm, playerClass, vm.local(player), "native_release", "()V");
            return fakejni::Value{};
        };
        dispatcher->addAction(action(android::getMediaService(vm.env(), vm.local(player)), 2));
        waitForPauses(1);
        _exit(vm.globalReferences() == 0 && vm.violations().empty() ? 0 : 1);
    };
    EXPECT_EXIT(releaseInEvent(), testing::ExitedWithCode(0), "");
}

// In a process of its own, where the dispatcher does not exist yet.
class SyncToAsyncLifeTest : public testing::Test {
protected:
    SyncToAsyncLifeTest() {
        testing::FLAGS_gtest_death_test_style = "threadsafe";
        __android_log_set_minimum_priority(ANDROID_LOG_VERBOSE);
    }
};

TEST_F(SyncToAsyncLifeTest, StartsOnFirstUseAndEndsWithTheProcess) {
    const auto use = [] {
        ORV::SyncToAsync::getInstance();
        ORV::SyncToAsync::getInstance();
        exit(0);
    };
    EXPECT_EXIT(use(), testing::ExitedWithCode(0),
                testing::MatchesRegex("(.|\n)*SyncToAsync::SyncToAsync\\(\\): Enter\n"
                                      "[^\n]*SyncToAsync::SyncToAsync\\(\\): Leave\n"
                                      "[^\n]*SyncToAsync::~SyncToAsync\\(\\): Enter\n"
                                      "[^\n]*SyncToAsync::~SyncToAsync\\(\\): Leave\n"));
}

// The worker is started by the constructor.
TEST_F(SyncToAsyncLifeTest, IsMadeUnderTheGlobalMutex) {
    const auto use = [] {
        int tried = -1;
        const auto look = pthreadCreateCall.replace([&](auto... arguments) {
            tried = tryFromAnotherThread(*memberOf(GlobalMutex{}));
            return pthreadCreateCall.real(arguments...);
        });
        ORV::SyncToAsync::getInstance();
        _exit(tried == EBUSY ? 0 : 1);
    };
    EXPECT_EXIT(use(), testing::ExitedWithCode(0), "");
}

TEST_F(SyncToAsyncLifeTest, TheWorkerIsStartedBetweenTheConstructorsLines) {
    const auto use = [] {
        const auto look = pthreadCreateCall.replace([&](auto... arguments) {
            fputs("the worker starts\n", stderr);
            return pthreadCreateCall.real(arguments...);
        });
        ORV::SyncToAsync::getInstance();
        _exit(0);
    };
    EXPECT_EXIT(use(), testing::ExitedWithCode(0),
                testing::MatchesRegex("(.|\n)*SyncToAsync::SyncToAsync\\(\\): Enter\n"
                                      "the worker starts\n"
                                      "[^\n]*SyncToAsync::SyncToAsync\\(\\): Leave\n"));
}

TEST_F(SyncToAsyncLifeTest, TheWorkerIsEndedBehindTheDestructorsFirstLine) {
    const auto use = [] {
        // Made first, so that it goes last.
        static const auto look = semPostCall.replace([](sem_t* semaphore) {
            fputs("a wake-up\n", stderr);
            return semPostCall.real(semaphore);
        });
        ORV::SyncToAsync::getInstance();
        exit(0);
    };
    EXPECT_EXIT(use(), testing::ExitedWithCode(0),
                testing::MatchesRegex("(.|\n)*SyncToAsync::~SyncToAsync\\(\\): Enter\n"
                                      "a wake-up\n"
                                      "a wake-up\n"
                                      "[^\n]*SyncToAsync::~SyncToAsync\\(\\): Leave\n"));
}

// The worker is through with all that was added before the last line comes.
TEST_F(SyncToAsyncLifeTest, EndWaitsForTheWorker) {
    const auto use = [] {
        for (int i = 0; i < 200; i++) {
            ORV::SyncToAsync::getInstance()->addAction(new ORV::SyncToAsyncAction);
        }
        exit(0);
    };
    const auto isWhole = [](const std::string& text) {
        const std::string line = "action is not valid";
        const size_t end = text.find("~SyncToAsync(): Leave");
        size_t count = 0;
        for (size_t at = text.find(line); at < end; at = text.find(line, at + 1)) count++;
        return end != std::string::npos && count == 200;
    };
    EXPECT_EXIT(use(), testing::ExitedWithCode(0), testing::Truly(isWhole));
}

}  // namespace
}  // namespace orvtest
