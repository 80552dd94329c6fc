// SPDX-License-Identifier: Apache-2.0
// JNI_OnLoad: the one way into the library that is not a row of the table.

#include <jni.h>

#include "jni/BridgeLog.h"
#include "jni/JavaVm.h"
#include "jni/NativeMethodTable.h"
#include "os/Export.h"

JavaVM* g__JavaVM = nullptr;

extern "C" ORV_EXPORT jint JNI_OnLoad(JavaVM* vm, void*) {
    g__JavaVM = vm;  // stays set even when loading fails
    ALOGI("JNI_OnLoad():  g__JavaVM[X] = %p\n", g__JavaVM);
    JNIEnv* env = nullptr;
    if (vm->GetEnv(reinterpret_cast<void**>(&env), JNI_VERSION_1_4) != JNI_OK) {
        ALOGE("ERROR: GetEnv failed\n");
        return -1;
    }
    if (android::register_OrvMediaClient(env) < 0) {
        ALOGE("ERROR: BrixMediaPlayer native registration failed\n");
        return -1;
    }
    return JNI_VERSION_1_4;
}
