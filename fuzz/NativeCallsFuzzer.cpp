// SPDX-License-Identifier: Apache-2.0
//
// Random calls of the native methods on two players, against a small model of the
// contract. Input, a line each: the name of a native function without its prefix
// and its arguments, after "other" on the second player; "answer OPERATION N",
// "put OPERATION N" for what the engine says; "tracks N" for what it has; "fail N"
// has the machine's N-th call within the next native method fail.
#include <gui/Surface.h>
#include <jni/OrvMediaClient.h>
#include <stdio.h>
#include <string.h>

#include <algorithm>
#include <array>
#include <memory>
#include <set>

#include "NativeMethodRows.h"
#include "stream/JavaInputStream.h"
#include "support/JavaObjects.h"
#include "support/LockCount.h"
#include "support/NativeArguments.h"
#include "support/PlayerMachine.h"
#include "support/Require.h"
#include "support/Words.h"

namespace {

using android::sp;
using fakejni::ObjectPtr;
using orvfuzz::require;

constexpr int kMostCalls = 300;
constexpr int kMostTracks = 8;

// What a method throws for a player without a service.
enum Absence { kThrows, kStaysQuiet };

struct Row {
    const char* name;  // of the native function, without its prefix
    const char* javaName;
    const char* signature;
    Absence absence;
};

bool isAnyOf(const char* name, std::initializer_list<const char*> names) {
    return std::any_of(names.begin(), names.end(),
                       [&](const char* other) { return strcmp(name, other) == 0; });
}

// The methods that only log when there is no service; the others throw.
Absence absenceOf(const char* name) {
    const bool quiet = isAnyOf(name, {"init",
                                      "setup",
                                      "release",
                                      "finalize",
                                      "getFrameAt",
                                      "setAudioTrack",
                                      "getVideoCodecInfo",
                                      "getPlayMode",
                                      "getBufferingTime",
                                      "onSubtitleTrack",
                                      "offSubtitleTrack",
                                      "deselectTrack",
                                      "selectTrack",
                                      "getSubtitleTrackInfo",
                                      "getAllSubtitleTrackInfo",
                                      "getAllAudioTrackInfo",
                                      "getAllVideoTrackInfo",
                                      "setSubtitleDataSource",
                                      "setSubtitleDataSourceEx",
                                      "addTimedTextSource",
                                      "setSubtitleAttr",
                                      "setPcmMediaInfo",
                                      "setPcmFlag",
                                      "setDataSourceByInputStream",
                                      "getMetaDataInfo",
                                      "setABRepeat",
                                      "QTVDEC_SendCliCommand",
                                      "setUnLockPin"}) ||
                       strstr(name, "Divx") != nullptr;
    return quiet ? kStaysQuiet : kThrows;
}

// The two whose strings are never given back.
size_t keptBuffers(const char* name) {
    return isAnyOf(name, {"addTimedTextSource", "QTVDEC_SendCliCommand"}) ? 1 : 0;
}

// After a failure the library goes on where the contract has it do so; and where the
// machine does not find its own thread, the library attaches it.
bool followsFailure(const std::string& violation) {
    const char* const consequences[] = {"with a pending", "null argument",
                                        "DetachCurrentThread: on a thread that runs Java"};
    return std::any_of(std::begin(consequences), std::end(consequences),
                       [&](const char* each) { return violation.find(each) != std::string::npos; });
}

struct Player {
    ObjectPtr object;
    bool wasSetUp = false;
    bool hasService = false;
    std::shared_ptr<orvtest::ScriptedEngine> engine;
    bool refuses = false;  // the engine answers other than with success
};

// Without the prefix.
#define NAME_OF(function) (&#function[sizeof("OrvMediaClient")])

class Calls {
public:
    explicit Calls(orvfuzz::Words& input) : words(input), surface(new android::Surface(producer)) {
        players[0].object = machine.player;
        players[1].object = machine.vm.newObject(orvtest::kPlayerClass);
    }

    void run() {
        for (int i = 0; i < kMostCalls && !words.atEnd(); i++) step(words.next());
    }

