// SPDX-License-Identifier: Apache-2.0
// The platform's functions that the product calls, for the trace: the linker sends
// the program's calls here. Each is one step; how it works is left out.
#include "PlatformCalls.h"

#include <android_runtime/AndroidRuntime.h>
#include <gui/Surface.h>
#include <nativehelper/JNIHelp.h>

#include <string>
#include <utility>

#include "Trace.h"

using orvtest::Trace;

extern "C" {

int __real_jniThrowException(C_JNIEnv* env, const char* type, const char* message);
int __real_jniGetFDFromFileDescriptor(C_JNIEnv* env, jobject descriptor);

int __real__ZN7android14AndroidRuntime21registerNativeMethodsEP7_JNIEnvPKcPK15JNINativeMethodi(
    JNIEnv* env, const char* type, const JNINativeMethod* rows, int count);

int __wrap_jniThrowException(C_JNIEnv* env, const char* type, const char* message) {
    Trace::add("throw", std::string(type) + (message ? " " + std::string(message) : ""));
    const Trace::Pause pause;
    return __real_jniThrowException(env, type, message);
}

int __wrap_jniGetFDFromFileDescriptor(C_JNIEnv* env, jobject descriptor) {
    Trace::add("platform", "jniGetFDFromFileDescriptor");
    const Trace::Pause pause;
    return __real_jniGetFDFromFileDescriptor(env, descriptor);
}

// AndroidRuntime::registerNativeMethods
int __wrap__ZN7android14AndroidRuntime21registerNativeMethodsEP7_JNIEnvPKcPK15JNINativeMethodi(
    JNIEnv* env, const char* type, const JNINativeMethod* rows, int count) {
    Trace::add("platform", "registerNativeMethods " + std::string(type));
    const Trace::Pause pause;
    return __real__ZN7android14AndroidRuntime21registerNativeMethodsEP7_JNIEnvPKcPK15JNINativeMethodi(
        env, type, rows, count);
}

}  // extern "C"

using android::sp;
using android::Surface;

sp<Surface> realGetSurface(JNIEnv* env, jobject surface) asm(
    "__real__ZN7android31android_view_Surface_getSurfaceEP7_JNIEnvP8_jobject");
sp<Surface> getSurface(JNIEnv* env, jobject surface) asm(
    "__wrap__ZN7android31android_view_Surface_getSurfaceEP7_JNIEnvP8_jobject");

sp<Surface> getSurface(JNIEnv* env, jobject surface) {
    Trace::add("platform", "android_view_Surface_getSurface");
    const Trace::Pause pause;
    return realGetSurface(env, surface);
}

namespace {

// The functions of a library take C's environment, too.
template <class Env>
auto isInLibrary(int) -> decltype(jniThrowException(std::declval<Env>(), "", ""), true) {
    return true;
}
template <class Env>
bool isInLibrary(long) {
    return false;
}

}  // namespace

bool orvtest::platformHelpersAreInline() { return !isInLibrary<C_JNIEnv*>(0); }
