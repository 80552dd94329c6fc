// SPDX-License-Identifier: Apache-2.0
#include <nativehelper/JNIHelp.h>

// The desktop's java.io.FileDescriptor keeps the descriptor in a field of
// another name than the packaged helper library looks for, so this definition
// stands in for the helper's: this library comes first in the lookup order.
// -1 for null, for an object of another kind and for a closed descriptor.
extern "C" JNIEXPORT int jniGetFDFromFileDescriptor(C_JNIEnv* functions, jobject fileDescriptor) {
    JNIEnv* const env = reinterpret_cast<JNIEnv*>(functions);
    if (fileDescriptor == nullptr) return -1;
    jclass const clazz = env->GetObjectClass(fileDescriptor);
    jfieldID const field = env->GetFieldID(clazz, "fd", "I");
    env->DeleteLocalRef(clazz);
    return field != nullptr ? env->GetIntField(fileDescriptor, field) : -1;
}
