// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

namespace android {

// The modified UTF-8 characters of a Java string, to be released with
// ReleaseStringUTFChars; null when there are none to be had. A null string has
// none: not every virtual machine takes it.
inline const char* stringChars(JNIEnv* env, jstring string) {
    return string != nullptr ? env->GetStringUTFChars(string, nullptr) : nullptr;
}

}  // namespace android
