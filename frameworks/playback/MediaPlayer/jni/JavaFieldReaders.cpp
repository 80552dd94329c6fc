// SPDX-License-Identifier: Apache-2.0
#include "jni/JavaFieldReaders.h"

#include <log/log.h>

#undef LOG_TAG
#define LOG_TAG "Customer_media_Utils"

namespace android {

namespace {

// What the int, byte and bool readers do alike. The word SubtitleAttr is part
// of the text, whatever the class.
jfieldID findValueField(JNIEnv* env, const char* reader, const char* classPath, const char* name,
                        const char* signature) {
    if (env == nullptr || classPath == nullptr || name == nullptr) {
        ALOGE("%s(): parameter error!!\n", reader);
        return nullptr;
    }
    ALOGI("%s(): pszClassPath=%s, pszVar_AliasName=%s", reader, classPath, name);
    jclass clazz = env->FindClass(classPath);
    if (clazz == nullptr) {
        ALOGE("%s(): find class(%s) failed, please check\n", reader, classPath);
        return nullptr;
    }
    jfieldID field = env->GetFieldID(clazz, name, signature);
    if (field == nullptr) {
        ALOGE("%s(): find variable(SubtitleAttr, %s) failed, please check\n", reader, name);
    }
    return field;
}

}  // namespace

bool getIntValueFromJava(JNIEnv* env, const char* classPath, jobject object, const char* name,
                         int& out) {
    jfieldID field = findValueField(env, __func__, classPath, name, "I");
    if (field == nullptr) return false;
    out = env->GetIntField(object, field);
    ALOGI("getIntValueFromJava(): i4Ret=%d", out);
    return true;
}

bool getByteValueFromJava(JNIEnv* env, const char* classPath, jobject object, const char* name,
                          char& out) {
    jfieldID field = findValueField(env, __func__, classPath, name, "B");
    if (field == nullptr) return false;
    out = static_cast<char>(env->GetByteField(object, field));
    ALOGI("getByteValueFromJava(): chRet=%d", out);
    return true;
}

bool getBoolValueFromJava(JNIEnv* env, const char* classPath, jobject object, const char* name,
                          bool& out) {
    jfieldID field = findValueField(env, __func__, classPath, name, "Z");
    if (field == nullptr) return false;
    out = env->GetByteField(object, field) != 0;  // a byte access to a boolean field
    ALOGI("getBoolValueFromJava(): fgRet=%d", out);
    return true;
}

bool getObjValueFromJava(JNIEnv* env, const char* classPath, jobject object, const char* name,
                         const char* signature, jobject& out) {
    if (env == nullptr || classPath == nullptr || name == nullptr || signature == nullptr) {
        ALOGE("getObjValueFromJava(): parameter error!!\n");
        return false;
    }
    ALOGI(
        "getObjValueFromJava(): pszClassPath_Parent=%s, pszClassPathType_Son=%s, "
        "pszVar_AliasName=%s",
        classPath, signature, name);
    jclass clazz = env->FindClass(classPath);
    if (clazz == nullptr) {
        ALOGE("getObjValueFromJava(): find parent class(%s) failed, please check\n", classPath);
        return false;
    }
    jfieldID field = env->GetFieldID(clazz, name, signature);
    if (field == nullptr) {
        ALOGE("getObjValueFromJava(): find variable(%s, %s) failed, please check\n", classPath,
              name);
        return false;
    }
    out = env->GetObjectField(object, field);
    return true;
}

int OrvMediaClient_shortLength(unsigned short* text, int max) {
    int length = 0;
    while (length < max && text[length] != 0) ++length;
    return length;
}

}  // namespace android
