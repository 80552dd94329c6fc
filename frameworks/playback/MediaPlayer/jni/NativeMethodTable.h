// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

namespace android {

// Registers the native methods on the Java player class. Negative, with the
// virtual machine's exception pending, when the class does not declare one of
// them exactly so.
int register_OrvMediaClient(JNIEnv* env);

}  // namespace android
