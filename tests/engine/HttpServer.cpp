// SPDX-License-Identifier: Apache-2.0
#include "HttpServer.h"

#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <poll.h>
#include <stdlib.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <fstream>
#include <iterator>

namespace orvtest {
namespace {

std::string readRequest(int connection) {
    std::string request;
    char buffer[2048];
    while (request.find("\r\n\r\n") == std::string::npos) {
        const ssize_t count = recv(connection, buffer, sizeof(buffer), 0);
        if (count <= 0) return "";
        request.append(buffer, static_cast<size_t>(count));
    }
    return request;
}

bool sendAll(int connection, const char* data, size_t length) {
    while (length > 0) {
        const ssize_t count = send(connection, data, length, MSG_NOSIGNAL);
        if (count <= 0) return false;
        data += count;
        length -= static_cast<size_t>(count);
    }
    return true;
}

}  // namespace

HttpServer::HttpServer(const std::string& path, const HttpFaults& faults) : mFaults(faults) {
    std::ifstream file(path, std::ios::binary);
    mContent.assign(std::istreambuf_iterator<char>(file), {});
    mListener = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address = {};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof(address);
    if (bind(mListener, reinterpret_cast<sockaddr*>(&address), length) != 0 ||
        listen(mListener, 16) != 0) {
        ADD_FAILURE() << "no port to serve on";
    }
    getsockname(mListener, reinterpret_cast<sockaddr*>(&address), &length);
    mPort = ntohs(address.sin_port);
    mAcceptor = std::thread([this] { serve(); });
}

HttpServer::~HttpServer() {
    mQuit = true;
    mAcceptor.join();
    {
        std::lock_guard<std::mutex> lock(mMutex);
        for (int connection : mConnections) shutdown(connection, SHUT_RDWR);
    }
    for (std::thread& thread : mThreads) thread.join();
    for (int connection : mConnections) close(connection);
    close(mListener);
}

std::string HttpServer::url(const std::string& name) const {
    return "http://127.0.0.1:" + std::to_string(mPort) + "/" + name;
}

std::vector<std::string> HttpServer::requests() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mRequests;
}

void HttpServer::serve() {
    while (!mQuit) {
        pollfd waiting = {mListener, POLLIN, 0};
        if (poll(&waiting, 1, 20) <= 0) continue;
        const int connection = accept(mListener, nullptr, nullptr);
        if (connection < 0) continue;
        std::lock_guard<std::mutex> lock(mMutex);
        mConnections.push_back(connection);
        mThreads.emplace_back([this, connection] { answer(connection); });
    }
}

void HttpServer::setFaults(const HttpFaults& faults) {
    std::lock_guard<std::mutex> lock(mMutex);
    mFaults = faults;
}

void HttpServer::addText(const std::string& name, const std::string& text) {
    std::lock_guard<std::mutex> lock(mMutex);
    mTexts[name] = text;
}

void HttpServer::setStatus(int status) {
    std::lock_guard<std::mutex> lock(mMutex);
    mFaults.status = status;
}

void HttpServer::breakAt(int64_t position) {
    std::lock_guard<std::mutex> lock(mMutex);
    mFaults.breakAt = position;
}

void HttpServer::setSilent(bool silent) {
    std::lock_guard<std::mutex> lock(mMutex);
    mFaults.stallAt = silent ? -1 : INT64_MAX;
}

// The text of the name that the request is for, or the file.
std::string HttpServer::contentOf(const std::string& request) const {
    std::lock_guard<std::mutex> lock(mMutex);
    const size_t begin = request.find('/') + 1;
    const auto text = mTexts.find(request.substr(begin, request.find(' ', begin) - begin));
    return text != mTexts.end() ? text->second : mContent;
}

void HttpServer::answer(int connection) {
    const std::string request = readRequest(connection);
    HttpFaults faults;
    {
        std::lock_guard<std::mutex> lock(mMutex);
        mRequests.push_back(request);
        faults = mFaults;
        if (mRequests.size() > static_cast<size_t>(faults.expireAfter)) faults.status = 403;
    }
    if (faults.stallAt < 0) return;
    if (!faults.shuts) answer(connection, request, faults);
    // A connection that has fallen silent stays open.
    if (faults.stallAt == INT64_MAX) shutdown(connection, SHUT_RDWR);
}

void HttpServer::answer(int connection, const std::string& request, const HttpFaults& faults) {
    const bool lacksHeader = request.find(faults.wantsHeader) == std::string::npos;
    const bool lacksCookie =
        faults.wantsCookie && request.find("Cookie: ticket=1") == std::string::npos;
    const bool first = request.find("/again") == std::string::npos;
    std::string head;
    if (faults.status != 200 || lacksHeader || (lacksCookie && !first)) {
        head = std::to_string(faults.status != 200 ? faults.status : 403) + " No";
    } else if (faults.onlyTexts && contentOf(request) == mContent) {
        head = "404 No";
    } else if (!faults.redirect.empty()) {
        head = "302 Found\r\nLocation: " + faults.redirect;
    } else if (lacksCookie) {
        head = "302 Found\r\nSet-Cookie: ticket=1; path=/\r\nLocation: " + url("again");
    } else {
        return sendFile(connection, request, faults);
    }
    // As most servers, with words for people.
    const std::string words = "<p>See elsewhere.</p>";
    head = "HTTP/1.1 " + head + "\r\nContent-Length: " + std::to_string(words.size()) + "\r\n\r\n";
    sendAll(connection, (head + words).data(), head.size() + words.size());
}

void HttpServer::sendFile(int connection, const std::string& request, const HttpFaults& faults) {
    const std::string content = contentOf(request);
    const size_t range = request.find("Range: bytes=");
    const bool hasRange = faults.ranges && range != std::string::npos;
    const auto asked = hasRange ? atoll(request.c_str() + range + 13) : 0;
    const int64_t size = static_cast<int64_t>(content.size()) + faults.extraLength;
    if (asked >= faults.breakAt) return;
    std::string head = "HTTP/1.1 200 OK\r\n";
    if (hasRange) {
        head = "HTTP/1.1 206 Partial Content\r\nContent-Range: bytes " + std::to_string(asked) +
               "-" + std::to_string(size - 1) + "/" + std::to_string(size) + "\r\n";
    }
    if (faults.ranges) head += "Accept-Ranges: bytes\r\n";
    if (faults.tellsLength) head += "Content-Length: " + std::to_string(size - asked) + "\r\n";
    head += "Connection: close\r\n\r\n";
    if (!sendAll(connection, head.data(), head.size())) return;
    sendBody(connection, content, static_cast<size_t>(asked), faults);
}

void HttpServer::sendBody(int connection, const std::string& body, size_t first,
                          const HttpFaults& faults) {
    constexpr int kDripsPerSecond = 20;
    const auto end = static_cast<size_t>(
        std::min({static_cast<int64_t>(body.size()), faults.breakAt, faults.stallAt}));
    const size_t drip = faults.bytesPerSecond > 0
                            ? static_cast<size_t>(faults.bytesPerSecond / kDripsPerSecond)
                            : body.size();
    while (first < end && !mQuit) {
        const size_t count = std::min(drip, end - first);
        if (!sendAll(connection, body.data() + first, count)) return;
        first += count;
        if (faults.bytesPerSecond > 0) usleep(1000000 / kDripsPerSecond);
    }
}

}  // namespace orvtest
