// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <orvtarn/PlayerTypes.h>
#include <utils/RefBase.h>

#include "jni/media-service/OrvMediaService.h"

namespace android {

// The service of a Java player, kept in its field mNativeContext; null when it
// has none. Never blocks for longer than the field's access.
sp<OrvMediaService> getMediaService(JNIEnv* env, jobject thiz);

// Puts a service, or null, into the Java player and returns the previous one.
// The field holds one strong reference, under the Java object as its id.
sp<OrvMediaService> setMediaService(JNIEnv* env, jobject thiz, const sp<OrvMediaService>& service);

// Attaches a new engine player to the service.
void createPlayer(JNIEnv* env, sp<OrvMediaService> service, E_OrvPlayer_Type type);

}  // namespace android
