// SPDX-License-Identifier: Apache-2.0
#include "DispatcherFixture.h"

#include <chrono>

#include "PrivateMember.h"

namespace orvtest {

ORV_OPEN_MEMBER(DispatcherMutex, ORV::SyncToAsync, m_mutex);
ORV_OPEN_MEMBER(DispatcherActions, ORV::SyncToAsync, m_actions);
ORV_OPEN_MEMBER(DispatcherHandlers, ORV::SyncToAsync, m_handlers);

DispatcherFixture::DispatcherFixture()
    : dispatcher(ORV::SyncToAsync::getInstance()),
      mNoSleep(nanosleepCall, [this](const timespec* duration, timespec*) {
          if (duringPause) duringPause();
          std::lock_guard<std::mutex> lock(mPausesMutex);
          mPauses.push_back(*duration);
          mPaused.notify_all();
          return 0;
      }) {}

void DispatcherFixture::SetUp() {
    JniFixture::SetUp();
    log.clear();
}

os::Mutex& DispatcherFixture::dispatcherMutex() { return dispatcher->*memberOf(DispatcherMutex{}); }

size_t DispatcherFixture::handlers() {
    const Hold held = hold();
    return (dispatcher->*memberOf(DispatcherHandlers{})).size();
}

size_t DispatcherFixture::pending() {
    const Hold held = hold();
    return actions().size();
}

std::list<ORV::SyncToAsyncAction*>& DispatcherFixture::actions() {
    return dispatcher->*memberOf(DispatcherActions{});
}

void DispatcherFixture::addHandler(const Service& service, const std::string& name) {
    JNIEnv* env = vm.env();
    dispatcher->addMsgHandler(service, new ORV::MsgDispatcher(env, vm.local(player), string(name)));
}

ORV::SyncToAsyncAction* DispatcherFixture::action(const Service& service, int msg) {
    auto* action = new ORV::SyncToAsyncAction;
    action->payload = new NotifyMessage{msg, 0, 0, nullptr};
    action->service = service;
    action->valid = true;
    return action;
}

void DispatcherFixture::settle() {
    const Hold held = hold();
    (void)held;
}

void DispatcherFixture::waitFor(const ExpectedLine& line, size_t count) {
    EXPECT_TRUE(log.waitFor(line, count)) << testing::PrintToString(line) << " did not come";
    settle();
}

void DispatcherFixture::waitForPauses(size_t count) {
    {
        std::unique_lock<std::mutex> lock(mPausesMutex);
        EXPECT_TRUE(mPaused.wait_for(lock, std::chrono::seconds(10),
                                     [&] { return mPauses.size() >= count; }))
            << mPauses.size() << " pauses instead of " << count;
    }
    settle();
}

std::vector<timespec> DispatcherFixture::pauses() {
    std::lock_guard<std::mutex> lock(mPausesMutex);
    return mPauses;
}

std::vector<std::string> DispatcherFixture::posted() {
    std::vector<std::string> events;
    for (const fakejni::JavaCall& call : vm.javaCalls()) {
        EXPECT_EQ(call.method, "postEventFromNative");
        events.push_back(fakejni::toString(call.args.at(0)) + " " +
                         std::to_string(call.args.at(1).integer));
    }
    return events;
}

ExpectedLine dispatcherInfo(const std::string& text) {
    return info(text).tagged("ORV::SyncToAsync");
}
ExpectedLine dispatcherError(const std::string& text) {
    return error(text).tagged("ORV::SyncToAsync");
}

}  // namespace orvtest
