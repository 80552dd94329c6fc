// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <atomic>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace orvtest {

// Serves one file on a port of this machine, to one client after another and
// to several at once, with ranges.
class HttpServer {
public:
    explicit HttpServer(const std::string& path);
    ~HttpServer();

    std::string url(const std::string& name = "media") const;

    // Answers every request with that status and nothing more.
    void setStatus(int status) { mStatus = status; }
    // Breaks connections off at that byte of the file, and takes no new ones
    // behind it.
    void breakAt(int64_t position) { mBreakAt = position; }
    // Takes requests but never answers them.
    void setSilent(bool silent) { mSilent = silent; }

    // The requests so far, each with its header lines.
    std::vector<std::string> requests() const;

private:
    void serve();
    void answer(int connection);
    void sendRange(int connection, int64_t first);

    std::string mContent;
    int mListener = -1;
    int mPort = 0;
    std::atomic<int> mStatus{200};
    std::atomic<int64_t> mBreakAt{INT64_MAX};
    std::atomic<bool> mSilent{false};
    std::atomic<bool> mQuit{false};
    mutable std::mutex mMutex;
    std::vector<std::string> mRequests;
    std::vector<int> mConnections;
    std::vector<std::thread> mThreads;
    std::thread mAcceptor;
};

}  // namespace orvtest
