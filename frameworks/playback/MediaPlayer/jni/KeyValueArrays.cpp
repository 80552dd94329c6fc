// SPDX-License-Identifier: Apache-2.0
#include "jni/KeyValueArrays.h"

#include <log/log.h>
#include <nativehelper/JNIHelp.h>

#include "jni/JavaString.h"

#undef LOG_TAG
#define LOG_TAG "Customer_media_Utils"

namespace android {

namespace {

bool lengthsDiffer(JNIEnv* env, jobjectArray keys, jobjectArray values) {
    if (keys == nullptr || values == nullptr) return keys != values;
    return env->GetArrayLength(keys) != env->GetArrayLength(values);
}

bool addPair(JNIEnv* env, jstring key, jstring value, KeyedVector<String8, String8>* out) {
    const char* keyChars = stringChars(env, key);
    if (keyChars == nullptr) return false;
    const char* valueChars = stringChars(env, value);
    if (valueChars == nullptr) {
        env->ReleaseStringUTFChars(key, keyChars);
        return false;
    }
    out->add(String8(keyChars), String8(valueChars));
    env->ReleaseStringUTFChars(key, keyChars);
    env->ReleaseStringUTFChars(value, valueChars);
    env->DeleteLocalRef(key);
    env->DeleteLocalRef(value);
    return true;
}

}  // namespace

bool ConvertKeyValueArraysToKeyedVector(JNIEnv* env, jobjectArray keys, jobjectArray values,
                                        KeyedVector<String8, String8>* out) {
    if (lengthsDiffer(env, keys, values)) {
        ALOGE("keys and values arrays have different length");
        jniThrowException(env, "java/lang/IllegalArgumentException", nullptr);
        return false;
    }
    const jsize count = keys != nullptr ? env->GetArrayLength(keys) : 0;
    for (jsize i = 0; i < count; ++i) {
        jstring key = static_cast<jstring>(env->GetObjectArrayElement(keys, i));
        jstring value = static_cast<jstring>(env->GetObjectArrayElement(values, i));
        if (!addPair(env, key, value, out)) return false;
    }
    return true;
}

}  // namespace android
