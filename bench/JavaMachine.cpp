// SPDX-License-Identifier: Apache-2.0
#include "JavaMachine.h"

namespace orvbench {
namespace {

JavaVM* gJava = nullptr;

}  // namespace

jint startJava(const std::vector<std::string>& options) {
    std::vector<JavaVMOption> list;
    list.reserve(options.size());
    for (const std::string& option : options) list.push_back({option.c_str(), nullptr});
    JavaVMInitArgs arguments = {JNI_VERSION_1_6, static_cast<jint>(list.size()), list.data(),
                                JNI_FALSE};
    JNIEnv* env = nullptr;
    return JNI_CreateJavaVM(&gJava, &env, &arguments);
}

void endJava() { gJava->DestroyJavaVM(); }

JavaVM* javaMachine() { return gJava; }

JNIEnv* javaEnv() {
    JNIEnv* env = nullptr;
    gJava->AttachCurrentThread(&env, nullptr);
    return env;
}

std::string takeException() {
    JNIEnv* env = javaEnv();
    jthrowable thrown = env->ExceptionOccurred();
    if (thrown == nullptr) return "";
    env->ExceptionClear();
    jmethodID toString =
        env->GetMethodID(env->GetObjectClass(thrown), "toString", "()Ljava/lang/String;");
    auto text = static_cast<jstring>(env->CallObjectMethod(thrown, toString));
    const char* chars = text != nullptr ? env->GetStringUTFChars(text, nullptr) : nullptr;
    env->ExceptionClear();
    if (chars == nullptr) return "an exception without a readable text";
    std::string copy(chars);
    env->ReleaseStringUTFChars(text, chars);
    return copy;
}

}  // namespace orvbench
