// SPDX-License-Identifier: Apache-2.0
#include "source/ServerCheck.h"

#include <curl/curl.h>
#include <orvtarn/PlayerTypes.h>
#include <stdint.h>

#include <algorithm>
#include <chrono>
#include <memory>
#include <mutex>
#include <utility>

#include "source/TlsSettings.h"
#include "source/UrlScheme.h"

namespace orvtarn {
namespace {

using android::status_t;

using Clock = std::chrono::steady_clock;

constexpr long kLimitMs = 5000;
constexpr size_t kAnswerSample = 64 * 1024;
// Between two bytes of an answer that goes on.
constexpr std::chrono::seconds kPause{2};
constexpr long kLargestRedirection = 8;  // as libavformat
constexpr int kPollMs = 50;
constexpr long kFirstFailure = 400;

struct EasyDeleter {
    void operator()(CURL* handle) const { curl_easy_cleanup(handle); }
};
struct MultiDeleter {
    void operator()(CURLM* handle) const { curl_multi_cleanup(handle); }
};
struct ListDeleter {
    void operator()(curl_slist* list) const { curl_slist_free_all(list); }
};
using Easy = std::unique_ptr<CURL, EasyDeleter>;
using Multi = std::unique_ptr<CURLM, MultiDeleter>;
using HeaderList = std::unique_ptr<curl_slist, ListDeleter>;

// The first bytes of an answer are enough.
struct Sample {
    std::vector<uint8_t> bytes;
    Clock::time_point newest = Clock::now();

