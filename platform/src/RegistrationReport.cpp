// SPDX-License-Identifier: Apache-2.0
#include "RegistrationReport.h"

#include <android/log.h>

#include <string>

namespace android {

namespace {

constexpr char kTag[] = "AndroidRuntime";

#define LOG_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

// Calls one of Java's reflection methods that takes nothing; null, with no
// exception pending, when anything fails.
jobject callObjectMethod(JNIEnv* env, jobject object, const char* name, const char* signature) {
    jclass const clazz = env->GetObjectClass(object);
    jmethodID const method = env->GetMethodID(clazz, name, signature);
    jobject const result = method != nullptr ? env->CallObjectMethod(object, method) : nullptr;
    env->DeleteLocalRef(clazz);
    if (!env->ExceptionCheck()) return result;
    env->ExceptionClear();
    return nullptr;
}

std::string callStringMethod(JNIEnv* env, jobject object, const char* name) {
    jstring const text =
        static_cast<jstring>(callObjectMethod(env, object, name, "()Ljava/lang/String;"));
    if (text == nullptr) return {};
    const char* const chars = env->GetStringUTFChars(text, nullptr);
    std::string result(chars != nullptr ? chars : "");
    if (chars != nullptr) env->ReleaseStringUTFChars(text, chars);
    env->DeleteLocalRef(text);
    return result;
}

// The declarations of that name, as Java writes them, comma-separated.
std::string declarationsOf(JNIEnv* env, jobjectArray declared, const char* name) {
    std::string found;
    const jsize count = declared != nullptr ? env->GetArrayLength(declared) : 0;
    for (jsize i = 0; i < count; ++i) {
        jobject const method = env->GetObjectArrayElement(declared, i);
        if (callStringMethod(env, method, "getName") == name) {
            if (!found.empty()) found += ", ";
            found += callStringMethod(env, method, "toString");
        }
        env->DeleteLocalRef(method);
    }
    return found;
}

// The class's method of that name and signature as a reflection object, static
// or not; null when there is none.
jobject findMethod(JNIEnv* env, jclass clazz, const JNINativeMethod& row) {
    for (const bool isStatic : {false, true}) {
        jmethodID const id = isStatic ? env->GetStaticMethodID(clazz, row.name, row.signature)
                                      : env->GetMethodID(clazz, row.name, row.signature);
        if (id != nullptr) return env->ToReflectedMethod(clazz, id, isStatic);
        env->ExceptionClear();
    }
    return nullptr;
}

void reportRow(JNIEnv* env, jclass clazz, const char* className, const JNINativeMethod& row,
               jobjectArray declared) {
    const std::string declarations = declarationsOf(env, declared, row.name);
    if (jobject const method = findMethod(env, clazz, row)) {
        const std::string text = callStringMethod(env, method, "toString");
        env->DeleteLocalRef(method);
        // An inherited or non-native method does not take a native function.
        if (declarations.find(text) == std::string::npos) {
            LOG_ERROR("%s: native method %s%s is only inherited: %s", className, row.name,
                      row.signature, text.c_str());
        } else if ((" " + text).find(" native ") == std::string::npos) {
            LOG_ERROR("%s: method %s%s is not declared native: %s", className, row.name,
                      row.signature, text.c_str());
        }
        return;
    }
    if (declarations.empty()) {
        LOG_ERROR("%s: no native method %s%s", className, row.name, row.signature);
    } else {
        LOG_ERROR("%s: no native method %s%s; the class declares %s", className, row.name,
                  row.signature, declarations.c_str());
    }
}

}  // namespace

void reportMissingClass(const char* className) {
    LOG_ERROR("%s: class not found or not initialised, its native methods cannot be registered",
              className);
}

void reportFailedRegistration(JNIEnv* env, jclass clazz, const char* className,
                              const JNINativeMethod* methods, int count) {
    jthrowable const pending = env->ExceptionOccurred();
    env->ExceptionClear();
    LOG_ERROR("%s: registration of %d native methods failed", className, count);
    jobjectArray const declared = static_cast<jobjectArray>(
        callObjectMethod(env, clazz, "getDeclaredMethods", "()[Ljava/lang/reflect/Method;"));
    for (int i = 0; i < count; ++i) reportRow(env, clazz, className, methods[i], declared);
    if (declared != nullptr) env->DeleteLocalRef(declared);
    if (pending != nullptr) {
        env->Throw(pending);
        env->DeleteLocalRef(pending);
    }
}

}  // namespace android
