// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <jni.h>
#include <utils/RefBase.h>

namespace android {

// Binds a Java surface, or null, to a Java player. The producer's address stands
// in the field mNativeSurfaceTexture, which no lock guards: one thread at a
// time binds surfaces to one player.
void setVideoSurface(JNIEnv* env, jobject thiz, jobject jsurface, bool mediaPlayerMustBeAlive);

// Gives up the Java player's reference to its producer. The field keeps the
// address until the next binding.
void decVideoSurfaceRef(JNIEnv* env, jobject thiz);

// The producer bound last; null for none.
sp<IGraphicBufferProducer> getVideoSurfaceTexture(JNIEnv* env, jobject thiz);

}  // namespace android
