// SPDX-License-Identifier: Apache-2.0
#include "jni/JavaCallback.h"

#include "jni/BridgeLog.h"
#include "jni/ClientFields.h"
#include "jni/JavaFieldReaders.h"

namespace android {

jmethodID findCallback(JNIEnv* env, const char* name, const char* signature,
                       const char* classMissing, const char* methodMissing) {
    jclass clazz = env->FindClass(kPlayerClassPath);
    if (clazz == nullptr) {
        ALOGE(classMissing, kPlayerClassPath);
        return nullptr;
    }
    jmethodID method = env->GetMethodID(clazz, name, signature);
    if (method == nullptr) ALOGE("%s", methodMissing);
    return method;
}

jstring newString(JNIEnv* env, OrvWideText& text) {
    return env->NewString(text, OrvMediaClient_shortLength(text, ORV_TEXT_UNITS));
}

}  // namespace android
