// SPDX-License-Identifier: Apache-2.0
#include "Round.h"

#include <jni/JavaVm.h>
#include <jni/PlayerContext.h>

#include <algorithm>
#include <memory>
#include <thread>

#include "Events.h"
#include "Natives.h"
#include "Perturbation.h"
#include "Progress.h"
#include "ScriptedEngine.h"
#include "Slot.h"
#include "Streams.h"

namespace stress {

namespace {

using android::OrvMediaService;
using android::sp;
using fakejni::ObjectPtr;
using orvtest::ScriptedEngine;

class Round {
public:
    Round(uint32_t seed, const RoundSize& size)
        : mSeed(seed),
          mSize(size),
          mEvents(mWorld, size.threads, [this] { insideAnEvent(); }),
          mStreams(std::make_unique<Streams>(mWorld)),
          mEventRandom(seed, size.threads),
          mKeptBefore(logCounts().keptTexts) {
        for (uint32_t i = 0; i < size.players; ++i) {
            mSlots.push_back(std::make_unique<Slot>(i % 2 == 0));
        }
        ScriptedEngine::whenMade([this](ScriptedEngine& engine) { script(engine); });
    }
    ~Round() { ScriptedEngine::whenMade(nullptr); }

    std::vector<std::string> run();

private:
    void script(ScriptedEngine& engine);
    void runJava(uint32_t number);
    void runEngine(uint32_t number);
    void act(Random& random, uint32_t number);
    void insideAnEvent();

    Slot& anySlot(Random& random) { return *mSlots[random.below(mSize.players)]; }
    void renew(Slot& slot, Random& random);
    void call(Slot& slot, const Player& player, Random& random, const Native& row);
    void callAny(Slot& slot, Random& random);
    void useService(Slot& slot, Random& random, uint32_t number);
    void finish();
    void check();

