// SPDX-License-Identifier: Apache-2.0
#include "KitTest.h"

#include <stdlib.h>

#include <chrono>
#include <thread>

namespace orvkit {
namespace {

constexpr auto kPatience = std::chrono::seconds(30);
constexpr auto kBetweenLooks = std::chrono::milliseconds(2);
constexpr int kLooks = 100;
constexpr int kShortestFilmMs = 8000;

std::string environment(const char* name) {
    const char* value = getenv(name);
    return value == nullptr ? "" : value;
}

bool isUnplayable(android::status_t status) {
    return status == ORV_ERROR_UNSUPPORTED || status == ORV_ERROR_MALFORMED;
}

}  // namespace

bool eventually(const std::function<bool()>& condition) {
    const auto deadline = std::chrono::steady_clock::now() + kPatience;
    while (!condition()) {
        if (std::chrono::steady_clock::now() > deadline) return false;
        std::this_thread::sleep_for(kBetweenLooks);
    }
    return true;
}

bool remains(const std::function<bool()>& condition) {
    for (int look = 0; look < kLooks; look++) {
        if (!condition()) return false;
        std::this_thread::sleep_for(kBetweenLooks);
    }
    return true;
}

KitTest::KitTest() { player->setNotifyCallback(events); }

KitTest::~KitTest() { player->release(); }

void KitTest::checks(const char* operation, const char* words) {
    RecordProperty("operation", operation);
    RecordProperty("words", words);
}

void KitTest::notOffered(const std::string& what) {
    RecordProperty("notOffered", what);
    GTEST_SKIP() << "not offered: " << what;
}

std::string KitTest::mediaPath(const std::string& name) {
    return environment("ORV_KIT_MEDIA") + "/" + name;
}

std::string KitTest::film() {
    const std::string address = environment("ORV_KIT_ADDRESS");
    return address.empty() ? mediaPath("tracks.mp4") : address;
}

void KitTest::setSource(const std::string& path) {
    const android::status_t status = player->setDataSource(path.c_str(), nullptr);
    ORV_NOT_OFFERED_IF(status == ORV_ERROR_SCHEME, "it opens no addresses like " + path);
    ASSERT_EQ(android::NO_ERROR, status) << path;
}

void KitTest::open(const std::string& path) {
    setSource(path);
    if (IsSkipped() || HasFailure()) return;
    const android::status_t status = player->prepare();
    ORV_NOT_OFFERED_IF(path != film() && isUnplayable(status), "it does not play " + path);
    ASSERT_EQ(android::NO_ERROR, status) << path;
    if (path == film()) {
        ASSERT_GE(duration(), kShortestFilmMs) << "these tests need longer media";
    }
}

int KitTest::position() const {
    int msec = -1;
    EXPECT_EQ(android::NO_ERROR, player->getCurrentPosition(&msec));
    return msec;
}

int KitTest::duration() const {
    int msec = -1;
    EXPECT_EQ(android::NO_ERROR, player->getDuration(&msec));
    return msec;
}

bool KitTest::isReady() const {
    int msec = -1;
    return player->getCurrentPosition(&msec) == android::NO_ERROR;
}

void KitTest::playBeyond(int msec) {
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() > msec; }));
}

}  // namespace orvkit
