// SPDX-License-Identifier: Apache-2.0
#include "source/FailureCause.h"

#include <orvtarn/PlayerTypes.h>

#include <chrono>
#include <utility>
#include <vector>

#include "base/ThreadName.h"
#include "source/FormatCheck.h"
#include "source/ServerCheck.h"
#include "source/UrlScheme.h"

namespace orvtarn {
namespace {

constexpr std::chrono::milliseconds kCancelInterval{10};

android::status_t causeOf(MediaSource& source, const std::string& address, android::status_t status,
                          const std::atomic<bool>& cancelled) {
    if (!isOpenedScheme(schemeOf(address))) {
        return status == ORV_ERROR_MALFORMED ? checkFormat(source) : status;
    }
    std::vector<uint8_t> sample;
    const android::status_t answer = checkServer(address, source.headers(), cancelled, sample);
    if (answer != android::NO_ERROR) return answer;
    // It gives the media now: what was lost was the connection.
    return status == ORV_ERROR_MALFORMED ? checkFormat(std::move(sample))
                                         : ORV_ERROR_CONNECTION_LOST;
}

}  // namespace

bool FailureCause::isVague(android::status_t status) {
    return status == ORV_ERROR_IO || status == ORV_ERROR_MALFORMED;
}

void FailureCause::find(std::shared_ptr<MediaSource> source, std::string address,
                        android::status_t status, std::function<void(android::status_t)> done) {
    stop();
    mCancelled = false;
    mSearching = true;
    mSource = std::move(source);
    mThread = std::thread([this, address = std::move(address), status, done = std::move(done)] {
        nameThisThread("orv-cause");
        const android::status_t cause = causeOf(*mSource, address, status, mCancelled);
        mSearching = false;
        if (!mCancelled) done(cause);
    });
}

void FailureCause::stop() {
    if (!mThread.joinable()) return;
    mCancelled = true;
    while (mSearching) {
        // A read that is just about to block misses the word.
        mSource->cancelReads();
        std::this_thread::sleep_for(kCancelInterval);
    }
    mThread.join();
    mSource.reset();
}

}  // namespace orvtarn
