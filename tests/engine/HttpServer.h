// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <atomic>
#include <map>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace orvtest {

// What is wrong with a server. As it is at first, nothing is.
struct HttpFaults {
    int status = 200;              // of every answer; 206 where a range is asked for
    bool ranges = true;            // knows ranges
    bool tellsLength = true;       // sends Content-Length
    int64_t extraLength = 0;       // announced beyond what there is
    int64_t breakAt = INT64_MAX;   // the byte of the file at which connections break
    int64_t stallAt = INT64_MAX;   // that at which they fall silent; -1: before the head
    int expireAfter = INT32_MAX;   // requests that are answered; later ones get 403
    bool onlyTexts = false;        // has no file
    bool shuts = false;            // closes each connection without an answer
    bool wantsCookie = false;      // sets a cookie by a redirect, and refuses who lacks it
    std::string wantsHeader = {};  // a header line that every request must have
    std::string redirect = {};     // where every request is sent to
    int64_t bytesPerSecond = 0;    // 0: as many as go
};

// Serves one file on a port of this machine, to one client after another and
// to several at once, and further texts by their names.
class HttpServer {
public:
    explicit HttpServer(const std::string& path, const HttpFaults& faults = {});
    ~HttpServer();

    std::string url(const std::string& name = "media") const;

    // From now on.
    void setFaults(const HttpFaults& faults);
    // Answers requests for that name with a text in place of the file.
    void addText(const std::string& name, const std::string& text);

    // Answers every request with that status and nothing more.
    void setStatus(int status);
    // Breaks connections off at that byte of the file, and takes no new ones
    // behind it.
    void breakAt(int64_t position);
    // Takes requests but never answers them.
    void setSilent(bool silent);

    // The requests so far, each with its header lines.
    std::vector<std::string> requests() const;

private:
    void serve();
    void answer(int connection);
    void answer(int connection, const std::string& request, const HttpFaults& faults);
    void sendFile(int connection, const std::string& request, const HttpFaults& faults);
    void sendBody(int connection, const std::string& body, size_t first, const HttpFaults& faults);
    std::string contentOf(const std::string& request) const;

    std::string mContent;
    int mListener = -1;
    int mPort = 0;
    std::atomic<bool> mQuit{false};
    mutable std::mutex mMutex;
    HttpFaults mFaults;
    std::map<std::string, std::string> mTexts;
    std::vector<std::string> mRequests;
    std::vector<int> mConnections;
    std::vector<std::thread> mThreads;
    std::thread mAcceptor;
};

}  // namespace orvtest
