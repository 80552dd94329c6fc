// SPDX-License-Identifier: Apache-2.0
// What the virtual machine remembers for the test: calls, buffers given out,
// failures to come, and broken rules.
#include <algorithm>
#include <utility>

#include "FakeJni/EnvSupport.h"
#include "Trace.h"

namespace fakejni {

namespace {

using Lock = std::lock_guard<MachineMutex>;

}  // namespace

void Vm::fail(const std::string& function, int nth) {
    Lock lock(mMutex);
    mPlans.push_back({function, nth});
}

void Vm::failNth(int n) { fail("", n); }

void Vm::forgetFailures() {
    Lock lock(mMutex);
    mPlans.clear();
}

bool Vm::mustFail(const std::string& function) {
    // Inside the platform's functions nothing fails: what they make of it is their affair.
    if (orvtest::Trace::Pause::isOn()) return false;
    bool hit = false;
    for (Plan& plan : mPlans) {
        const bool isAny = plan.function.empty() && mSpared.count(function) == 0;
        const bool counts = isAny || plan.function == function;
        if (counts && plan.remaining > 0 && --plan.remaining == 0) hit = true;
    }
    mFailures += hit;
    if (hit) mLastFailed = function;
    return hit;
}

void Vm::record(const std::string& function, const std::string& detail) {
    mCalls.push_back({function, detail, std::this_thread::get_id()});
    orvtest::Trace::add("jni", detail.empty() ? function : function + " " + detail);
    const auto action = mActions.find(function);
    if (action == mActions.end()) return;
    const MachineMutex::Look look(mMutex);
    action->second();
}

void Vm::whenCalled(const std::string& function, std::function<void()> action) {
    Lock lock(mMutex);
    mActions[function] = std::move(action);
}

void Vm::recordJava(JavaCall call) {
    orvtest::Trace::add("java", toString(call));
    mJavaCalls.push_back(std::move(call));
}

std::vector<JniCall> Vm::calls() {
    Lock lock(mMutex);
    return mCalls;
}

std::vector<std::string> Vm::callsOf(const std::string& function) {
    Lock lock(mMutex);
    std::vector<std::string> details;
    for (const JniCall& call : mCalls) {
        if (call.function == function) details.push_back(call.detail);
    }
    return details;
}

std::vector<JavaCall> Vm::javaCalls() {
    Lock lock(mMutex);
    return mJavaCalls;
}

std::vector<JNINativeMethod> Vm::registrations() {
    Lock lock(mMutex);
    return mRegistrations;
}

std::vector<std::string> Vm::javaCallTexts() {
    std::vector<std::string> texts;
    for (const JavaCall& call : javaCalls()) texts.push_back(toString(call));
    return texts;
}

void Vm::forgetCalls() {
    Lock lock(mMutex);
    mCalls.clear();
    mJavaCalls.clear();
}

size_t Vm::globalReferences() {
    Lock lock(mMutex);
    return mReferences.liveCount(RefKind::kGlobal) + mReferences.liveCount(RefKind::kWeak);
}

size_t Vm::localReferences() {
    Lock lock(mMutex);
    return mReferences.liveCount(RefKind::kLocal);
}

std::vector<std::string> Vm::unreleased() {
    Lock lock(mMutex);
    std::vector<std::string> functions;
    for (const auto& [buffer, pin] : mPins) functions.push_back(pin.function);
    std::sort(functions.begin(), functions.end());
    return functions;
}

std::vector<std::string> Vm::violations() {
    Lock lock(mMutex);
    return mViolations;
}

std::vector<std::string> Vm::takeViolations() {
    Lock lock(mMutex);
    return std::exchange(mViolations, {});
}

void Vm::violation(const std::string& text) {
    Lock lock(mMutex);
    for (const std::string& tolerated : mTolerated) {
        if (text.find(tolerated) != std::string::npos) return;
    }
    mViolations.push_back(text);
}

void Vm::tolerate(const std::string& text) {
    Lock lock(mMutex);
    mTolerated.push_back(text);
    std::vector<std::string> earlier;
    earlier.swap(mViolations);
    for (const std::string& one : earlier) violation(one);
}

void Vm::handOut(const void* id) { mIds.insert(id); }

bool Vm::isHandedOut(const void* id) const { return mIds.count(id) != 0; }

void Vm::pin(const void* buffer, void* block, const std::string& function, ObjectPtr owner) {
    mPins[buffer] = {block, function, std::move(owner)};
}

ObjectPtr Vm::unpin(const void* buffer, const std::string& function, bool keep) {
    auto found = mPins.find(buffer);
    const std::string giver = "Get" + function.substr(std::string("Release").size());
    if (found == mPins.end() || found->second.function != giver) {
        violation(function + ": not a buffer that " + giver + " gave");
        return nullptr;
    }
    ObjectPtr owner = found->second.owner;
    if (!keep) mPins.erase(found);
    return owner;
}

}  // namespace fakejni
