// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <utils/RefBase.h>

namespace android {

class Surface;

// The native surface of an android.view.Surface; null once it was released.
extern sp<Surface> android_view_Surface_getSurface(JNIEnv* env, jobject surfaceObj);

}  // namespace android
