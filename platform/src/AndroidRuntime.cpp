// SPDX-License-Identifier: Apache-2.0
#include <android_runtime/AndroidRuntime.h>
#include <dlfcn.h>

#include <atomic>

#include "RegistrationReport.h"

namespace android {

namespace {

std::atomic<JavaVM*> sJavaVM{nullptr};

// The process's virtual machine when nobody registered methods through us. It
// is asked in the machine's own library by name: another library of the
// process exports the same function and ends the process when called.
JavaVM* findCreatedJavaVM() {
    void* const library = dlopen("libjvm.so", RTLD_NOW | RTLD_NOLOAD);
    if (library == nullptr) return nullptr;
    using GetCreatedJavaVMs = jint (*)(JavaVM**, jsize, jsize*);
    const auto getCreated =
        reinterpret_cast<GetCreatedJavaVMs>(dlsym(library, "JNI_GetCreatedJavaVMs"));
    JavaVM* vm = nullptr;
    jsize count = 0;
    if (getCreated == nullptr || getCreated(&vm, 1, &count) != JNI_OK || count == 0) vm = nullptr;
    dlclose(library);
    return vm;
}

}  // namespace

int AndroidRuntime::registerNativeMethods(JNIEnv* env, const char* className,
                                          const JNINativeMethod* methods, int count) {
    JavaVM* vm = nullptr;
    if (env->GetJavaVM(&vm) == JNI_OK && vm != nullptr) sJavaVM.store(vm);

    jclass clazz = env->FindClass(className);
    if (clazz == nullptr) {
        reportMissingClass(className);
        return -1;
    }
    const bool registered = env->RegisterNatives(clazz, methods, count) == JNI_OK;
    if (!registered) reportFailedRegistration(env, clazz, className, methods, count);
    env->DeleteLocalRef(clazz);
    return registered ? 0 : -1;
}

JavaVM* AndroidRuntime::getJavaVM() {
    JavaVM* const vm = sJavaVM.load();
    return vm != nullptr ? vm : findCreatedJavaVM();
}

JNIEnv* AndroidRuntime::getJNIEnv() {
    JavaVM* const vm = getJavaVM();
    void* env = nullptr;
    if (vm == nullptr || vm->GetEnv(&env, JNI_VERSION_1_4) != JNI_OK) return nullptr;
    return static_cast<JNIEnv*>(env);
}

}  // namespace android
