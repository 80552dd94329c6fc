// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <jni.h>

namespace android {

// A new android.view.Surface over the producer, which it holds; null with a Java
// exception pending when it cannot be made. For native methods: the class is
// looked for by the class loader of their class.
jobject newJavaSurface(JNIEnv* env, IGraphicBufferProducer* producer);

}  // namespace android