    void finish() {
        for (Player& each : players) {
            failing = 0;
            player = &each;
            if (each.hasService) call(*rowOf("release"));
        }
        streams.clear();
        require(producer->getStrongCount() == 2, "the surface's buffers have their holders back");
        machine.finish({0, buffers});
    }

private:
    static const Row* rowOf(std::string_view name) {
        static const Row rows[] = {
#define ROW(javaName, signature, function) \
    {NAME_OF(function), javaName, signature, absenceOf(NAME_OF(function))},
            ORV_NATIVE_METHODS(ROW)
#undef ROW
        };
        const auto row = std::find_if(std::begin(rows), std::end(rows),
                                      [&](const Row& each) { return name == each.name; });
        return row == std::end(rows) ? nullptr : row;
    }

    void step(std::string_view word) {
        if (word == "other") {
            player = &players[1];
            return;
        }
        if (word == "fail") {
            failing = words.below(64);
        } else if (word == "answer" || word == "put") {
            script(word == "answer");
        } else if (word == "tracks") {
            addTracks();
        } else if (const Row* row = rowOf(word)) {
            call(*row);
        }
        player = &players[0];
    }

    void script(bool isAnswer) {
        const std::string operation(words.next());
        const int value = words.int32();
        if (player->engine == nullptr) return;
        if (isAnswer) {
            player->engine->answer(operation, {value});
            player->refuses = true;
        } else if (operation.find("TrackCount") == std::string::npos) {
            player->engine->put(operation, value);
        }
    }

    void addTracks() {
        const int count = words.below(kMostTracks);
        if (player->engine == nullptr) return;
        for (const char* operation :
             {"getVideoTrackCount", "getAudioTrackCount", "getSubtitleTrackCount"}) {
            player->engine->put(operation, count);
        }
        for (int i = 0; i < count; i++) {
            player->engine->videoCodecs[i] = {};
            player->engine->audioTracks[i] = {};
            player->engine->subtitleTracks[i] = {};
        }
        player->engine->currentVideoCodec = VideoCodecInfo();
        player->engine->metaDataInfo = MetaDataInfo();
        player->engine->albumArt = std::vector<uint8_t>(static_cast<size_t>(count));
    }

    // Java sets a player up in its constructor: once. It makes no call to a class whose
    // initialization failed.
    bool isAllowed(const Row& row) const {
        if (strcmp(row.name, "init") == 0) return failing == 0;
        return strcmp(row.name, "setup") != 0 || !player->wasSetUp;
    }

    void call(const Row& row) {
        orvfuzz::NativeArguments arguments(machine, words, row.signature, surface);
        if (!isAllowed(row)) return;
        const size_t buffersBefore = machine.vm.unreleased().size();
        const size_t violationsBefore = machine.vm.violations().size();
        const int failuresBefore = machine.vm.failures();
        if (player->engine != nullptr) player->engine->takeCalls();
        const bool had = player->hasService;

        invoke(row, arguments);

        const bool failed = machine.vm.failures() != failuresBefore;
        machine.vm.forgetFailures();
        failing = 0;
        // A poster or a stream that the machine failed has fewer references.
        const bool makesReferences = isAnyOf(row.name, {"setup", "setDataSourceByInputStream"});
        lacksReferences = lacksReferences || (failed && makesReferences);
        followLife(row);
        takeStream(row);
        if (!failed) requireException(row, had);
        machine.vm.clearPending();
        requireRules(violationsBefore, failed);
        requireBuffers(row, buffersBefore);
        requireLife();
    }

    void invoke(const Row& row, orvfuzz::NativeArguments& arguments) {
#define ROW(javaName, signature, function)               \
    if (row.name == std::string_view(NAME_OF(function))) \
        return enter(android::function, javaName, signature, arguments);
        ORV_NATIVE_METHODS(ROW)
#undef ROW
    }

