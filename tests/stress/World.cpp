// SPDX-License-Identifier: Apache-2.0
#include "World.h"

#include <jni/ClientFields.h>
#include <jni/JavaVm.h>

#include <algorithm>
#include <utility>

#include "FakeJni/NativeCall.h"
#include "JavaMembers.h"

namespace stress {

using android::sp;
using fakejni::ObjectPtr;
using fakejni::Value;

void Faults::add(const std::string& text) {
    std::lock_guard<std::mutex> lock(mMutex);
    if (mTexts.size() < 20) mTexts.push_back(text);
}

std::vector<std::string> Faults::take() {
    std::lock_guard<std::mutex> lock(mMutex);
    return std::exchange(mTexts, {});
}

namespace {

int32_t holdersOf(const sp<android::Surface>& surface) {
    return surface->getIGraphicBufferProducer()->getStrongCount();
}

}  // namespace

World::World() : playerClass(orvtest::definePlayerClasses(vm)) {
    orvtest::defineJavaMembers(vm, ORV_JAVA_MEMBERS);
    vm.find("java/lang/ref/WeakReference")->field("mNumber", "I");
    playerClass.findMethod("readStream", "(I)I", false)->implementation =
        [](const fakejni::Invocation& call) {
            const int64_t asked = call.args.at(0).integer;
            return Value::ofInt(static_cast<jint>(std::min<int64_t>(asked, kReadBufferSize)));
        };
    for (int i = 0; i < 3; ++i) {
        const sp<android::IGraphicBufferProducer> producer = new orvtest::TestProducer;
        mSurfaces.push_back(new android::Surface(producer));
    }
    for (const auto& surface : mSurfaces) mSurfaceCounts.push_back(holdersOf(surface));
    g__JavaVM = nullptr;
    android::gClientFields = {};
    if (JNI_OnLoad(vm.javaVm(), nullptr) != JNI_VERSION_1_4) faults.add("JNI_OnLoad failed");
    const LocalFrame frame(vm);
    fakejni::callNative<void>(vm, playerClass, vm.local(playerClass.mirror), "native_init", "()V");
}

World::~World() { g__JavaVM = nullptr; }

Player World::newPlayer() {
    const uint32_t number = ++mPlayers;
    ObjectPtr player = vm.newObject(orvtest::kPlayerClass);
    player->set("mStreamSize", Value::ofLong(1000000 + number));
    player->set("mStreamCurPos", Value::ofLong(2000000 + number));
    player->set("mStreamDuration", Value::ofLong(3000000 + number));
    const std::vector<uint8_t> bytes(kReadBufferSize, static_cast<uint8_t>(number));
    player->set("mStreamReadBuffer", Value::of(vm.newBytes(bytes)));
    return {player, number};
}

ObjectPtr World::newWeakReference(const Player& player) {
    ObjectPtr reference = vm.newObject("java/lang/ref/WeakReference");
    reference->set("mNumber", Value::ofInt(static_cast<jint>(player.number)));
    return reference;
}

uint32_t World::numberOf(const ObjectPtr& weakReference) {
    return static_cast<uint32_t>(weakReference->get("mNumber").integer);
}

// Numbers are small, so that a record also makes sense as a size of a picture.
ObjectPtr World::newRecord(const std::string& path, uint32_t choice) {
    ObjectPtr record = vm.newObject(path);
    for (fakejni::Class* type = record->type; type != nullptr; type = type->super) {
        for (const auto& field : type->fields) {
            if (field->isStatic) continue;
            const std::string& signature = field->signature;
            if (signature.size() > 1 && signature[0] == 'L') {
                const std::string child = signature.substr(1, signature.size() - 2);
                record->set(field->name, Value::of(newRecord(child, choice)));
            } else if (signature.size() == 1) {
                Value value = Value::zero(signature[0]);
                value.integer = choice % 16;
                record->set(field->name, value);
            }
        }
    }
    return record;
}

ObjectPtr World::newArgument(const std::string& path, uint32_t choice) {
    if (path == "java/lang/String") return vm.newString("/media/" + std::to_string(choice));
    if (path == "[java/lang/String") {
        return vm.newArray("java/lang/String", {vm.newString("key" + std::to_string(choice))});
    }
    if (path == "android/os/Parcel") return nullptr;
    if (path == "java/io/FileDescriptor") return orvtest::newFileDescriptor(vm, 0);
    if (path == "android/view/Surface") {
        if (choice % 4 == 3) return nullptr;
        return orvtest::newJavaSurface(vm, mSurfaces[choice % mSurfaces.size()]);
    }
    return newRecord(path, choice);
}

bool World::surfacesAreFree() const {
    for (size_t i = 0; i < mSurfaces.size(); ++i) {
        if (holdersOf(mSurfaces[i]) != mSurfaceCounts[i]) return false;
    }
    return true;
}

LocalFrame::LocalFrame(fakejni::Vm& vm) : mVm(vm), mMark(fakejni::markOf(vm)) {}

LocalFrame::~LocalFrame() {
    const std::lock_guard<fakejni::MachineMutex> lock(mVm.mutex());
    mVm.references().dropLocalsSince(mMark, fakejni::threadNumber());
}

}  // namespace stress
