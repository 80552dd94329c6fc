// SPDX-License-Identifier: Apache-2.0
// native_init: looks up everything the library touches in its Java peer.

#include "jni/ClientFields.h"

#include "jni/BridgeLog.h"
#include "jni/OrvMediaClient.h"

namespace android {

ClientFields gClientFields;

namespace {

const char kShortClassName[] = "OrvMediaPlayer";

// One lookup: where the ID goes and what is logged when there is none.
struct FieldLookup {
    jfieldID ClientFields::* member;
    const char* name;
    const char* signature;
    const char* failure;
};

struct MethodLookup {
    jmethodID ClientFields::* member;
    const char* name;
    const char* signature;
    const char* failure;
};

bool find(JNIEnv* env, jclass clazz, const FieldLookup& lookup) {
    jfieldID id = env->GetFieldID(clazz, lookup.name, lookup.signature);
    gClientFields.*lookup.member = id;
    if (id == nullptr) ALOGE(lookup.failure, kShortClassName);
    return id != nullptr;
}

bool find(JNIEnv* env, jclass clazz, const MethodLookup& lookup) {
    jmethodID id = env->GetMethodID(clazz, lookup.name, lookup.signature);
    gClientFields.*lookup.member = id;
    if (id == nullptr) ALOGE(lookup.failure, kShortClassName);
    return id != nullptr;
}

bool findPostEvent(JNIEnv* env, jclass clazz) {
    gClientFields.postEvent = env->GetStaticMethodID(clazz, "postEventFromNative",
                                                     "(Ljava/lang/Object;IIILjava/lang/Object;)V");
    if (gClientFields.postEvent != nullptr) return true;
    ALOGE("OrvMediaClient_init(): find method(%s, postEventFromNative) failed, please check\n",
          kShortClassName);
    return false;
}

bool findStreamReadBuffer(JNIEnv* env, jclass clazz) {
    gClientFields.streamReadBuffer = env->GetFieldID(clazz, "mStreamReadBuffer", "[B");
    if (gClientFields.streamReadBuffer != nullptr) return true;
    // Reported twice, the second time under another member's name.
    ALOGE(
        "OrvMediaClient_init(): find variable(BrixMediaPlayer, mStreamReadBuffer) failed, please "
        "check\n");
    ALOGE("OrvMediaClient_init(): find variable(%s, mNativeSurfaceTexture) failed, please check\n",
          kShortClassName);
    return false;
}

const FieldLookup kContext = {
    &ClientFields::context, "mNativeContext", "J",
    "OrvMediaClient_init(): find variable(%s, mNativeContext) failed, please check\n"};
const FieldLookup kSurfaceTexture = {
    &ClientFields::surfaceTexture, "mNativeSurfaceTexture", "J",
    "OrvMediaClient_init(): find variable(%s, mNativeSurfaceTexture) failed, please check\n"};
const MethodLookup kReadStream = {
    &ClientFields::readStream, "readStream", "(I)I",
    "OrvMediaClient_init(): find method(%s, readStream) failed, please check\n"};
const FieldLookup kStreamSize = {
    &ClientFields::streamSize, "mStreamSize", "J",
    "OrvMediaClient_init(): find variable(%s, mStreamSize) failed, please check\n"};
const FieldLookup kStreamDuration = {
    &ClientFields::streamDuration, "mStreamDuration", "J",
    "OrvMediaClient_init(): find variable(%s, mStreamDuration) failed, please check\n"};
const FieldLookup kStreamCurPos = {
    &ClientFields::streamCurPos, "mStreamCurPos", "J",
    "OrvMediaClient_init(): find variable(%s, mStreamCurPos) failed, please check\n"};
const MethodLookup kSeekStream = {
    &ClientFields::seekStream, "seekStream", "(IJ)J",
    "OrvMediaClient_init(): find method(%s, seekStream) failed, please check\n"};
const MethodLookup kSeekStreamEx = {
    &ClientFields::seekStreamEx, "seekStreamEx", "(IJ)J",
    "OrvMediaClient_init(): find method(%s, seekStreamEx) failed, please check\n"};
const MethodLookup kTimeSeekStream = {
    &ClientFields::timeSeekStream, "timeSeekStream", "(JJ)J",
    "OrvMediaClient_init(): find method(%s, timeSeekStream) failed, please check\n"};
const MethodLookup kCancelRead = {
    &ClientFields::cancelRead, "cancelRead", "()V",
    "OrvMediaClient_init(): find method(%s, cancelRead) failed, please check\n"};
const MethodLookup kCloseStream = {
    &ClientFields::closeStream, "closeStream", "()V",
    "OrvMediaClient_init(): find method(%s, closeStream) failed, please check\n"};
const FieldLookup kStreamSeekable = {
    &ClientFields::streamSeekable, "mStreamSeekable", "Z",
    "OrvMediaClient_init(): find variable(%s, mStreamSeekable) failed, please check\n"};
const FieldLookup kStallingSupport = {
    &ClientFields::stallingSupport, "mStallingSupport", "Z",
    "OrvMediaClient_init(): find variable(%s, mStallingSupport) failed, please check\n"};
const MethodLookup kGetSeekType = {
    &ClientFields::getSeekType, "getSeekType", "()I",
    "OrvMediaClient_init(): find variable(%s, getSeekType) failed, please check\n"};
const FieldLookup kDataSourceType = {
    &ClientFields::dataSourceType, "mDataSourceType", "I",
    "OrvMediaClient_init(): find variable(%s, mDataSourceType) failed, please check\n"};

// In this order, to the first that fails; the virtual machine's exception for
// it stays pending.
bool findAll(JNIEnv* env, jclass clazz) {
    return find(env, clazz, kContext) && findPostEvent(env, clazz) &&
           find(env, clazz, kSurfaceTexture) && find(env, clazz, kReadStream) &&
           findStreamReadBuffer(env, clazz) && find(env, clazz, kStreamSize) &&
           find(env, clazz, kStreamDuration) && find(env, clazz, kStreamCurPos) &&
           find(env, clazz, kSeekStream) && find(env, clazz, kSeekStreamEx) &&
           find(env, clazz, kTimeSeekStream) && find(env, clazz, kCancelRead) &&
           find(env, clazz, kCloseStream) && find(env, clazz, kStreamSeekable) &&
           find(env, clazz, kStallingSupport) && find(env, clazz, kGetSeekType) &&
           find(env, clazz, kDataSourceType);
}

}  // namespace

void OrvMediaClient_init(JNIEnv* env, jclass) {
    logEnter(__func__);
    jclass clazz = env->FindClass(kPlayerClassPath);
    if (clazz == nullptr) {
        ALOGE("OrvMediaClient_init(): find class(%s) failed, please check\n", kPlayerClassPath);
        return;
    }
    if (findAll(env, clazz)) logLeave(__func__);
}

}  // namespace android