    const uint32_t mSeed;
    const RoundSize mSize;
    World mWorld;
    Events mEvents;
    std::vector<std::unique_ptr<Slot>> mSlots;
    std::unique_ptr<Streams> mStreams;
    Random mEventRandom;  // of the dispatcher's thread
    const uint64_t mKeptBefore;
};

// Records with something in them, so that the whole ways to Java are run.
void Round::script(ScriptedEngine& engine) {
    engine.takeStream = [this](IOrvStreamSource* stream) { mStreams->add(stream); };
    for (const char* count : {"getVideoTrackCount", "getAudioTrackCount", "getSubtitleTrackCount"})
        engine.put(count, 2);
    engine.currentVideoCodec.emplace();
    engine.metaDataInfo.emplace();
    for (int track : {0, 1}) {
        engine.videoCodecs[track];
        engine.audioTracks[track];
        engine.subtitleTracks[track];
    }
    engine.albumArt.emplace(std::vector<uint8_t>(32));
}

// A new player in the slot; the one before is released, if another thread has not.
void Round::renew(Slot& slot, Random& random) {
    const Player next = mWorld.newPlayer();
    setUp(mWorld, next);
    const Player before = slot.replace(next);
    if (before.object == nullptr) return;
    call(slot, before, random, native(random.oneIn(2) ? "native_release" : "native_finalize"));
}

void Round::call(Slot& slot, const Player& player, Random& random, const Native& row) {
    if (!slot.bindsSurfaces || !row.touchesSurface) {
        return callOn(mWorld, random, player.object, row);
    }
    const std::lock_guard<std::mutex> turn(slot.turn);
    callOn(mWorld, random, player.object, row);
    // Of the other slots' players another thread's release may not be through yet.
    if (row.releases) mWorld.markReleased(player);
}

void Round::callAny(Slot& slot, Random& random) {
    const Native& row = natives()[random.below(static_cast<uint32_t>(natives().size()))];
    if (row.name == "native_setVideoSurface" && !slot.bindsSurfaces) return;
    const Player player = slot.player();
    if (player.object != nullptr) call(slot, player, random, row);
}

// What native code does with a service that it holds.
void Round::useService(Slot& slot, Random& random, uint32_t number) {
    const ObjectPtr player = slot.player().object;
    if (player == nullptr) return;
    sp<OrvMediaService> service;
    {
        const LocalFrame frame(mWorld.vm);
        service = android::getMediaService(mWorld.vm.env(), mWorld.vm.local(player));
    }
    if (service == nullptr) return;
    switch (random.below(8)) {
        case 0:
            return mEvents.abortLast(number);
        case 1:
            return ORV::SyncToAsync::getInstance()->abortAllActions(service, random.oneIn(2));
        case 2: {
            // The listener has no lock against its removal, which is in release.
            const std::lock_guard<std::mutex> turn(slot.turn);
            if (slot.bindsSurfaces) service->notify(android::MEDIA_PREPARED, 0, 0, nullptr);
            return;
        }
        default:
            return mEvents.send(number, service);
    }
}

void Round::act(Random& random, uint32_t number) {
    Slot& slot = anySlot(random);
    switch (random.below(16)) {
        case 0:
            return renew(slot, random);
        case 1:
            if (const Player player = slot.player(); player.object != nullptr) {
                call(slot, player, random, native("native_setDataSourceByInputStream"));
            }
            return;
        case 2:
        case 3:
        case 4:
        case 5:
        case 6:
        case 7:
            return useService(slot, random, number);
        default:
            return callAny(slot, random);
    }
}

// Inside a delivery the dispatcher's lock is held: a call that waits for a turn could
// wait for a thread that waits for the dispatcher.
void Round::insideAnEvent() {
    Slot& slot = anySlot(mEventRandom);
    if (!slot.bindsSurfaces && mEventRandom.oneIn(2)) callAny(slot, mEventRandom);
}

void Round::runJava(uint32_t number) {
    setPerturbationThread(number);
    JNIEnv* env;
    mWorld.vm.attach(&env, true);
    Random random(mSeed, number);
    for (uint32_t i = 0; i < mSize.calls; ++i) act(random, number);
}

void Round::runEngine(uint32_t number) {
    setPerturbationThread(number);
    Random random(mSeed, number);
    for (uint32_t i = 0; i < mSize.calls; ++i) mStreams->use(random);
    // A read that is made invalid while Java has it leaves its thread attached.
    if (mWorld.vm.isAttached()) g__JavaVM->DetachCurrentThread();
}

void Round::finish() {
    Random random(mSeed, mSize.threads + 1);
    for (const auto& slot : mSlots) {
        const Player player = slot->player();
        if (player.object != nullptr) call(*slot, player, random, native("native_release"));
    }
    mEvents.settle();
    mStreams.reset();
}

void Round::check() {
    mEvents.check();
    fakejni::Vm& vm = mWorld.vm;
    Faults& faults = mWorld.faults;
    for (const std::string& violation : vm.violations()) faults.add(violation);
    if (vm.globalReferences() != 0) {
        faults.add(std::to_string(vm.globalReferences()) + " global references are left");
    }
    if (vm.attachedThreads() != 0) {
        faults.add(std::to_string(vm.attachedThreads()) + " threads are still attached");
    }
    if (ScriptedEngine::live() != 0) {
        faults.add(std::to_string(ScriptedEngine::live()) + " engine players are left");
    }
    if (!mWorld.surfacesAreFree()) faults.add("a surface's references do not add up");
    const std::vector<std::string> kept = vm.unreleased();
    const auto texts = std::count(kept.begin(), kept.end(), "GetStringUTFChars");
    const uint64_t expected = logCounts().keptTexts - mKeptBefore;
    if (kept.size() != static_cast<size_t>(texts) || static_cast<uint64_t>(texts) != expected) {
        faults.add(std::to_string(kept.size()) + " buffers were not given back instead of the " +
                   std::to_string(expected) + " texts that are kept");
    }
}

std::vector<std::string> Round::run() {
    std::vector<std::thread> threads;
    const uint32_t engines = std::max(1u, mSize.threads / 4);
    for (uint32_t number = 0; number < mSize.threads; ++number) {
        const bool isEngine = number + engines >= mSize.threads;
        threads.emplace_back(isEngine ? &Round::runEngine : &Round::runJava, this, number);
    }
    for (std::thread& thread : threads) thread.join();
    finish();
    check();
    ScriptedEngine::forgetAll();
    return mWorld.faults.take();
}

}  // namespace

std::vector<std::string> runRound(uint32_t seed, const RoundSize& size) {
    Round round(seed, size);
    return round.run();
}

}  // namespace stress
