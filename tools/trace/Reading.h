// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <signal.h>

#include <chrono>
#include <functional>
#include <string>
#include <vector>

#include "LineReader.h"
#include "Session.h"

namespace orvtrace {

// Reads logs from files, pipes and standard input into a session.
class Reading {
public:
    // It ends early once stop is set.
    Reading(Session& session, const volatile sig_atomic_t& stop);

    // Has the last log followed while it grows, and refresh called about once a second.
    // A file that is replaced, or begins anew, is read from its beginning.
    void follow(std::function<void()> refresh);
    // Blocks until the end of the logs, or of the program that writes a pipe. Throws a
    // Failure if one cannot be read. False if it was stopped.
    bool read(const std::vector<std::string>& logs);

private:
    class File;

    bool readLog(const std::string& path, bool follows);
    void refreshIfDue();

    Session& mSession;
    const volatile sig_atomic_t& mStop;
    std::function<void()> mRefresh;
    std::chrono::steady_clock::time_point mRefreshed;
};

}  // namespace orvtrace