    bool isFull() const { return bytes.size() >= kAnswerSample; }
    bool isFlowing() const { return Clock::now() - newest < kPause; }
};

size_t take(char* data, size_t, size_t length, void* context) {
    auto* sample = static_cast<Sample*>(context);
    const size_t count = std::min(length, kAnswerSample - sample->bytes.size());
    sample->bytes.insert(sample->bytes.end(), data, data + count);
    sample->newest = Clock::now();
    return sample->isFull() ? 0 : length;
}

bool isTransferred(const std::string& scheme) {
    return scheme == "http" || scheme == "https" || scheme == "ftp" || scheme == "ftps";
}

// The port of servers that curl only connects to; 0 for those without
// connections.
long usualPort(const std::string& scheme) {
    if (scheme == "rtsp" || scheme == "rtsps") return 554;
    if (scheme == "smb") return 445;
    if (scheme == "mmsh" || scheme == "mmshttp") return 80;
    if (scheme == "mms" || scheme == "mmst") return 1755;
    if (scheme == "rtmps" || scheme == "rtmpts") return 443;
    if (scheme.compare(0, 4, "rtmp") == 0) return 1935;
    return 0;
}

HeaderList headerList(const RequestHeaders& headers) {
    curl_slist* list = nullptr;
    for (const auto& [name, value] : headers) {
        // With nothing after the colon curl would leave the header out.
        const std::string line = value.empty() ? name + ";" : name + ": " + value;
        curl_slist* longer = curl_slist_append(list, line.c_str());
        if (longer != nullptr) list = longer;
    }
    return HeaderList(list);
}

void setAddress(CURL* easy, const std::string& url) {
    const std::string scheme = schemeOf(url);
    if (isTransferred(scheme)) {
        curl_easy_setopt(easy, CURLOPT_URL, url.c_str());
        return;
    }
    const std::string place = url.substr(scheme.size());
    const std::string host = place.substr(0, place.find('/', sizeof("://") - 1));
    curl_easy_setopt(easy, CURLOPT_URL, ("http" + host).c_str());
    // A port in the URL goes first.
    const bool namesPort = host.find(':', sizeof("://") - 1) != std::string::npos;
    if (!namesPort) curl_easy_setopt(easy, CURLOPT_PORT, usualPort(scheme));
    curl_easy_setopt(easy, CURLOPT_CONNECT_ONLY, 1L);
}

void setLimits(CURL* easy) {
    curl_easy_setopt(easy, CURLOPT_NOSIGNAL, 1L);
    // Does not wait for a name that is still being looked up.
    curl_easy_setopt(easy, CURLOPT_QUICK_EXIT, 1L);
    curl_easy_setopt(easy, CURLOPT_TIMEOUT_MS, kLimitMs);
    curl_easy_setopt(easy, CURLOPT_FOLLOWLOCATION, 1L);
    curl_easy_setopt(easy, CURLOPT_MAXREDIRS, kLargestRedirection);
    // A server may close a connection that it redirects on without a word.
    curl_easy_setopt(easy, CURLOPT_FORBID_REUSE, 1L);
    curl_easy_setopt(easy, CURLOPT_PROTOCOLS_STR, "http,https,ftp,ftps");
    curl_easy_setopt(easy, CURLOPT_REDIR_PROTOCOLS_STR, "http,https");
    curl_easy_setopt(easy, CURLOPT_USERAGENT, "orvtarn");  // unless the headers have one
    curl_easy_setopt(easy, CURLOPT_COOKIEFILE, "");        // cookies, but from no file
}

void setTrust(CURL* easy) {
    const long verifies = verifiesCertificates() ? 1 : 0;
    curl_easy_setopt(easy, CURLOPT_SSL_VERIFYPEER, verifies);
    curl_easy_setopt(easy, CURLOPT_SSL_VERIFYHOST, 2 * verifies);
    const std::string file = certificateFile();
    if (!file.empty()) curl_easy_setopt(easy, CURLOPT_CAINFO, file.c_str());
}

status_t statusOf(CURLcode code, long httpStatus, const Sample& sample) {
    if (httpStatus >= kFirstFailure) return ORV_ERROR_HTTP - static_cast<status_t>(httpStatus);
    // The sample is of the last answer, which is words for people.
    if (code == CURLE_TOO_MANY_REDIRECTS) return ORV_ERROR_REDIRECTS;
    if (sample.isFull() || (!sample.bytes.empty() && sample.isFlowing())) {
        return android::NO_ERROR;
    }
    switch (code) {
        case CURLE_OK:
            return android::NO_ERROR;
        case CURLE_COULDNT_RESOLVE_HOST:
        case CURLE_URL_MALFORMAT:
            return ORV_ERROR_UNKNOWN_HOST;
        case CURLE_COULDNT_CONNECT:
            return ORV_ERROR_CANNOT_CONNECT;
        case CURLE_OPERATION_TIMEDOUT:
            return ORV_ERROR_NO_ANSWER;
        case CURLE_UNSUPPORTED_PROTOCOL:  // where a redirect leads to
            return ORV_ERROR_LOCAL_REFERENCE;
        case CURLE_PEER_FAILED_VERIFICATION:
        case CURLE_SSL_ISSUER_ERROR:
            return ORV_ERROR_CERTIFICATE;
        case CURLE_SSL_CONNECT_ERROR:
        case CURLE_GOT_NOTHING:
        case CURLE_PARTIAL_FILE:
        case CURLE_RECV_ERROR:
        case CURLE_SEND_ERROR:
            return ORV_ERROR_CONNECTION_LOST;
        case CURLE_REMOTE_FILE_NOT_FOUND:
            return ORV_ERROR_HTTP - 404;
        case CURLE_LOGIN_DENIED:
            return ORV_ERROR_HTTP - 401;
        default:
            return ORV_ERROR_IO;
    }
}

// False when it was cancelled.
bool perform(CURLM* multi, const std::atomic<bool>& cancelled, CURLcode& code) {
    int running = 1;
    while (!cancelled) {
        if (curl_multi_perform(multi, &running) != CURLM_OK) return false;
        int left = 0;
        const CURLMsg* message = curl_multi_info_read(multi, &left);
        if (message != nullptr && message->msg == CURLMSG_DONE) {
            code = message->data.result;
            return true;
        }
        curl_multi_poll(multi, nullptr, 0, kPollMs, nullptr);
    }
    return false;
}

}  // namespace

status_t checkServer(const std::string& url, const RequestHeaders& headers,
                     const std::atomic<bool>& cancelled, std::vector<uint8_t>& sample) {
    static std::once_flag initialized;
    std::call_once(initialized, [] { curl_global_init(CURL_GLOBAL_DEFAULT); });
    const std::string scheme = schemeOf(url);
    if (!isTransferred(scheme) && usualPort(scheme) == 0) return ORV_ERROR_IO;
    const HeaderList list = headerList(headers);
    const Easy easy(curl_easy_init());
    const Multi multi(curl_multi_init());
    if (easy == nullptr || multi == nullptr) return ORV_ERROR_IO;
    Sample taken;
    setAddress(easy.get(), url);
    setLimits(easy.get());
    setTrust(easy.get());
    curl_easy_setopt(easy.get(), CURLOPT_HTTPHEADER, list.get());
    curl_easy_setopt(easy.get(), CURLOPT_WRITEFUNCTION, take);
    curl_easy_setopt(easy.get(), CURLOPT_WRITEDATA, &taken);
    curl_multi_add_handle(multi.get(), easy.get());
    CURLcode code = CURLE_OK;
    const bool done = perform(multi.get(), cancelled, code);
    long httpStatus = 0;
    if (isTransferred(scheme) && scheme[0] == 'h') {
        curl_easy_getinfo(easy.get(), CURLINFO_RESPONSE_CODE, &httpStatus);
    }
    curl_multi_remove_handle(multi.get(), easy.get());
    if (!done) return ORV_ERROR_IO;
    const status_t status = statusOf(code, httpStatus, taken);
    // Of the others only the connection was tried.
    if (!isTransferred(scheme) && status == android::NO_ERROR) return ORV_ERROR_IO;
    sample = std::move(taken.bytes);
    return status;
}

}  // namespace orvtarn
