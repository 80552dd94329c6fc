// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni/media-service/OrvMediaService.h>

#include <memory>
#include <string>

#include "FakeJni/NativeCall.h"
#include "FakeJni/Vm.h"
#include "ScriptedEngine.h"

namespace orvcounts {

// A virtual machine with the Java player class. Nothing may have broken JNI's
// rules when it ends.
class Machine {
public:
    Machine();
    ~Machine();
    Machine(const Machine&) = delete;
    Machine& operator=(const Machine&) = delete;

    // Loads the library as System.loadLibrary does.
    void load();
    // The class's native_init.
    void initClass();
    // Loads and initialises, then sets a player up.
    fakejni::ObjectPtr newPlayer();
    void release(const fakejni::ObjectPtr& player);

    // The native method's result.
    template <typename R, typename... A>
    fakejni::Value call(const fakejni::ObjectPtr& object, const char* name, const char* signature,
                        A... args) {
        jobject thiz = vm.local(object);
        return fakejni::callNative<R>(vm, playerClass, thiz, name, signature, args...).value;
    }

    fakejni::Vm vm;
    fakejni::Class& playerClass;
    std::shared_ptr<orvtest::ScriptedEngine> engine;  // of the last player
};

// The media service of a player that was set up.
android::sp<android::OrvMediaService> serviceOf(const fakejni::ObjectPtr& player);

}  // namespace orvcounts
