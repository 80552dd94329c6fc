// SPDX-License-Identifier: Apache-2.0
#include "jni/StatusExceptions.h"

#include <nativehelper/JNIHelp.h>
#include <stdio.h>
#include <string.h>

#include "jni/BridgeLog.h"
#include "jni/PlayerContext.h"

namespace android {

namespace {

// Longer messages are thrown as they are: the status would not fit behind them.
const size_t kMaxFormattedMessage = 230;

void throwWithStatus(JNIEnv* env, status_t status, const char* exception, const char* message) {
    if (message == nullptr) {
        // Whatever class the caller asked for.
        ALOGE("process_media_player_call(): else 3, throw exception\n");
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
    } else if (strlen(message) > kMaxFormattedMessage) {
        ALOGE("process_media_player_call(): else 1, throw exception\n");
        jniThrowException(env, exception, message);
    } else {
        char text[256];
        snprintf(text, sizeof(text), "%s: status=0x%X", message, static_cast<uint32_t>(status));
        ALOGE("process_media_player_call(): else 2, throw exception\n");
        jniThrowException(env, exception, text);
    }
}

}  // namespace

void process_media_player_call(JNIEnv* env, jobject, status_t status, const char* exception,
                               const char* message) {
    if (exception == nullptr) {
        // Despite the text nothing is thrown.
        if (status != NO_ERROR) {
            ALOGE("process_media_player_call(): exception==NULL, throw exception\n");
        }
    } else if (status == INVALID_OPERATION) {
        ALOGE("process_media_player_call(): INVALID_OPERATION, throw exception\n");
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
    } else if (status == PERMISSION_DENIED) {
        ALOGE("process_media_player_call(): PERMISSION_DENIED, throw exception\n");
        jniThrowException(env, "java/lang/SecurityException", nullptr);
    } else if (status != NO_ERROR) {
        throwWithStatus(env, status, exception, message);
    }
}

void logMissingService(int line) { ALOGE("service not exist, throw exception. Line:%d\n", line); }

sp<OrvMediaService> serviceOrThrow(JNIEnv* env, jobject thiz, int line) {
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        logMissingService(line);
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
    }
    return service;
}

}  // namespace android
