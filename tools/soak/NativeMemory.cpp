// SPDX-License-Identifier: Apache-2.0
#include <jni.h>
#include <malloc.h>
#include <string.h>

// Planted leaks must stay what they are under every optimisation.
static void* volatile gLeaked;

extern "C" {

JNIEXPORT void JNICALL Java_com_quintora_orv_soak_NativeMemory_trim(JNIEnv*, jclass) {
    malloc_trim(0);
}

JNIEXPORT jlong JNICALL Java_com_quintora_orv_soak_NativeMemory_inUse(JNIEnv*, jclass) {
    const struct mallinfo2 info = mallinfo2();
    return static_cast<jlong>(info.uordblks + info.hblkhd);
}

JNIEXPORT void JNICALL Java_com_quintora_orv_soak_NativeMemory_leak(JNIEnv*, jclass, jint bytes) {
    gLeaked = malloc(static_cast<size_t>(bytes));
    if (gLeaked != nullptr) memset(gLeaked, 1, static_cast<size_t>(bytes));
}

JNIEXPORT void JNICALL Java_com_quintora_orv_soak_NativeMemory_leakReference(JNIEnv* env, jclass,
                                                                             jobject object) {
    env->NewGlobalRef(object);
}

JNIEXPORT void JNICALL Java_com_quintora_orv_soak_NativeMemory_crash(JNIEnv*, jclass) {
    volatile int* nowhere = nullptr;
    *nowhere = 1;
}

}  // extern "C"
