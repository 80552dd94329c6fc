// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "FakeJni/NativeCall.h"
#include "FakeJni/Vm.h"
#include "PlayerClasses.h"
#include "ScriptedEngine.h"

namespace orvfuzz {

// What is left over by contract after a run. Whatever is beyond is a finding.
struct Leftovers {
    size_t globals = 0;
    size_t buffers = 0;
};

// A virtual machine with the library loaded and a Java player of its own for each
// input. What finish() found nothing left of is used for the next inputs, too: to
// make it takes longer than most inputs do.
class PlayerMachine {
public:
    PlayerMachine();
    ~PlayerMachine();
    PlayerMachine(const PlayerMachine&) = delete;
    PlayerMachine& operator=(const PlayerMachine&) = delete;

    // native_setup on a player; its engine.
    orvtest::ScriptedEngine& setUp(const fakejni::ObjectPtr& object);
    orvtest::ScriptedEngine& setUp() { return setUp(player); }

    // Calls a native method and requires that it leaves no lock held. What it
    // threw stays pending.
    template <typename R, typename... A>
    fakejni::NativeResult callOn(const fakejni::ObjectPtr& object, const char* name,
                                 const char* signature, A... args) {
        jobject thiz = vm.local(object);
        auto result = fakejni::callNative<R>(vm, playerClass, thiz, name, signature, args...);
        requireNoLocks(name);
        return result;
    }
    template <typename R, typename... A>
    fakejni::NativeResult call(const char* name, const char* signature, A... args) {
        return callOn<R>(player, name, signature, args...);
    }

    // Releases the player, and requires that nothing is left beyond that.
    void finish(const Leftovers& left = {});
    // Requires that no rule of JNI was broken so far.
    void requireNoViolations();

    // Gives a method of the Java player a body; initClass afterwards.
    void redefine(const char* name, const char* signature, fakejni::Implementation body,
                  bool isStatic = false);
    // native_init.
    void initClass();

    // From now on that is no broken rule, on this machine.
    void tolerate(const std::string& violation);

private:
    struct Shared;
    static std::unique_ptr<Shared> sShared;
    std::unique_ptr<Shared> mShared;

public:
    fakejni::Vm& vm;
    fakejni::Class& playerClass;
    const fakejni::ObjectPtr player;

private:
    const size_t mBuffersBefore;
    bool mToleratesMore = false;
    bool mIsReusable = false;

    static void requireNoLocks(const char* name);
};

}  // namespace orvfuzz
