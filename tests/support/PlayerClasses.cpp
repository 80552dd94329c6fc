// SPDX-License-Identifier: Apache-2.0
#include "PlayerClasses.h"

#include <string.h>

#include "NativeMethodRows.h"

namespace orvtest {

namespace {

void declareNatives(fakejni::Class& player) {
#define ROW(name, signature, function) \
    player.nativeMethod(name, signature, strcmp(name, "native_init") == 0);
    ORV_NATIVE_METHODS(ROW)
#undef ROW
}

void declareMembers(fakejni::Class& player) {
    player.field("mNativeContext", "J");
    player.field("mNativeSurfaceTexture", "J");
    player.field("mStreamReadBuffer", "[B");
    player.field("mStreamSize", "J");
    player.field("mStreamCurPos", "J");
    player.field("mStreamDuration", "J");
    player.field("mStreamSeekable", "Z");
    player.field("mStallingSupport", "Z");
    player.field("mDataSourceType", "I");
    player.method("readStream", "(I)I");
    player.method("seekStream", "(IJ)J");
    player.method("seekStreamEx", "(IJ)J");
    player.method("timeSeekStream", "(JJ)J");
    player.method("cancelRead", "()V");
    player.method("closeStream", "()V");
    player.method("getSeekType", "()I");
    player.staticMethod("postEventFromNative", "(Ljava/lang/Object;IIILjava/lang/Object;)V");
}

}  // namespace

fakejni::Class& definePlayerClasses(fakejni::Vm& vm) {
    vm.define("java/lang/ref/WeakReference");
    vm.define("android/os/Parcel");
    vm.define("android/view/Surface").field("mNativeObject", "J");
    fakejni::Class& descriptor = vm.define("java/io/FileDescriptor");
    descriptor.field("fd", "I");
    descriptor.field("descriptor", "I");
    fakejni::Class& player = vm.define(kPlayerClass);
    declareMembers(player);
    declareNatives(player);
    return player;
}

fakejni::ObjectPtr newJavaSurface(fakejni::Vm& vm, const android::sp<android::Surface>& surface) {
    fakejni::ObjectPtr object = vm.newObject("android/view/Surface");
    object->set(
        "mNativeObject",
        fakejni::Value::ofLong(static_cast<jlong>(reinterpret_cast<uintptr_t>(surface.get()))));
    return object;
}

fakejni::ObjectPtr newFileDescriptor(fakejni::Vm& vm, int fd) {
    fakejni::ObjectPtr object = vm.newObject("java/io/FileDescriptor");
    object->set("fd", fakejni::Value::ofInt(fd));
    object->set("descriptor", fakejni::Value::ofInt(fd));
    return object;
}

}  // namespace orvtest
