// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <stdint.h>

namespace android {

// A counted object in a Java long: the long carries one strong reference. T is
// always the type the object was stored as.

// The id of those references; any fixed address does.
inline const int kJavaReference = 0;

template <typename T>
T* fromHandle(jlong handle) {
    return reinterpret_cast<T*>(static_cast<uintptr_t>(handle));
}

template <typename T>
jlong toHandle(T* object) {
    return static_cast<jlong>(reinterpret_cast<uintptr_t>(object));
}

}  // namespace android
