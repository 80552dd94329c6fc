// SPDX-License-Identifier: Apache-2.0
#include "PlayerMachine.h"

#include "JavaObjects.h"
#include "LockCount.h"
#include "QuietLog.h"
#include "Require.h"
#include "jni/ClientFields.h"
#include "jni/JavaVm.h"

namespace orvfuzz {

using fakejni::ObjectPtr;

// References are never freed while a machine lives.
constexpr int kMostUses = 500;

struct PlayerMachine::Shared {
    Shared() : playerClass(orvtest::definePlayerClasses(vm)) {
        static const bool quiet = (quietLog(), true);
        (void)quiet;
        defineValueClasses(vm);
        defineCallbacks(playerClass);
        g__JavaVM = nullptr;
        android::gClientFields = {};
        require(JNI_OnLoad(vm.javaVm(), nullptr) == JNI_VERSION_1_4, "the library loads");
    }
    ~Shared() { g__JavaVM = nullptr; }

    fakejni::Vm vm;
    fakejni::Class& playerClass;
    int uses = 0;
};
std::unique_ptr<PlayerMachine::Shared> PlayerMachine::sShared;

PlayerMachine::PlayerMachine()
    : mShared(sShared != nullptr ? std::move(sShared) : std::make_unique<Shared>()),
      vm(mShared->vm),
      playerClass(mShared->playerClass),
      player(vm.newObject(orvtest::kPlayerClass)),
      mBuffersBefore(vm.unreleased().size()) {
    if (mShared->uses == 0) initClass();
}

PlayerMachine::~PlayerMachine() {
    if (mIsReusable && ++mShared->uses < kMostUses) sShared = std::move(mShared);
}

void PlayerMachine::initClass() {
    jobject type = vm.local(playerClass.mirror);
    fakejni::callNative<void>(vm, playerClass, type, "native_init", "()V");
}

void PlayerMachine::redefine(const char* name, const char* signature, fakejni::Implementation body,
                             bool isStatic) {
    playerClass.remove(name);
    if (isStatic) {
        playerClass.staticMethod(name, signature, std::move(body));
    } else {
        playerClass.method(name, signature, std::move(body));
    }
}

void PlayerMachine::tolerate(const std::string& violation) {
    vm.tolerate(violation);
    mToleratesMore = true;
}

orvtest::ScriptedEngine& PlayerMachine::setUp(const ObjectPtr& object) {
    jobject weak = vm.local(vm.newObject("java/lang/ref/WeakReference"));
    callOn<void>(object, "native_setup", "(Ljava/lang/Object;)V", weak);
    return *orvtest::ScriptedEngine::last();
}

void PlayerMachine::requireNoLocks(const char* name) {
    require(heldLocks() == 0, std::string(name) + " leaves no lock held");
}

void PlayerMachine::requireNoViolations() {
    for (const std::string& violation : vm.violations()) require(false, violation);
}

void PlayerMachine::finish(const Leftovers& left) {
    vm.forgetFailures();
    vm.clearPending();
    if (player->get("mNativeContext").integer != 0) call<void>("native_release", "()V");
    vm.clearPending();
    requireNoViolations();
    require(vm.globalReferences() == left.globals, "no global reference is left");
    require(vm.unreleased().size() == mBuffersBefore + left.buffers,
            "every string and array is given back");
    require(vm.attachedThreads() == 0, "no thread stays attached");
    require(orvtest::ScriptedEngine::live() == 0, "no engine player is left");
    orvtest::ScriptedEngine::forgetAll();
    vm.forgetCalls();
    mIsReusable = !mToleratesMore;
}

}  // namespace orvfuzz
