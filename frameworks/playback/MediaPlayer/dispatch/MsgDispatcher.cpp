// SPDX-License-Identifier: Apache-2.0
#include "dispatch/MsgDispatcher.h"

#include <android_runtime/AndroidRuntime.h>
#include <binder/Parcel.h>
#include <nativehelper/JNIHelp.h>
#include <string.h>

#include "jni/BridgeLog.h"
#include "jni/ClientFields.h"
#include "jni/JavaVm.h"

using android::AndroidRuntime;
using android::gClientFields;
using android::Parcel;

namespace ORV {

MsgDispatcher::MsgDispatcher(JNIEnv* env, jobject thiz, jobject weak_thiz) {
    ALOGI("MsgDispatcher::MsgDispatcher(JNIEnv, jobject thiz, jobject weak_thiz): Enter\n");
    jclass clazz = env->GetObjectClass(thiz);
    if (clazz == nullptr) {
        ALOGE(
            "MsgDispatcher::MsgDispatcher(JNIEnv, jobject thiz, jobject weak_thiz): Can't find %s",
            android::kPlayerClassPath);
        jniThrowException(env, "java/lang/Exception", nullptr);
    }
    mClass = static_cast<jclass>(env->NewGlobalRef(clazz));
    mObject = env->NewGlobalRef(weak_thiz);
    ALOGI("MsgDispatcher::MsgDispatcher(JNIEnv, jobject thiz, jobject weak_thiz): Leave\n");
}

MsgDispatcher::~MsgDispatcher() {
    ALOGI("MsgDispatcher::~MsgDispatcher(): Enter\n");
    // Normally the last reference goes on a Java thread, in native_release. A
    // player that is released inside its own event loses it on the dispatcher's
    // thread, which is detached by then.
    JNIEnv* env = AndroidRuntime::getJNIEnv();
    const bool attached = env == nullptr && g__JavaVM != nullptr &&
                          g__JavaVM->AttachCurrentThread(&env, nullptr) >= 0;
    if (env != nullptr) {
        env->DeleteGlobalRef(mObject);
        env->DeleteGlobalRef(mClass);
    }
    if (attached) g__JavaVM->DetachCurrentThread();
    ALOGI("MsgDispatcher::~MsgDispatcher(): Leave\n");
}

void MsgDispatcher::notify(int msg, int ext1, int ext2, const Parcel* obj) {
    ALOGI("MsgDispatcher::notify(): Enter\n");
    if (g__JavaVM == nullptr) {
        ALOGI("MsgDispatcher::notify(): g__JavaVM==NULL\n");
        return;
    }
    ALOGI("MsgDispatcher::notify(): g__JavaVM[X] = %p\n", g__JavaVM);
    JNIEnv* env = AndroidRuntime::getJNIEnv();
    const jint attachResult = g__JavaVM->AttachCurrentThread(&env, nullptr);
    ALOGI("MsgDispatcher::notify(): i4AttachRet = %d\n", attachResult);

    if (obj == nullptr || obj->dataSize() == 0) {
        ALOGI("MsgDispatcher::notify(): 3\n");
        post(env, msg, ext1, ext2, nullptr);
    } else {
        ALOGI("MsgDispatcher::notify(): 1\n");
        postParcel(env, msg, ext1, ext2, *obj);
    }

    if (attachResult >= 0) {
        ALOGI("MsgDispatcher::notify(): DetachCurrentThread, begin\n");
        g__JavaVM->DetachCurrentThread();
        ALOGI("MsgDispatcher::notify(): DetachCurrentThread, end\n");
    }
    ALOGI("MsgDispatcher::notify(): Leave\n");
}

void MsgDispatcher::post(JNIEnv* env, int msg, int ext1, int ext2, jobject payload) {
    env->CallStaticVoidMethod(mClass, gClientFields.postEvent, mObject, msg, ext1, ext2, payload);
}

void MsgDispatcher::postParcel(JNIEnv* env, int msg, int ext1, int ext2, const Parcel& parcel) {
    const jsize size = static_cast<jsize>(parcel.dataSize());
    jbyteArray array = env->NewByteArray(size);
    if (array == nullptr) return;
    ALOGI("MsgDispatcher::notify(): 2\n");
    jbyte* bytes = env->GetByteArrayElements(array, nullptr);
    if (bytes != nullptr) {
        memcpy(bytes, parcel.data(), size);
        env->ReleaseByteArrayElements(array, bytes, 0);
        post(env, msg, ext1, ext2, array);
    }
    env->DeleteLocalRef(array);
}

}  // namespace ORV
