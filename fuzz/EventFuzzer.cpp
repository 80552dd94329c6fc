// SPDX-License-Identifier: Apache-2.0
//
// Events of any content through the dispatcher, with actions that are aborted and
// posters that come and go, against a list of what must arrive. Input, a line
// each: "event PLAYER MSG EXT1 EXT2 BYTES", "bare PLAYER KIND VALID" for an action
// without an event, "abort N" for the N-th action, "abortAll PLAYER KEEP",
// "handler PLAYER", "noHandler PLAYER", "listener PLAYER MSG".
#include <binder/Parcel.h>
#include <time.h>

#include <array>
#include <condition_variable>
#include <memory>
#include <mutex>

#include "dispatch/SyncToAsync.h"
#include "jni/media-service/MediaClientListener.h"
#include "support/PlayerMachine.h"
#include "support/Require.h"
#include "support/Words.h"

// The dispatcher's pause between two events would take all the time there is.
extern "C" int __wrap_nanosleep(const timespec*, timespec*) { return 0; }

namespace {

using android::OrvMediaService;
using android::sp;
using fakejni::Invocation;
using fakejni::Value;
using ORV::SyncToAsync;
using ORV::SyncToAsyncAction;
using orvfuzz::require;

constexpr int kPlayers = 3;
constexpr int kGate = -100;
constexpr int kEnd = -101;
constexpr size_t kMostActions = 200;

struct Event {
    int player;
    int msg, ext1, ext2;
    std::vector<uint8_t> bytes;
    bool operator==(const Event& other) const {
        return player == other.player && msg == other.msg && ext1 == other.ext1 &&
               ext2 == other.ext2 && bytes == other.bytes;
    }
};

// An action as the dispatcher should see it when its turn comes.
struct Planned {
    Event event;
    bool delivers;  // its kind, its flag and its payload
    bool cancelled = false;
    SyncToAsyncAction* action;  // its address alone: the dispatcher deletes it
};

class Dispatch {
public:
    Dispatch() {
        const auto post = [this](const Invocation& call) {
            arrived(call);
            return Value();
        };
        machine.redefine("postEventFromNative", "(Ljava/lang/Object;IIILjava/lang/Object;)V", post,
                         true);
        machine.initClass();
        for (int i = 0; i < kPlayers; i++) {
            weak[i] = machine.vm.newObject("java/lang/ref/WeakReference");
            services[i] = new OrvMediaService;
        }
        gateService = new OrvMediaService;
        gateWeak = machine.vm.newObject("java/lang/ref/WeakReference");
    }

    void run(orvfuzz::Words input) {
        words = input;
        dispatcher->addMsgHandler(gateService, poster(gateWeak));
        for (int i = 0; i < kPlayers; i++) addHandler(i);
        // What the input says happens inside the first event, so that the
        // dispatcher is at its next action only when all is said.
        add(gateService, {0, kGate, 0, 0, {}});
        std::unique_lock<std::mutex> lock(mutex);
        ended.wait(lock, [this] { return isOver; });
    }

    void finish() {
        for (int i = 0; i < kPlayers; i++) {
            for (; handlers[i] > 0; handlers[i]--) dispatcher->delMsgHandler(services[i]);
        }
        // Waits, too, until the last event's delivery has returned.
        dispatcher->delMsgHandler(gateService);
        require(received == expected,
                "exactly the events arrive that were not aborted, in their order");
        for (sp<OrvMediaService>& service : services) service.clear();
        gateService.clear();
        machine.finish();
    }

private:
    sp<ORV::MsgDispatcher> poster(const fakejni::ObjectPtr& weakPlayer) {
        return new ORV::MsgDispatcher(machine.vm.env(), machine.vm.local(machine.player),
                                      machine.vm.local(weakPlayer));
    }
    void addHandler(int player) {
        dispatcher->addMsgHandler(services[player], poster(weak[player]));
        handlers[player]++;
    }

    SyncToAsyncAction* add(const sp<OrvMediaService>& service, const Event& event) {
        auto* action = new SyncToAsyncAction;
        parcels.push_back(std::make_unique<android::Parcel>());
        parcels.back()->setData(event.bytes.data(), event.bytes.size());
        action->payload =
            new NotifyMessage{event.msg, event.ext1, event.ext2, parcels.back().get()};
        action->service = service;
        action->valid = true;
        dispatcher->addAction(action);
        return action;
    }

