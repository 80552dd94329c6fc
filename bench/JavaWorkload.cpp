// SPDX-License-Identifier: Apache-2.0
#include "JavaWorkload.h"

#include "JavaMachine.h"

namespace orvbench {
namespace {

constexpr jint kLocalReferences = 16;

}  // namespace

JavaWorkload::JavaWorkload(const char* factory) {
    JNIEnv* env = javaEnv();
    env->PushLocalFrame(kLocalReferences);
    make(env, factory);
    env->PopLocalFrame(nullptr);
}

JavaWorkload::~JavaWorkload() {
    JNIEnv* env = javaEnv();
    env->DeleteGlobalRef(mPlayer);
    env->DeleteGlobalRef(mWorkload);
}

void JavaWorkload::make(JNIEnv* env, const char* factory) {
    jclass factories = env->FindClass("com/quintora/mmp/Workloads");
    jmethodID method = nullptr;
    if (factories != nullptr) {
        method = env->GetStaticMethodID(factories, factory, "()Lcom/quintora/mmp/Workload;");
    }
    jobject made = method != nullptr ? env->CallStaticObjectMethod(factories, method) : nullptr;
    mFailure = takeException();
    if (failed()) return;

    mWorkload = env->NewGlobalRef(made);
    jclass type = env->GetObjectClass(made);
    mRun = env->GetMethodID(type, "run", "(I)V");
    mRewind = env->GetMethodID(type, "rewind", "()V");
    mClose = env->GetMethodID(type, "close", "()V");
    jfieldID player = env->GetFieldID(type, "player", "Lcom/quintora/mmp/OrvMediaPlayer;");
    mPlayer = env->NewGlobalRef(env->GetObjectField(made, player));
}

void JavaWorkload::run(jint times) { call(mRun, times); }

void JavaWorkload::rewind() { call(mRewind); }

// Also after a failure, which stays the one that is reported.
void JavaWorkload::close() {
    if (mWorkload == nullptr) return;
    javaEnv()->CallVoidMethod(mWorkload, mClose);
    const std::string thrown = takeException();
    if (!failed()) mFailure = thrown;
}

void JavaWorkload::call(jmethodID method, jint times) {
    if (failed()) return;
    JNIEnv* env = javaEnv();
    env->CallVoidMethod(mWorkload, method, times);
    if (env->ExceptionCheck()) mFailure = takeException();
}

}  // namespace orvbench
