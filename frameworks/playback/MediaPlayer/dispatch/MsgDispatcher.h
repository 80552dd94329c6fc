// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <utils/RefBase.h>

#include "os/Export.h"

namespace android {
class Parcel;
}

namespace ORV {

// Posts events to one Java player's class. Made on a Java thread, destroyed on
// any; notify attaches the calling thread for the call and blocks until Java is
// done with the event.
class ORV_EXPORT MsgDispatcher : public virtual android::RefBase {
public:
    // weak_thiz: the Java side's weak reference to the player.
    MsgDispatcher(JNIEnv* env, jobject thiz, jobject weak_thiz);
    ~MsgDispatcher() override;

    // obj: handed over as a byte[] of its raw content; null or empty as null.
    void notify(int msg, int ext1, int ext2, const android::Parcel* obj);

private:
    void post(JNIEnv* env, int msg, int ext1, int ext2, jobject payload);
    void postParcel(JNIEnv* env, int msg, int ext1, int ext2, const android::Parcel& parcel);

    jclass mClass;    // global reference
    jobject mObject;  // global reference to the weak reference object
};

}  // namespace ORV
