// SPDX-License-Identifier: Apache-2.0
// The native method that makes a Java player its own source of media bytes.

#include <nativehelper/JNIHelp.h>

#include <new>

#include "jni/BridgeLog.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"
#include "stream/JavaInputStream.h"

namespace android {

void OrvMediaClient_setDataSourceByInputStream(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("service not exist,throw exception. Line:%d\n", 3471);  // nothing is thrown
        return;
    }
    JavaInputStream* stream = new (std::nothrow) JavaInputStream(env, thiz);
    if (stream == nullptr) {
        ALOGE(
            "OrvMediaClient_setDataSourceByInputStream(): out of memory, new JavaInputStream "
            "failed, throw exception\n");
        jniThrowException(env, "java/lang/RuntimeException", "Out of memory");
        return;
    }
    // The stream is the engine's from here on, whatever the engine answers.
    if (service->setDataSource(stream) != NO_ERROR) {
        ALOGE("OrvMediaClient_setDataSourceByInputStream(): service set failed\n");
    }
    logLeave(__func__);
}

}  // namespace android
