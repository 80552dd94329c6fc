// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gtest/gtest.h>
#include <jni/media-service/OrvMediaService.h>

#include <memory>

#include "LogCapture.h"
#include "ScriptedEngine.h"

namespace orvtest {

// A service of its own for each test, at first without a player. At the end
// the service and every engine must be gone.
class ServiceFixture : public testing::Test {
protected:
    ServiceFixture() : service(new android::OrvMediaService) { log.clear(); }

    void TearDown() override {
        service.clear();
        EXPECT_EQ(ScriptedEngine::live(), 0) << "an engine player was leaked";
        ScriptedEngine::forgetAll();
    }

    // Attaches a new player; the lines of doing so are dropped.
    ScriptedEngine& attachPlayer() {
        service->attachPlayer(new android::TarnPlayer(-1));
        log.clear();
        engine = ScriptedEngine::last();
        return *engine;
    }

    LogCapture log;
    android::sp<android::OrvMediaService> service;
    std::shared_ptr<ScriptedEngine> engine;
};

}  // namespace orvtest
