// SPDX-License-Identifier: Apache-2.0
#include <android/file_descriptor_jni.h>
#include <nativehelper/JNIHelp.h>

namespace {

// The desktop's java.io.FileDescriptor keeps the number in a field of another
// name than the packaged helper library looks for, so the definitions here
// stand in for the helper's: this library comes first in the lookup order.
jfieldID numberFieldOf(JNIEnv* env, jobject fileDescriptor) {
    jclass const clazz = env->GetObjectClass(fileDescriptor);
    jfieldID const field = env->GetFieldID(clazz, "fd", "I");
    env->DeleteLocalRef(clazz);
    return field;
}

}  // namespace

extern "C" {

JNIEXPORT jobject AFileDescriptor_create(JNIEnv* env) {
    jclass const clazz = env->FindClass("java/io/FileDescriptor");
    if (clazz == nullptr) return nullptr;
    jmethodID const constructor = env->GetMethodID(clazz, "<init>", "()V");
    jobject const created = constructor != nullptr ? env->NewObject(clazz, constructor) : nullptr;
    env->DeleteLocalRef(clazz);
    return created;
}

JNIEXPORT int AFileDescriptor_getFd(JNIEnv* env, jobject fileDescriptor) {
    jfieldID const field = numberFieldOf(env, fileDescriptor);
    return field != nullptr ? env->GetIntField(fileDescriptor, field) : -1;
}

JNIEXPORT void AFileDescriptor_setFd(JNIEnv* env, jobject fileDescriptor, int fd) {
    jfieldID const field = numberFieldOf(env, fileDescriptor);
    if (field != nullptr) env->SetIntField(fileDescriptor, field, fd);
}

// Before Android 12 a function of the helper library itself.
JNIEXPORT int jniGetFDFromFileDescriptor(C_JNIEnv* functions, jobject fileDescriptor) {
    if (fileDescriptor == nullptr) return -1;
    return AFileDescriptor_getFd(reinterpret_cast<JNIEnv*>(functions), fileDescriptor);
}

}  // extern "C"
