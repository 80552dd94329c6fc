// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

namespace android {

// Why a registration of native methods failed, in error lines of the log.

void reportMissingClass(const char* className);

// Names each method that the class does not declare as a native method of that
// name and signature, with what it declares instead. The exception that is
// pending at the call is pending again afterwards.
void reportFailedRegistration(JNIEnv* env, jclass clazz, const char* className,
                              const JNINativeMethod* methods, int count);

}  // namespace android