    template <typename R, typename Self, typename... A>
    void enter(R (*)(JNIEnv*, Self, A...), const char* name, const char* signature,
               orvfuzz::NativeArguments& arguments) {
        // Braces: the arguments are made in their order.
        const std::tuple<A...> made{arguments.next<A>()...};
        jobject thiz = machine.vm.local(std::is_same_v<Self, jclass> ? machine.playerClass.mirror
                                                                     : player->object);
        if (failing > 0) machine.vm.failNth(failing);
        std::apply(
            [&](A... each) {
                fakejni::callNative<R>(machine.vm, machine.playerClass, thiz, name, signature,
                                       each...);
            },
            made);
        require(orvfuzz::heldLocks() == 0, std::string(name) + " leaves no lock held");
    }

    void followLife(const Row& row) {
        if (strcmp(row.name, "setup") == 0) {
            player->wasSetUp = true;
            player->hasService = true;
            player->engine = orvtest::ScriptedEngine::last();
        } else if (isAnyOf(row.name, {"release", "finalize"})) {
            player->hasService = false;
            player->engine.reset();
            player->refuses = false;
        }
    }

    // The engine keeps the stream that it was given; here it does so to the end.
    void takeStream(const Row& row) {
        if (strcmp(row.name, "setDataSourceByInputStream") != 0 || !player->hasService) return;
        for (const std::string& text : player->engine->takeCalls()) {
            void* address = nullptr;
            if (sscanf(text.c_str(), "setDataSource(%p)", &address) != 1) continue;
            auto* source = static_cast<IOrvStreamSource*>(address);
            streams.emplace_back(static_cast<JavaInputStream*>(source));
        }
    }

    void requireException(const Row& row, bool had) {
        const auto thrown = machine.vm.pending();
        const std::string type = thrown.has_value() ? thrown->type : "";
        const std::string what =
            std::string(row.name) + " threw " + (type.empty() ? "nothing" : type);
        if (!had) {
            const bool throws = row.absence == kThrows;
            require(type == (throws ? "java/lang/IllegalStateException" : ""),
                    what + " without a service");
            return;
        }
        if (type.empty()) return;
        const std::set<std::string> ofStatus = {"java/lang/IllegalStateException",
                                                "java/lang/SecurityException",
                                                "java/io/IOException"};
        const bool ofArgument = type == "java/lang/IllegalArgumentException" &&
                                strncmp(row.name, "setDataSource", 13) == 0;
        const bool allowed = (player->refuses || !player->hasService) && ofStatus.count(type) != 0;
        require(allowed || ofArgument, what + " with an engine that refuses nothing");
    }

    void requireRules(size_t before, bool failed) {
        const std::vector<std::string> all = machine.vm.violations();
        for (size_t i = before; i < all.size(); i++) {
            require(failed && followsFailure(all[i]), all[i]);
            machine.tolerate(all[i]);
        }
    }

    void requireBuffers(const Row& row, size_t before) {
        const size_t kept = machine.vm.unreleased().size() - before;
        require(kept <= keptBuffers(row.name), std::string(row.name) + " gives its strings back");
        buffers += kept;
    }

    void requireLife() {
        size_t services = 0;
        for (const Player& each : players) {
            require((each.object->get("mNativeContext").integer != 0) == each.hasService,
                    "a player has its service from setup to release");
            services += each.hasService;
        }
        require(orvtest::ScriptedEngine::live() == static_cast<int>(services),
                "a service has one engine player");
        if (lacksReferences) return;
        require(machine.vm.globalReferences() == 2 * (services + streams.size()),
                "a service and a stream hold two references each");
    }

    orvfuzz::Words& words;
    orvfuzz::PlayerMachine machine;
    std::array<Player, 2> players;
    Player* player = &players[0];
    sp<orvtest::TestProducer> producer = new orvtest::TestProducer;
    sp<android::Surface> surface;
    std::vector<std::unique_ptr<JavaInputStream>> streams;
    size_t buffers = 0;
    int failing = 0;
    bool lacksReferences = false;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    orvfuzz::Words words(data, size);
    Calls calls(words);
    calls.run();
    calls.finish();
    return 0;
}
