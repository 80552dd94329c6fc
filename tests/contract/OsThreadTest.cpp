// SPDX-License-Identifier: Apache-2.0
#include <errno.h>
#include <gtest/gtest.h>
#include <os/Thread.h>
#include <sys/prctl.h>

#include <atomic>
#include <functional>
#include <future>
#include <mutex>
#include <optional>
#include <thread>
#include <vector>

#include "Deletion.h"
#include "PosixCalls.h"
#include "PrivateMember.h"

namespace orvtest {

ORV_OPEN_MEMBER(EndSignal, os::Thread, mImplmentation);
ORV_OPEN_MEMBER(Attributes, os::Thread, mAttributes);

namespace {

using testing::internal::CaptureStdout;
using testing::internal::GetCapturedStdout;

class Worker : public os::Thread {
public:
    Worker(const std::string& name, std::function<void()> body)
        : os::Thread(name), mBody(std::move(body)) {}
    void Run() override { mBody(); }

private:
    const std::function<void()> mBody;
};

TEST(OsThreadTest, RunsOnAThreadOfItsOwnAndWaitReturnsAfterIt) {
    std::thread::id id;
    std::promise<void> mayEnd;
    Worker worker("worker", [&] {
        mayEnd.get_future().wait();
        id = std::this_thread::get_id();
    });
    worker.Start();
    mayEnd.set_value();
    EXPECT_EQ(worker.Wait(), 0);
    EXPECT_NE(id, std::thread::id());
    EXPECT_NE(id, std::this_thread::get_id());
}

TEST(OsThreadTest, IsNotStartedByItsConstruction) {
    bool created = false;
    auto record =
        pthreadCreateCall.replace([&](pthread_t*, const pthread_attr_t*, void* (*)(void*), void*) {
            created = true;
            return 0;
        });
    {
        Worker worker("idle", [] {});
    }
    EXPECT_FALSE(created);
}

TEST(OsThreadTest, WaitReturnsAtOnceWhenRunHasReturned) {
    std::promise<void> ended;
    Worker worker("worker", [&] { ended.set_value(); });
    worker.Start();
    ended.get_future().wait();
    EXPECT_EQ(worker.Wait(), 0);
}

std::string nameSeenInside(const std::string& name) {
    char seen[16] = {};
    Worker worker(name, [&] { prctl(PR_GET_NAME, seen, 0, 0, 0); });
    worker.Start();
    worker.Wait();
    return seen;
}

TEST(OsThreadTest, ShowsTheFirst15CharactersOfItsName) {
    EXPECT_EQ(nameSeenInside("thread"), "thread");
    EXPECT_EQ(nameSeenInside("exactly15chars."), "exactly15chars.");
    EXPECT_EQ(nameSeenInside("a name of many more characters"), "a name of many ");
}

TEST(OsThreadTest, CopiesItsName) {
    std::string name = "before";
    char seen[16] = {};
    Worker worker(name, [&] { prctl(PR_GET_NAME, seen, 0, 0, 0); });
    name = "after";
    worker.Start();
    worker.Wait();
    EXPECT_STREQ(seen, "before");
}

TEST(OsThreadTest, BlocksSigtermForItselfOnly) {
    int inside = -1;
    int insideOther = -1;
    Worker worker("worker", [&] {
        sigset_t blocked;
        pthread_sigmask(SIG_SETMASK, nullptr, &blocked);
        inside = sigismember(&blocked, SIGTERM);
        insideOther = sigismember(&blocked, SIGINT);
    });
    worker.Start();
    worker.Wait();
    EXPECT_EQ(inside, 1);
    EXPECT_EQ(insideOther, 0);
    sigset_t here;
    pthread_sigmask(SIG_SETMASK, nullptr, &here);
    EXPECT_EQ(sigismember(&here, SIGTERM), 0);
}

// Leaves all bits set on the stack where the functions that are called next have theirs.
__attribute__((noinline)) void dirtyTheStack() {
    volatile char bytes[4096];
    for (volatile char& byte : bytes) byte = -1;
}

struct Entry {
    void* (*function)(void*);
    void* argument;
};

void* enterOnADirtyStack(void* data) {
    const Entry entry = *static_cast<Entry*>(data);
    dirtyTheStack();
    return entry.function(entry.argument);
}

TEST(OsThreadTest, BlocksNoOtherSignalWhateverItsStackHolds) {
    Entry entry = {};
    auto creation = pthreadCreateCall.replace([&](pthread_t* thread, const pthread_attr_t* block,
                                                  void* (*function)(void*), void* argument) {
        entry = {function, argument};
        return pthreadCreateCall.real(thread, block, enterOnADirtyStack, &entry);
    });
    sigset_t inside;
    Worker worker("worker", [&] { pthread_sigmask(SIG_SETMASK, nullptr, &inside); });
    worker.Start();
    worker.Wait();
    sigset_t expected;
    pthread_sigmask(SIG_SETMASK, nullptr, &expected);
    sigaddset(&expected, SIGTERM);
    for (int signal = 1; signal <= SIGRTMAX; signal++) {
        EXPECT_EQ(sigismember(&inside, signal), sigismember(&expected, signal)) << signal;
    }
}

TEST(OsThreadTest, ItsEntryReturnsItsArgument) {
    pthread_t handle = {};
    void* given = nullptr;
    auto creation =
        pthreadCreateCall.replace([&](pthread_t* thread, const pthread_attr_t* attributes,
                                      void* (*entry)(void*), void* argument) {
            given = argument;
            const int result = pthreadCreateCall.real(thread, attributes, entry, argument);
            handle = *thread;
            return result;
        });
    Worker worker("worker", [] {});
    worker.Start();
    worker.Wait();
    void* returned = nullptr;
    ASSERT_EQ(pthread_join(handle, &returned), 0);
    EXPECT_EQ(returned, given);
    EXPECT_EQ(returned, &worker);
}

// The restoring comes last, behind the signal that Run has returned.
TEST(OsThreadTest, IgnoresTheFirstRealTimeSignalWhileItRuns) {
    const std::thread::id self = std::this_thread::get_id();
    const int kMarker = SA_NODEFER;
    std::mutex mutex;
    std::vector<std::string> order;
    struct sigaction installed = {};
    struct sigaction restored = {};
    std::promise<void> done;
    const auto note = [&](const std::string& what) {
        std::lock_guard<std::mutex> lock(mutex);
        order.push_back(what);
    };
    auto record = sigactionCall.replace(
        [&](int signal, const struct sigaction* action, struct sigaction* previous) {
            // An earlier test's thread may still be on its way to its restoring.
            static thread_local bool installedHere = false;
            if (previous == nullptr && !installedHere) return 0;
            if (!installedHere) {
                char name[16] = {};
                prctl(PR_GET_NAME, name, 0, 0, 0);
                EXPECT_STRNE(name, "worker") << "it is named behind the first call";
            }
            installedHere = true;
            EXPECT_EQ(signal, 32);
            note(previous != nullptr ? "install" : "restore");
            if (previous == nullptr) {
                restored = *action;
                done.set_value();
                return 0;
            }
            installed = *action;
            *previous = {};
            previous->sa_flags = kMarker;
            return 0;
        });
    auto end = semPostCall.replace([&](sem_t* sem) {
        if (std::this_thread::get_id() != self) note("signal");
        return semPostCall.real(sem);
    });
    Worker worker("worker", [&] { note("run"); });
    worker.Start();
    worker.Wait();
    ASSERT_EQ(done.get_future().wait_for(std::chrono::seconds(10)), std::future_status::ready);
    EXPECT_EQ(order, (std::vector<std::string>{"install", "run", "signal", "restore"}));
    EXPECT_EQ(installed.sa_handler, SIG_IGN);
    EXPECT_EQ(installed.sa_flags, 0);
    EXPECT_EQ(sigismember(&installed.sa_mask, SIGTERM), 0);
    EXPECT_EQ(restored.sa_flags, kMarker);
}

TEST(OsThreadTest, WaitGivesTheSystemsResultAndMinusOneWithoutASignal) {
    Worker worker("idle", [] {});
    {
        auto interrupted = semWaitCall.replace([](sem_t*) { return -1; });
        EXPECT_EQ(worker.Wait(), -1);
    }
    auto& signal = worker.*memberOf(EndSignal{});
    auto* const kept = signal;
    signal = nullptr;
    EXPECT_EQ(worker.Wait(), -1);
    signal = kept;
}

TEST(OsThreadTest, DestructionGivesItsSignalAndItsAttributesBack) {
    int semaphores = 0;
    int attributes = 0;
    std::optional<Deletion> deletion;
    auto signals = semDestroyCall.replace([&](sem_t* sem) {
        EXPECT_EQ(attributes, 0) << "the signal goes first";
        semaphores++;
        return semDestroyCall.real(sem);
    });
    // Others destroy attributes, too: a sanitizer those that it asks for the stack with.
    std::atomic<const pthread_attr_t*> own{nullptr};
    auto creations = pthreadCreateCall.replace(
        [&](pthread_t* thread, const pthread_attr_t* block, void* (*entry)(void*), void* argument) {
            own = block;
            return pthreadCreateCall.real(thread, block, entry, argument);
        });
    auto blocks = pthreadAttrDestroyCall.replace([&](pthread_attr_t* block) {
        if (block == own) {
            EXPECT_FALSE(deletion && deletion->happened()) << "what is deleted is destroyed";
            attributes++;
        }
        return pthreadAttrDestroyCall.real(block);
    });
    {
        Worker idle("idle", [] {});
    }
    EXPECT_EQ(semaphores, 1);
    EXPECT_EQ(attributes, 0);
    {
        Worker worker("worker", [] {});
        worker.Start();
        worker.Wait();
        deletion.emplace(worker.*memberOf(Attributes{}));
    }
    EXPECT_EQ(semaphores, 2);
    EXPECT_EQ(attributes, 1);
}

TEST(OsThreadTest, IsJoinableWithDefaultAttributes) {
    int detachState = -1;
    size_t stackSize = 0;
    auto record = pthreadCreateCall.replace([&](pthread_t* thread, const pthread_attr_t* attributes,
                                                void* (*entry)(void*), void* argument) {
        pthread_attr_getdetachstate(attributes, &detachState);
        pthread_attr_getstacksize(attributes, &stackSize);
        return pthreadCreateCall.real(thread, attributes, entry, argument);
    });
    Worker worker("worker", [] {});
    worker.Start();
    worker.Wait();
    pthread_attr_t defaults;
    pthread_attr_init(&defaults);
    size_t defaultStackSize = 1;
    pthread_attr_getstacksize(&defaults, &defaultStackSize);
    pthread_attr_destroy(&defaults);
    EXPECT_EQ(detachState, PTHREAD_CREATE_JOINABLE);
    EXPECT_EQ(stackSize, defaultStackSize);
}

TEST(OsThreadTest, FailedAttributesArePrintedAndNothingIsStarted) {
    bool created = false;
    auto record =
        pthreadCreateCall.replace([&](pthread_t*, const pthread_attr_t*, void* (*)(void*), void*) {
            created = true;
            return 0;
        });
    CaptureStdout();
    {
        auto failure = pthreadAttrInitCall.replace([](pthread_attr_t* attributes) {
            pthreadAttrInitCall.real(attributes);
            return ENOMEM;
        });
        Worker worker("worker", [] { ADD_FAILURE() << "Run was called"; });
        worker.Start();
    }
    EXPECT_EQ(GetCapturedStdout(), "Error pthread_attr_init " + std::to_string(ENOMEM) + " \n");
    EXPECT_FALSE(created);
}

TEST(OsThreadTest, FailedCreationIsPrinted) {
    CaptureStdout();
    {
        auto failure = pthreadCreateCall.replace(
            [](pthread_t*, const pthread_attr_t*, void* (*)(void*), void*) { return EAGAIN; });
        Worker worker("worker", [] { ADD_FAILURE() << "Run was called"; });
        worker.Start();
    }
    EXPECT_EQ(GetCapturedStdout(), "Error pthread_create " + std::to_string(EAGAIN) + " \n");
}

TEST(OsThreadTest, PrintsNothingWhenAllGoesWell) {
    CaptureStdout();
    {
        Worker worker("worker", [] {});
        worker.Start();
        EXPECT_EQ(worker.Wait(), 0);
    }
    EXPECT_EQ(GetCapturedStdout(), "");
}

TEST(OsThreadTest, DeletesWhatItMade) {
    auto* worker = new Worker("worker", [] {});
    worker->Start();
    EXPECT_EQ(worker->Wait(), 0);
    const Deletion endSignal(worker->*memberOf(EndSignal{}));
    const Deletion attributes(worker->*memberOf(Attributes{}));
    delete worker;
    EXPECT_TRUE(endSignal.happened());
    EXPECT_TRUE(attributes.happened());
}

class ThreadSleepTest : public testing::TestWithParam<int> {};

TEST_P(ThreadSleepTest, SleepsOnceEvenWhenItIsInterrupted) {
    const int ms = GetParam();
    std::vector<timespec> sleeps;
    auto record = nanosleepCall.replace([&](const timespec* duration, timespec* rest) {
        sleeps.push_back(*duration);
        if (rest != nullptr) *rest = *duration;
        errno = EINTR;
        return -1;
    });
    os::Thread::sleep(ms);
    ASSERT_EQ(sleeps.size(), 1u);
    EXPECT_EQ(sleeps[0].tv_sec, ms / 1000);
    EXPECT_EQ(sleeps[0].tv_nsec, ms % 1000 * 1000000);
}

INSTANTIATE_TEST_SUITE_P(Milliseconds, ThreadSleepTest,
                         testing::Values(0, 1, 50, 999, 1000, 3600999));

}  // namespace
}  // namespace orvtest
