// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

namespace android {

// The process's Java runtime, as native libraries see it.
class AndroidRuntime {
public:
    // Registers count methods on the class of that path. 0, or -1 when the
    // class or one of the methods is missing; the virtual machine's exception
    // is then left pending.
    static int registerNativeMethods(JNIEnv* env, const char* className,
                                     const JNINativeMethod* methods, int count);

    // The virtual machine of this process; null when there is none.
    static JavaVM* getJavaVM();

    // The calling thread's environment; null when it is not attached.
    static JNIEnv* getJNIEnv();
};

}  // namespace android
