// SPDX-License-Identifier: Apache-2.0
#include "ByHand.h"

namespace orvbench {
namespace {

jint nothing(JNIEnv*, jobject) { return 0; }

struct PlayerMembers {
    jmethodID readStream = nullptr;
    jfieldID readBuffer = nullptr;
    jmethodID postEvent = nullptr;
};
PlayerMembers gMembers;

bool registerEmptyNative(JNIEnv* env) {
    char name[] = "nothing";
    char signature[] = "()I";
    const JNINativeMethod method = {name, signature, reinterpret_cast<void*>(nothing)};
    jclass type = env->FindClass("com/quintora/mmp/EmptyNative");
    return type != nullptr && env->RegisterNatives(type, &method, 1) == JNI_OK;
}

bool findMembers(JNIEnv* env) {
    jclass player = env->FindClass("com/quintora/mmp/OrvMediaPlayer");
    if (player == nullptr) return false;
    gMembers.readStream = env->GetMethodID(player, "readStream", "(I)I");
    gMembers.readBuffer = env->GetFieldID(player, "mStreamReadBuffer", "[B");
    gMembers.postEvent = env->GetStaticMethodID(player, "postEventFromNative",
                                                "(Ljava/lang/Object;IIILjava/lang/Object;)V");
    return !env->ExceptionCheck();
}

class Constant : public Virtual {
public:
    int position(int* msec) override {
        *msec = 0;
        return 0;
    }
};

}  // namespace

bool prepareByHand(JNIEnv* env) { return registerEmptyNative(env) && findMembers(env); }

int readByHand(JavaVM* java, jobject player, char* buffer, int length) {
    JNIEnv* env = nullptr;
    java->AttachCurrentThread(&env, nullptr);
    const int count = env->CallIntMethod(player, gMembers.readStream, length);
    auto array = static_cast<jbyteArray>(env->GetObjectField(player, gMembers.readBuffer));
    env->GetByteArrayRegion(array, 0, count, reinterpret_cast<jbyte*>(buffer));
    java->DetachCurrentThread();
    return count;
}

void postByHand(JavaVM* java, jclass players, jobject weakPlayer, int what) {
    JNIEnv* env = nullptr;
    java->AttachCurrentThread(&env, nullptr);
    env->CallStaticVoidMethod(players, gMembers.postEvent, weakPlayer, what, 0, 0, nullptr);
    java->DetachCurrentThread();
}

Virtual& someVirtual() {
    static Constant constant;
    return constant;
}

}  // namespace orvbench

int orv_bench_nothing() { return 0; }
