// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

namespace orvbench {

// The least that can be done for the same effect: what the library's figures
// are held against.

// Before the others: gives com.quintora.mmp.EmptyNative its method and finds the
// player's members. False, with an exception, when there are no such.
bool prepareByHand(JNIEnv* env);

// Attaches the thread, has the player's readStream fill its array, copies the
// array once, detaches. Java's count.
int readByHand(JavaVM* java, jobject player, char* buffer, int length);

// Attaches the thread, calls the player's class with an event, detaches.
void postByHand(JavaVM* java, jclass players, jobject weakPlayer, int what);

// A call that no compiler can see through.
class Virtual {
public:
    virtual ~Virtual() = default;
    virtual int position(int* msec) = 0;
};
Virtual& someVirtual();

}  // namespace orvbench

// For JNA and the foreign-function interface: a function of C.
extern "C" __attribute__((visibility("default"))) int orv_bench_nothing();
