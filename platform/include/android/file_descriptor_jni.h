// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#ifdef __cplusplus
extern "C" {
#endif

// The descriptor in a java.io.FileDescriptor: a new object without one, its
// number, and another number for it. The number is -1 for a closed descriptor
// and for an object of another kind, which leaves an exception pending.
jobject AFileDescriptor_create(JNIEnv* env);
int AFileDescriptor_getFd(JNIEnv* env, jobject fileDescriptor);
void AFileDescriptor_setFd(JNIEnv* env, jobject fileDescriptor, int fd);

#ifdef __cplusplus
}
#endif
