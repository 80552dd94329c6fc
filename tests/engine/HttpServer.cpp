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

HttpServer::HttpServer(const std::string& path) {
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

void HttpServer::answer(int connection) {
    const std::string request = readRequest(connection);
    {
        std::lock_guard<std::mutex> lock(mMutex);
        mRequests.push_back(request);
    }
    if (mSilent) return;
    const size_t range = request.find("Range: bytes=");
    const int64_t first = range == std::string::npos ? 0 : atoll(request.c_str() + range + 13);
    if (mStatus == 200 && first < mBreakAt) {
        sendRange(connection, first);
    } else if (mStatus != 200) {
        const std::string head =
            "HTTP/1.1 " + std::to_string(mStatus) + " No\r\nContent-Length: 0\r\n\r\n";
        sendAll(connection, head.data(), head.size());
    }
    shutdown(connection, SHUT_RDWR);
}

void HttpServer::sendRange(int connection, int64_t first) {
    const auto size = static_cast<int64_t>(mContent.size());
    first = std::min(first, size);
    const std::string head =
        "HTTP/1.1 206 Partial Content\r\nAccept-Ranges: bytes\r\nContent-Range: bytes " +
        std::to_string(first) + "-" + std::to_string(size - 1) + "/" + std::to_string(size) +
        "\r\nContent-Length: " + std::to_string(size - first) + "\r\n\r\n";
    if (!sendAll(connection, head.data(), head.size())) return;
    const int64_t end = std::min<int64_t>(size, mBreakAt);
    sendAll(connection, mContent.data() + first, static_cast<size_t>(end - first));
}

}  // namespace orvtest
