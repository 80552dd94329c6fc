// SPDX-License-Identifier: Apache-2.0
#include "Natives.h"

#include <jni/DivxNavigation.h>
#include <jni/OrvMediaClient.h>
#include <stdio.h>
#include <stdlib.h>

#include <algorithm>
#include <set>
#include <tuple>

#include "FakeJni/NativeCall.h"
#include "NativeMethodRows.h"
#include "Progress.h"

namespace stress {

namespace {

using fakejni::ObjectPtr;

// The class paths of a signature's reference parameters, in order; an array's begins
// with a bracket.
std::vector<std::string> referencesOf(const std::string& signature) {
    std::vector<std::string> paths;
    for (size_t i = 1; signature[i] != ')'; ++i) {
        const bool isArray = signature[i] == '[';
        if (isArray) ++i;
        if (signature[i] != 'L') continue;
        const size_t end = signature.find(';', i);
        paths.push_back((isArray ? "[" : "") + signature.substr(i + 1, end - i - 1));
        i = end;
    }
    return paths;
}

// Makes one call's arguments from left to right.
class Arguments {
public:
    Arguments(World& world, Random& random, const std::string& signature)
        : mWorld(world), mRandom(random), mPaths(referencesOf(signature)) {}

    template <typename T>
    T next() {
        if constexpr (std::is_pointer_v<T>) {
            const ObjectPtr object = mWorld.newArgument(mPaths.at(mUsed++), mRandom.below(256));
            return object == nullptr ? nullptr : mWorld.vm.local<T>(object);
        } else if constexpr (std::is_same_v<T, jboolean>) {
            return static_cast<jboolean>(mRandom.below(2));
        } else {
            return static_cast<T>(static_cast<int>(mRandom.below(10)) - 1);
        }
    }

private:
    World& mWorld;
    Random& mRandom;
    const std::vector<std::string> mPaths;
    size_t mUsed = 0;
};

template <auto Function>
struct Caller;

template <typename R, typename Self, typename... A, R (*Function)(JNIEnv*, Self, A...)>
struct Caller<Function> {
    static void call(World& world, Random& random, const ObjectPtr& player, const Native& row) {
        jobject thiz = world.vm.local(player);
        Arguments arguments(world, random, row.signature);
        (void)arguments;
        std::apply(
            [&](A... values) {
                fakejni::callNative<R>(world.vm, world.playerClass, thiz, row.name, row.signature,
                                       values...);
            },
            std::tuple<A...>{arguments.template next<A>()...});
    }
};

bool touchesSurface(const std::string& name) {
    static const std::set<std::string> names = {"native_setVideoSurface", "native_prepare",
                                                "native_prepareAsync", "native_release",
                                                "native_finalize"};
    return names.count(name) != 0;
}

bool releases(const std::string& name) {
    return name == "native_release" || name == "native_finalize";
}

// A player that was released raises the first; an argument that is not taken, the others.
bool isExpected(const std::string& native, const std::string& exception) {
    return exception == "java/lang/IllegalStateException" ||
           (exception == "java/io/IOException" && native == "native_setAudioSessionId");
}

}  // namespace

const std::vector<Native>& natives() {
    static const std::vector<Native> all = [] {
        std::vector<Native> rows;
#define ROW(name, signature, function)                                                            \
    rows.push_back({name, touchesSurface(name), releases(name), Caller<&android::function>::call, \
                    signature});
        ORV_NATIVE_METHODS(ROW)
#undef ROW
        const auto isApart = [](const Native& row) {
            return row.name == "native_init" || row.name == "native_setup";
        };
        rows.erase(std::remove_if(rows.begin(), rows.end(), isApart), rows.end());
        return rows;
    }();
    return all;
}

const Native& native(const std::string& name) {
    for (const Native& row : natives()) {
        if (row.name == name) return row;
    }
    fprintf(stderr, "no native %s\n", name.c_str());
    abort();
}

void callOn(World& world, Random& random, const ObjectPtr& player, const Native& row) {
    {
        const LocalFrame frame(world.vm);
        row.call(world, random, player, row);
    }
    const auto thrown = world.vm.pending();
    world.vm.clearPending();
    if (thrown && !isExpected(row.name, thrown->type)) {
        world.faults.add(row.name + row.signature + " threw " + thrown->type);
    }
    step();
}

void setUp(World& world, const Player& player) {
    const LocalFrame frame(world.vm);
    jobject weak = world.vm.local(world.newWeakReference(player));
    fakejni::callNative<void>(world.vm, world.playerClass, world.vm.local(player.object),
                              "native_setup", "(Ljava/lang/Object;)V", weak);
    if (const auto thrown = world.vm.pending()) {
        world.vm.clearPending();
        world.faults.add("native_setup threw " + thrown->type);
    }
    step();
}

}  // namespace stress
