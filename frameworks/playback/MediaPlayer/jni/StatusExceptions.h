// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <utils/Errors.h>
#include <utils/RefBase.h>

#include "jni/media-service/OrvMediaService.h"

namespace android {

// Throws the Java exception for a service's status; nothing for 0. exception is
// a class path, message may be null. The exception stays pending: the caller
// goes on and returns.
void process_media_player_call(JNIEnv* env, jobject thiz, status_t status, const char* exception,
                               const char* message);

// The line for a player without a service; line is that of the check.
void logMissingService(int line = __builtin_LINE());

// The service of a Java player. Without one: the line, an
// IllegalStateException and null.
sp<OrvMediaService> serviceOrThrow(JNIEnv* env, jobject thiz, int line = __builtin_LINE());

}  // namespace android
