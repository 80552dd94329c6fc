// SPDX-License-Identifier: Apache-2.0
#include "Machine.h"

#include "Counting.h"
#include "PlayerClasses.h"
#include "jni/NativePointer.h"

extern "C" jint JNI_OnLoad(JavaVM* vm, void* reserved);

namespace orvcounts {

Machine::Machine() : playerClass(orvtest::definePlayerClasses(vm)) {}

Machine::~Machine() {
    for (const std::string& violation : vm.violations()) require(false, violation.c_str());
}

void Machine::load() {
    require(JNI_OnLoad(vm.javaVm(), nullptr) == JNI_VERSION_1_4, "the library did not load");
}

void Machine::initClass() { call<void>(playerClass.mirror, "native_init", "()V"); }

fakejni::ObjectPtr Machine::newPlayer() {
    load();
    initClass();
    fakejni::ObjectPtr player = vm.newObject(orvtest::kPlayerClass);
    jobject weak = vm.local(vm.newObject("java/lang/ref/WeakReference"));
    call<void>(player, "native_setup", "(Ljava/lang/Object;)V", weak);
    engine = orvtest::ScriptedEngine::last();
    require(engine != nullptr, "the player was not set up");
    return player;
}

void Machine::release(const fakejni::ObjectPtr& player) {
    call<void>(player, "native_release", "()V");
}

android::sp<android::OrvMediaService> serviceOf(const fakejni::ObjectPtr& player) {
    return android::fromJavaLong<android::OrvMediaService>(player->get("mNativeContext").integer);
}

}  // namespace orvcounts
