// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gtest/gtest.h>
#include <orvtarn/TarnPlayer.h>

#include <functional>
#include <string>

#include "EventRecorder.h"

// Opens media; the test ends here when that fails, or when the engine does not offer it.
#define ORV_OPEN(...)                            \
    do {                                         \
        open(__VA_ARGS__);                       \
        if (IsSkipped() || HasFailure()) return; \
    } while (false)

// The test ends here when the engine has refused what it does not offer.
#define ORV_NOT_OFFERED_IF(refused, what) \
    do {                                  \
        if (refused) {                    \
            notOffered(what);             \
            return;                       \
        }                                 \
    } while (false)

namespace orvkit {

// Where the film's tests go; it is longer.
constexpr int kMiddleMs = 4000;
// What a player may be away from the place that it was sent to: some frames.
constexpr int kNearMs = 200;

// Waits for a condition, asking again and again; false after half a minute.
bool eventually(const std::function<bool()>& condition);
// Whether a condition holds each of a hundred times that it is looked at.
bool remains(const std::function<bool()>& condition);

// An engine's player and its listener, which know nothing but the engine's headers.
// The environment says where the media are: ORV_KIT_MEDIA is the folder, and
// ORV_KIT_ADDRESS, when set, what stands in for its film (see docs/engine.md).
class KitTest : public testing::Test {
protected:
    KitTest();
    ~KitTest() override;

    // What the test is a row for: an operation of TarnPlayer, or "the player", and some
    // words of the one sentence in the headers that it checks. First in each test.
    static void checks(const char* operation, const char* words);
    // Ends the test as one of what the engine refuses.
    static void notOffered(const std::string& what);

    static std::string mediaPath(const std::string& name);
    // Seekable, eight seconds or more, with a picture.
    static std::string film();

    // An engine refuses addresses that it does not open, and formats that it does not play.
    void open(const std::string& path = film());
    // The file's name in the folder.
    void openFile(const std::string& name) { open(mediaPath(name)); }
    // Sets the source, which an engine may not offer.
    void setSource(const std::string& path = film());

    int position() const;
    int duration() const;
    bool isReady() const;
    // Plays until the position is beyond those milliseconds.
    void playBeyond(int msec);

    android::sp<orvtest::EventRecorder> events = new orvtest::EventRecorder;
    android::sp<android::TarnPlayer> player = new android::TarnPlayer(-1);
};

}  // namespace orvkit
