// SPDX-License-Identifier: Apache-2.0
// The product's table of native methods with a function of ORV_PARAMETER in one row
// whose descriptor has an int. With jint it compiles; with another type it must not.
#include <jni/OrvMediaClient.h>

namespace android {
void ofAnotherType(JNIEnv*, jobject, ORV_PARAMETER);
}  // namespace android

#define OrvMediaClient_setAudioStreamType ofAnotherType
#include <jni/NativeMethodTable.cpp>
