// SPDX-License-Identifier: Apache-2.0
#include "OtherThread.h"

#include <unistd.h>

#include <chrono>
#include <fstream>
#include <string>
#include <thread>
#include <utility>

namespace orvtest {
namespace {

// What tells one sleep from another: the state, and how often the thread has given its
// processor away. Empty unless it sleeps.
std::string sleepOf(int thread) {
    std::ifstream status("/proc/self/task/" + std::to_string(thread) + "/status");
    bool sleeps = false;
    for (std::string line; std::getline(status, line);) {
        if (line.rfind("State:", 0) == 0) sleeps = line.find("S (sleeping)") != std::string::npos;
        if (sleeps && line.rfind("voluntary_ctxt_switches:", 0) == 0) return line;
    }
    return "";
}

}  // namespace

OtherThread::OtherThread(std::function<void()> operation)
    : mEnd(std::async(std::launch::async, [this, run = std::move(operation)] {
          mThread = gettid();
          run();
      })) {}

bool OtherThread::hasEnded() const {
    return mEnd.wait_for(std::chrono::seconds(0)) == std::future_status::ready;
}

// A sleep that goes on is not that of a lock that is held for a moment.
bool OtherThread::isAsleep() {
    constexpr int kLooks = 50;
    std::string sleep;
    for (int looks = 0; looks < kLooks;) {
        if (hasEnded()) return false;
        const std::string now = mThread == 0 ? "" : sleepOf(mThread);
        looks = !now.empty() && now == sleep ? looks + 1 : 0;
        sleep = now;
        std::this_thread::yield();
    }
    return true;
}

}  // namespace orvtest
