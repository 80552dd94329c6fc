// SPDX-License-Identifier: Apache-2.0
#include <jni.h>

namespace {

// More than a native method may hold without asking for room.
const int kTooMany = 40;

}  // namespace

#define MISTAKE(name) extern "C" JNIEXPORT void JNICALL Java_PlantedMistakes_##name

MISTAKE(keepReferences)(JNIEnv* env, jclass) {
    for (int i = 0; i < kTooMany; ++i) env->NewStringUTF("kept");
}

MISTAKE(deleteReferences)(JNIEnv* env, jclass) {
    for (int i = 0; i < kTooMany; ++i) env->DeleteLocalRef(env->NewStringUTF("deleted"));
}

MISTAKE(callUnchecked)(JNIEnv* env, jclass clazz) {
    jmethodID const method = env->GetStaticMethodID(clazz, "nothing", "()V");
    env->CallStaticVoidMethod(clazz, method);
    env->CallStaticVoidMethod(clazz, method);
}

MISTAKE(callChecked)(JNIEnv* env, jclass clazz) {
    jmethodID const method = env->GetStaticMethodID(clazz, "nothing", "()V");
    env->CallStaticVoidMethod(clazz, method);
    if (!env->ExceptionCheck()) env->CallStaticVoidMethod(clazz, method);
}
