// SPDX-License-Identifier: Apache-2.0
#include "jni/media-service/MediaClientListener.h"

#include "dispatch/SyncToAsync.h"
#include "jni/BridgeLog.h"

MediaClientListener::MediaClientListener() {
    ALOGI(
        "MediaClientListener::MediaClientListener(JNIEnv, jobject thiz, jobject weak_thiz): "
        "Enter\n");
    ALOGI(
        "MediaClientListener::MediaClientListener(JNIEnv, jobject thiz, jobject weak_thiz): "
        "Leave\n");
}

MediaClientListener::~MediaClientListener() {
    ALOGI("MediaClientListener::~MediaClientListener(): Enter\n");
    ALOGI("MediaClientListener::~MediaClientListener(): Leave\n");
}

void MediaClientListener::notify(int msg, int ext1, int ext2, const android::Parcel* obj) {
    ALOGI("MediaClientListener::notify(): Enter\n");
    ORV::SyncToAsyncAction* action = new ORV::SyncToAsyncAction();
    action->payload = new NotifyMessage{msg, ext1, ext2, obj};
    // The action's service stays empty, so the dispatcher finds no poster for
    // it and discards it: events of this path end there.
    action->valid = true;
    ORV::SyncToAsync::getInstance()->addAction(action);
    ALOGI("MediaClientListener::notify(): Leave\n");
}
