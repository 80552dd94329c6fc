// SPDX-License-Identifier: Apache-2.0
#include "ScriptedEngine.h"

#include <binder/Parcel.h>

#include <atomic>
#include <sstream>
#include <utility>

#include "PrivateMember.h"
#include "Trace.h"

namespace orvtest {

ORV_OPEN_MEMBER(InstalledListener, android::MediaPlayerBase, mListener);
ORV_OPEN_MEMBER(SendEvent, android::MediaPlayerBase, sendEvent);

namespace {

std::mutex sEnginesMutex;
std::vector<std::shared_ptr<ScriptedEngine>> sEngines;
std::atomic<int> sLive{0};
std::function<void(ScriptedEngine&)> sWhenMade;

}  // namespace

std::shared_ptr<ScriptedEngine> ScriptedEngine::last() {
    std::lock_guard<std::mutex> lock(sEnginesMutex);
    return sEngines.empty() ? nullptr : sEngines.back();
}

std::vector<std::shared_ptr<ScriptedEngine>> ScriptedEngine::all() {
    std::lock_guard<std::mutex> lock(sEnginesMutex);
    return sEngines;
}

void ScriptedEngine::forgetAll() {
    std::lock_guard<std::mutex> lock(sEnginesMutex);
    sEngines.clear();
}

void ScriptedEngine::whenMade(std::function<void(ScriptedEngine&)> script) {
    sWhenMade = std::move(script);
}

int ScriptedEngine::live() { return sLive; }

std::shared_ptr<ScriptedEngine> ScriptedEngine::make(android::TarnPlayer* player, int decoder) {
    std::shared_ptr<ScriptedEngine> engine(new ScriptedEngine(player, decoder));
    if (sWhenMade) sWhenMade(*engine);
    std::lock_guard<std::mutex> lock(sEnginesMutex);
    sEngines.push_back(engine);
    sLive++;
    return engine;
}

void ScriptedEngine::playerGone() {
    mPlayer = nullptr;
    sLive--;
}

android::sp<android::MediaPlayerBase::Listener> ScriptedEngine::listener() const {
    return mPlayer->*memberOf(InstalledListener{});
}

void ScriptedEngine::sendEvent(int msg, int ext1, int ext2, const android::Parcel* obj) const {
    (mPlayer->*memberOf(SendEvent{}))(msg, ext1, ext2, obj);
}

void ScriptedEngine::answer(const std::string& operation, std::initializer_list<int> results) {
    std::lock_guard<std::mutex> lock(mMutex);
    mAnswers[operation] = results;
}

void ScriptedEngine::reply(const std::string& operation, std::vector<int32_t> words) {
    mReplies[operation] = std::move(words);
}

void ScriptedEngine::whenCalled(const std::string& operation, std::function<void()> action) {
    mActions[operation] = std::move(action);
}

std::vector<std::string> ScriptedEngine::calls() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mCalls;
}

std::vector<std::string> ScriptedEngine::takeCalls() {
    std::lock_guard<std::mutex> lock(mMutex);
    return std::exchange(mCalls, {});
}

int ScriptedEngine::call(const std::string& operation, const std::string& arguments,
                         int unscripted) {
    int result = unscripted;
    {
        std::lock_guard<std::mutex> lock(mMutex);
        mCalls.push_back(operation + "(" + arguments + ")");
        Trace::add("engine", mCalls.back());
        std::deque<int>& answers = mAnswers[operation];
        if (!answers.empty()) result = answers.front();
        if (answers.size() > 1) answers.pop_front();
    }
    // Outside the lock: an action may wait for another thread's call.
    const auto action = mActions.find(operation);
    if (action != mActions.end()) action->second();
    return result;
}

void ScriptedEngine::writeOut(const std::string& operation, int* out) const {
    const auto value = mOutValues.find(operation);
    if (value != mOutValues.end()) *out = value->second;
}

void ScriptedEngine::writeReply(const std::string& operation, android::Parcel* out) const {
    const auto words = mReplies.find(operation);
    if (words == mReplies.end()) return;
    for (int32_t word : words->second) out->writeInt32(word);
}

std::string pointerText(const void* pointer) {
    if (pointer == nullptr) return "null";
    std::ostringstream text;
    text << pointer;
    return text.str();
}

}  // namespace orvtest
