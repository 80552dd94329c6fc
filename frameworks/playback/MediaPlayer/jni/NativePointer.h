// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <stdint.h>

namespace android {

// Pointers kept in Java long fields: zero-extended on the way out, cut to a
// pointer's width on the way in.
inline jlong toJavaLong(const void* pointer) {
    return static_cast<jlong>(reinterpret_cast<uintptr_t>(pointer));
}

template <typename T>
T* fromJavaLong(jlong value) {
    return reinterpret_cast<T*>(static_cast<uintptr_t>(value));
}

}  // namespace android