    void arrived(const Invocation& call) {
        const int msg = static_cast<int>(call.args[1].integer);
        if (msg == kGate) return atGate();
        if (msg == kEnd) return atEnd();
        Event event = {0,
                       msg,
                       static_cast<int>(call.args[2].integer),
                       static_cast<int>(call.args[3].integer),
                       {}};
        while (event.player < kPlayers && weak[event.player] != call.args[0].object) event.player++;
        if (call.args[4].object != nullptr) event.bytes = call.args[4].object->bytes;
        received.push_back(event);
    }

    // On the dispatcher's thread.
    void atGate() {
        while (!words.atEnd()) step(words.next());
        for (const Planned& planned : plan) {
            const bool heard =
                planned.event.player < kPlayers && handlers[planned.event.player] > 0;
            if (planned.delivers && !planned.cancelled && heard) expected.push_back(planned.event);
        }
        add(gateService, {0, kEnd, 0, 0, {}});
    }
    void atEnd() {
        std::lock_guard<std::mutex> lock(mutex);
        isOver = true;
        ended.notify_one();
    }

    void step(std::string_view word) {
        if (word == "event" && plan.size() < kMostActions) addEvent();
        if (word == "bare" && plan.size() < kMostActions) addBare();
        if (word == "listener" && plan.size() < kMostActions) listen();
        if (word == "abort") abortOne();
        if (word == "abortAll") abortAll();
        if (word == "handler") addHandlerHere();
        if (word == "noHandler") removeHandler();
    }

    void addEvent() {
        Event event = {words.below(kPlayers), words.int32(), words.int32(), words.int32(), {}};
        const std::string text = words.text();
        event.bytes.assign(text.begin(), text.end());
        if (event.msg == kGate || event.msg == kEnd) return;
        plan.push_back({event, true, false, add(services[event.player], event)});
    }
    void addBare() {
        const int player = words.below(kPlayers);
        auto* action = new SyncToAsyncAction;
        action->kind = words.int32();
        action->valid = words.flag();
        action->service = services[player];
        plan.push_back({{player, 0, 0, 0, {}}, false, false, action});
        dispatcher->addAction(action);
    }
    // An event on the listener's path has no poster, by contract.
    void listen() {
        const int player = words.below(kPlayers);
        services[player]->setListener(new MediaClientListener);
        services[player]->notify(words.int32(), 0, 0, nullptr);
    }
    void abortOne() {
        if (plan.empty()) return dispatcher->abortAction(nullptr);
        Planned& planned = plan[static_cast<size_t>(words.below(static_cast<int>(plan.size())))];
        planned.cancelled = true;
        dispatcher->abortAction(planned.action);
    }
    void abortAll() {
        const int player = words.below(kPlayers + 1);
        if (player == kPlayers) return dispatcher->abortAllActions(nullptr, words.flag());
        for (Planned& planned : plan) {
            if (planned.event.player == player) planned.cancelled = true;
        }
        dispatcher->abortAllActions(services[player], words.flag());
    }
    void addHandlerHere() {
        const int player = words.below(kPlayers);
        if (handlers[player] < 4) addHandler(player);
    }
    void removeHandler() {
        const int player = words.below(kPlayers);
        dispatcher->delMsgHandler(services[player]);
        if (handlers[player] > 0) handlers[player]--;
    }

    orvfuzz::PlayerMachine machine;
    SyncToAsync* const dispatcher = SyncToAsync::getInstance();
    orvfuzz::Words words{nullptr, 0};
    std::array<sp<OrvMediaService>, kPlayers> services;
    std::array<fakejni::ObjectPtr, kPlayers> weak;
    std::array<int, kPlayers> handlers{};
    sp<OrvMediaService> gateService;
    fakejni::ObjectPtr gateWeak;
    std::vector<std::unique_ptr<android::Parcel>> parcels;
    std::vector<Planned> plan;
    std::vector<Event> expected;
    std::vector<Event> received;
    std::mutex mutex;
    std::condition_variable ended;
    bool isOver = false;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    Dispatch dispatch;
    dispatch.run({data, size});
    dispatch.finish();
    return 0;
}
