// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <dispatch/SyncToAsync.h>

#include <condition_variable>
#include <functional>
#include <list>
#include <mutex>
#include <string>
#include <vector>

#include "JniFixture.h"
#include "PosixCalls.h"

namespace orvtest {

// The process's dispatcher with posters into a fake virtual machine. Its
// pauses are counted and not waited for.
class DispatcherFixture : public JniFixture {
protected:
    using Service = android::sp<android::OrvMediaService>;

    DispatcherFixture();
    void SetUp() override;

    // Registers a poster whose events carry that name to Java.
    void addHandler(const Service& service, const std::string& name);
    // An action of that service with the event (msg, 0, 0).
    ORV::SyncToAsyncAction* action(const Service& service, int msg);

    // While it lives, the worker takes no action further than out of the queue.
    class Hold {
    public:
        explicit Hold(os::Mutex& mutex) : mScope(mutex) {}

    private:
        os::ScopedMutex mScope;
    };
    Hold hold() { return Hold(dispatcherMutex()); }
    os::Mutex& dispatcherMutex();
    // How many actions were added and not yet deleted.
    size_t pending();
    // Those actions, for who holds the mutex.
    std::list<ORV::SyncToAsyncAction*>& actions();
    // How many services have a poster.
    size_t handlers();

    // Waits until that line was logged so often and the worker is done with
    // the action that it was about.
    void waitFor(const ExpectedLine& line, size_t count = 1);
    // The same for so many pauses.
    void waitForPauses(size_t count);
    std::vector<timespec> pauses();

    // The names and events that reached Java: "name msg".
    std::vector<std::string> posted();
    std::vector<LogLine> dispatcherLines() const { return log.lines("ORV::SyncToAsync"); }

    ORV::SyncToAsync* dispatcher;
    // Runs inside each pause, on the worker's thread.
    std::function<void()> duringPause;

private:
    // Returns when the worker has let go of the dispatcher's mutex.
    void settle();

    std::mutex mPausesMutex;
    std::condition_variable mPaused;
    std::vector<timespec> mPauses;
    PosixCall<int(const timespec*, timespec*)>::Replacement mNoSleep;
};

ExpectedLine dispatcherInfo(const std::string& text);
ExpectedLine dispatcherError(const std::string& text);

}  // namespace orvtest
