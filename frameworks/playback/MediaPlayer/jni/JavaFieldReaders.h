// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#include "os/Export.h"

namespace android {

// Read one field of a Java object by class path and field name, looking both up
// on every call. False, with the output untouched and a line in the log, for a
// null argument and for a class or field that does not exist; the virtual
// machine's exception then stays pending. The object itself is not examined.

ORV_EXPORT bool getIntValueFromJava(JNIEnv* env, const char* classPath, jobject object,
                                    const char* name, int& out);
ORV_EXPORT bool getByteValueFromJava(JNIEnv* env, const char* classPath, jobject object,
                                     const char* name, char& out);
// True when the field's byte is not zero.
ORV_EXPORT bool getBoolValueFromJava(JNIEnv* env, const char* classPath, jobject object,
                                     const char* name, bool& out);
// The child, possibly null, as a local reference of the caller's.
ORV_EXPORT bool getObjValueFromJava(JNIEnv* env, const char* classPath, jobject object,
                                    const char* name, const char* signature, jobject& out);

// UTF-16 units before the first zero unit, at most max.
ORV_EXPORT int OrvMediaClient_shortLength(unsigned short* text, int max);

}  // namespace android
