// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <orvtarn/RecordText.h>

namespace android {

// An instance method of the Java player class, looked up anew for each native
// call. Null, with one of the two lines in the log, when the class (the first
// line's argument is its path) or the method is missing.
jmethodID findCallback(JNIEnv* env, const char* name, const char* signature,
                       const char* classMissing, const char* methodMissing);

// A record's UTF-16 text as a Java string: up to its first zero unit.
jstring newString(JNIEnv* env, OrvWideText& text);

}  // namespace android
