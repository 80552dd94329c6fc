// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "FakeJni/NativeCall.h"
#include "FakeJni/Vm.h"
#include "LogCapture.h"
#include "Outcome.h"
#include "PlayerClasses.h"
#include "ScriptedEngine.h"

namespace orvtest {

// A virtual machine with the Java player class, and nothing of the library
// loaded into it yet. At the end no violation, global reference, buffer,
// attached thread or engine player may be left, beyond what a test announces.
class VmFixture : public testing::Test {
public:
    VmFixture();
    ~VmFixture() override;
    void TearDown() override;

    // Loads the library as System.loadLibrary does, and runs the class's
    // native_init; the lines and calls of doing so are dropped.
    void loadLibrary();
    void initClass();

    // Runs a body on the test's thread and reports all that it did. The order of
    // it, under that title, is part of the test's page of traces.
    Outcome observe(const std::string& title, const std::function<fakejni::NativeResult()>& body);
    Outcome observeAction(const std::function<void()>& body);

    // A Java player object that was not set up.
    fakejni::ObjectPtr newPlayer();

    template <typename R, typename... A>
    Outcome callOn(const fakejni::ObjectPtr& object, const std::string& name,
                   const std::string& signature, A... args) {
        return observe(name + " " + signature, [&] {
            jobject thiz = vm.local(object);
            return fakejni::callNative<R>(vm, *object->type, thiz, name, signature, args...);
        });
    }
    template <typename R, typename... A>
    Outcome callStatic(const std::string& name, const std::string& signature, A... args) {
        return observe(name + " " + signature, [&] {
            jobject type = vm.local(playerClass.mirror);
            return fakejni::callNative<R>(vm, playerClass, type, name, signature, args...);
        });
    }

    jstring string(const std::string& modifiedUtf8) {
        return vm.local<jstring>(vm.newString(modifiedUtf8));
    }
    jobjectArray strings(const std::vector<std::string>& texts);

    // The functions of the virtual machine that were called, in order.
    std::vector<std::string> vmCalls();

    LogCapture log;
    fakejni::Vm vm;
    fakejni::Class& playerClass;

    // While one lives, calls are not part of the test's page of traces: those that
    // only lead to what is tested, and those that are repeated for many failures.
    class Untraced {
    public:
        explicit Untraced(VmFixture& test) : mTest(test) { mTest.mUntraced++; }
        ~Untraced() { mTest.mUntraced--; }
        Untraced(const Untraced&) = delete;
        Untraced& operator=(const Untraced&) = delete;

    private:
        VmFixture& mTest;
    };

    // What is left over at the end by contract.
    size_t leftGlobals = 0;
    std::vector<std::string> leftUnreleased;
    int leftEngines = 0;

private:
    std::vector<fakejni::ObjectPtr> mPlayers;
    int mUntraced = 0;
};

// The same with the library loaded and a Java player object that is not set
// up. Players that a test leaves with a service are released at the end.
class JniFixture : public VmFixture {
public:
    JniFixture() : player(newPlayer()) {}
    void SetUp() override;

    // native_setup on the player; what it did is dropped. Its engine player.
    ScriptedEngine& setUpPlayer() { return setUp(player); }
    ScriptedEngine& setUp(const fakejni::ObjectPtr& object);

    template <typename R, typename... A>
    Outcome call(const std::string& name, const std::string& signature, A... args) {
        return callOn<R>(player, name, signature, args...);
    }

    fakejni::ObjectPtr player;
    std::shared_ptr<ScriptedEngine> engine;  // of the last set-up
};

}  // namespace orvtest
