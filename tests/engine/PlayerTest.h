// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gtest/gtest.h>
#include <orvtarn/TarnPlayer.h>

#include <functional>
#include <string>
#include <vector>

#include "EventRecorder.h"
#include "FrameSink.h"
#include "LogCapture.h"
#include "TestMedia.h"

namespace orvtest {

// Waits for a condition, asking again and again; false after the seconds.
bool eventually(const std::function<bool()>& condition, int seconds = 15);

// Whether a condition goes on to hold while another player opens its media and shows a
// dozen frames: what the first would do of itself by then comes no later on a slow
// machine.
bool remains(const std::function<bool()>& condition);

// The player's lines that warn or report an error; what else its libraries log differs
// by the machine.
std::vector<LogLine> complaints(const LogCapture& log);

// A player with a surface and a listener, released at the end.
class PlayerTest : public testing::Test {
protected:
    PlayerTest();
    ~PlayerTest() override;

    // From a file of tests/media to the prepared state.
    void open(const std::string& name);
    // Starts and waits for the end of the media.
    void playToEnd();

    int position() const;
    int duration() const;
    int speed() const;

    android::sp<FrameSink> sink = new FrameSink;
    android::sp<EventRecorder> events = new EventRecorder;
    android::sp<android::TarnPlayer> player = new android::TarnPlayer(-1);
};

}  // namespace orvtest
