// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

namespace android {

// Compares a JNI method descriptor with a C++ function's type at compile time.
// A row of the table that pairs the wrong two does not compile.

constexpr bool isPrefix(const char* prefix, const char* text) {
    while (*prefix != '\0') {
        if (*prefix++ != *text++) return false;
    }
    return true;
}

// The descriptor behind an object type's, or null when it is none.
constexpr const char* skipObject(const char* descriptor) {
    if (*descriptor != 'L') return nullptr;
    while (*descriptor != ';') {
        if (*descriptor++ == '\0') return nullptr;
    }
    return descriptor + 1;
}

constexpr const char* skipPrefix(const char* prefix, const char* descriptor) {
    if (!isPrefix(prefix, descriptor)) return nullptr;
    while (*prefix++ != '\0') ++descriptor;
    return descriptor;
}

// JniType<T>::skip gives the descriptor behind T's, or null when it begins with
// another type's.
template <typename T>
struct JniType;
template <>
struct JniType<void> {
    static constexpr const char* skip(const char* d) { return skipPrefix("V", d); }
};
template <>
struct JniType<jboolean> {
    static constexpr const char* skip(const char* d) { return skipPrefix("Z", d); }
};
template <>
struct JniType<jint> {
    static constexpr const char* skip(const char* d) { return skipPrefix("I", d); }
};
template <>
struct JniType<jlong> {
    static constexpr const char* skip(const char* d) { return skipPrefix("J", d); }
};
template <>
struct JniType<jfloat> {
    static constexpr const char* skip(const char* d) { return skipPrefix("F", d); }
};
template <>
struct JniType<jstring> {
    static constexpr const char* skip(const char* d) { return skipPrefix("Ljava/lang/String;", d); }
};
template <>
struct JniType<jbyteArray> {
    static constexpr const char* skip(const char* d) { return skipPrefix("[B", d); }
};
template <>
struct JniType<jobjectArray> {
    static constexpr const char* skip(const char* d) {
        return *d == '[' ? skipObject(d + 1) : nullptr;
    }
};
template <>
struct JniType<jobject> {
    // A string has a type of its own.
    static constexpr const char* skip(const char* d) {
        return isPrefix("Ljava/lang/String;", d) ? nullptr : skipObject(d);
    }
};

template <typename Function>
struct NativeMethodSignature;

template <typename Result, typename Receiver, typename... Arguments>
struct NativeMethodSignature<Result (*)(JNIEnv*, Receiver, Arguments...)> {
    static constexpr bool matches(const char* descriptor) {
        const char* rest = skipPrefix("(", descriptor);
        ((rest = rest != nullptr ? JniType<Arguments>::skip(rest) : nullptr), ...);
        rest = rest != nullptr ? skipPrefix(")", rest) : nullptr;
        rest = rest != nullptr ? JniType<Result>::skip(rest) : nullptr;
        return rest != nullptr && *rest == '\0';
    }
};

}  // namespace android
