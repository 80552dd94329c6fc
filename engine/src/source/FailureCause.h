// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/Errors.h>

#include <atomic>
#include <functional>
#include <memory>
#include <string>
#include <thread>

#include "source/MediaSource.h"

namespace orvtarn {

// Finds out why media did not open, beyond what mpv reports: asks their server,
// or looks at their first bytes. Works on a thread of its own, for some seconds
// at most. One thread uses it.
class FailureCause {
public:
    ~FailureCause() { stop(); }

    // Whether there is more to find out about that status.
    static bool isVague(android::status_t status);

    // Passes the cause to done, on the other thread. Gives up the search before.
    // address: what mpv was opening, which may be an entry of the source's
    // playlist.
    void find(std::shared_ptr<MediaSource> source, std::string address, android::status_t status,
              std::function<void(android::status_t)> done);
    // Ends the search and waits for its thread.
    void stop();

private:
    std::atomic<bool> mCancelled{false};
    std::atomic<bool> mSearching{false};
    std::shared_ptr<MediaSource> mSource;  // what is searched
    std::thread mThread;
};

}  // namespace orvtarn
