// SPDX-License-Identifier: Apache-2.0
// What a server answers, as it is asked again when media did not open for a reason that
// the lines of the media library do not say.
#include <gtest/gtest.h>
#include <orvtarn/PlayerTypes.h>

#include <atomic>

#include "HttpServer.h"
#include "TestMedia.h"
#include "source/ServerCheck.h"

namespace orvtest {
namespace {

android::status_t check(const std::string& url) {
    const std::atomic<bool> cancelled{false};
    std::vector<uint8_t> sample;
    return orvtarn::checkServer(url, {}, cancelled, sample);
}

TEST(ServerCheckTest, ARedirectLoopIsCalledOneWhateverItsAnswersSay) {
    HttpServer server(mediaPath("short.mp4"));
    HttpFaults faults;
    faults.redirect = server.url("round");
    server.setFaults(faults);
    EXPECT_EQ(ORV_ERROR_REDIRECTS, check(server.url()));
}

TEST(ServerCheckTest, ARedirectIsFollowed) {
    HttpServer other(mediaPath("short.mp4"));
    HttpServer server(mediaPath("short.mp4"));
    HttpFaults faults;
    faults.redirect = other.url();
    server.setFaults(faults);
    EXPECT_EQ(android::NO_ERROR, check(server.url()));
}

}  // namespace
}  // namespace orvtest
