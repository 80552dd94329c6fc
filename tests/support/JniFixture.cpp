// SPDX-License-Identifier: Apache-2.0
#include "JniFixture.h"

#include <algorithm>

#include "Trace.h"
#include "TraceBook.h"
#include "dispatch/SyncToAsync.h"
#include "jni/ClientFields.h"
#include "jni/JavaVm.h"

namespace orvtest {

namespace {

using fakejni::NativeResult;
using fakejni::ObjectPtr;

std::vector<LogLine> ofThisThread(std::vector<LogLine> lines) {
    const auto foreign = [](const LogLine& line) {
        return line.thread != std::this_thread::get_id();
    };
    lines.erase(std::remove_if(lines.begin(), lines.end(), foreign), lines.end());
    return lines;
}

std::vector<std::string> takeEngineCalls() {
    const auto engine = ScriptedEngine::last();
    return engine == nullptr ? std::vector<std::string>() : engine->takeCalls();
}

// What is in after and not in before.
std::vector<std::string> added(const std::vector<std::string>& before,
                               const std::vector<std::string>& after) {
    std::vector<std::string> rest;
    std::set_difference(after.begin(), after.end(), before.begin(), before.end(),
                        std::back_inserter(rest));
    return rest;
}

}  // namespace

VmFixture::VmFixture() : playerClass(definePlayerClasses(vm)) {
    g__JavaVM = nullptr;
    android::gClientFields = {};
}

VmFixture::~VmFixture() { g__JavaVM = nullptr; }

void VmFixture::TearDown() {
    const Untraced ending(*this);
    for (const ObjectPtr& object : mPlayers) {
        if (object->get("mNativeContext").integer != 0)
            callOn<void>(object, "native_release", "()V");
    }
    EXPECT_THAT(vm.violations(), testing::IsEmpty());
    EXPECT_EQ(vm.globalReferences(), leftGlobals) << "global references are left";
    EXPECT_EQ(vm.unreleased(), leftUnreleased) << "strings or arrays were not given back";
    EXPECT_EQ(vm.attachedThreads(), 0) << "threads are still attached";
    EXPECT_EQ(ScriptedEngine::live(), leftEngines) << "engine players are left";
    ScriptedEngine::forgetAll();
}

void VmFixture::loadLibrary() {
    ASSERT_EQ(JNI_OnLoad(vm.javaVm(), nullptr), JNI_VERSION_1_4);
    log.clear();
    vm.forgetCalls();
}

void VmFixture::initClass() { callStatic<void>("native_init", "()V"); }

Outcome VmFixture::observe(const std::string& title, const std::function<NativeResult()>& body) {
    log.clear();
    vm.forgetCalls();
    takeEngineCalls();
    const size_t globalsBefore = vm.globalReferences();
    const std::vector<std::string> unreleasedBefore = vm.unreleased();

    const Trace trace;
    const NativeResult result = body();

    Outcome outcome;
    outcome.returned = toString(result.value);
    outcome.locals = result.locals;
    outcome.thrown = vm.pending();
    vm.clearPending();
    outcome.log = ofThisThread(log.take());
    outcome.engine = takeEngineCalls();
    outcome.java = vm.javaCallTexts();
    outcome.unreleased = added(unreleasedBefore, vm.unreleased());
    outcome.globals = static_cast<int>(vm.globalReferences() - globalsBefore);
    if (mUntraced == 0) addToTracePage(title, trace.steps());
    return outcome;
}

Outcome VmFixture::observeAction(const std::function<void()>& body) {
    return observe("action", [&] {
        body();
        return NativeResult{};
    });
}

ObjectPtr VmFixture::newPlayer() {
    mPlayers.push_back(vm.newObject(kPlayerClass));
    return mPlayers.back();
}

jobjectArray VmFixture::strings(const std::vector<std::string>& texts) {
    std::vector<ObjectPtr> elements;
    for (const std::string& text : texts) elements.push_back(vm.newString(text));
    return vm.local<jobjectArray>(vm.newArray("java/lang/String", elements));
}

std::vector<std::string> VmFixture::vmCalls() {
    std::vector<std::string> functions;
    for (const fakejni::JniCall& call : vm.calls()) functions.push_back(call.function);
    return functions;
}

void JniFixture::SetUp() {
    const Untraced beginning(*this);
    ORV::SyncToAsync::getInstance();  // the first use logs more than the later ones
    loadLibrary();
    initClass();
}

ScriptedEngine& JniFixture::setUp(const ObjectPtr& object) {
    const Untraced beginning(*this);
    jobject weak = vm.local(vm.newObject("java/lang/ref/WeakReference"));
    callOn<void>(object, "native_setup", "(Ljava/lang/Object;)V", weak);
    engine = ScriptedEngine::last();
    return *engine;
}

}  // namespace orvtest
