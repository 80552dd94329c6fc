// SPDX-License-Identifier: Apache-2.0

// The native half of the JVM tests' android.os.PlatformNatives: the C++ side of
// the platform, called from Java as a player library would call it.

#include <android/log.h>
#include <android_runtime/AndroidRuntime.h>
#include <android_runtime/android_view_Surface.h>
#include <binder/Parcel.h>
#include <gui/Surface.h>
#include <jni.h>
#include <nativehelper/JNIHelp.h>
#if __has_include(<nativehelper/JNIPlatformHelp.h>)
#include <nativehelper/JNIPlatformHelp.h>
#endif
#include <nativehelper/ScopedUtfChars.h>
#include <utils/String16.h>

#include <mutex>
#include <string>
#include <vector>

#include "LogSink.h"

using namespace android;

namespace {

std::mutex sLogLock;
std::string sLog;

bool takeLine(const orvtest::SinkLine& line) {
    std::lock_guard<std::mutex> lock(sLogLock);
    sLog += std::string(line.tag) + ": " + line.text + "\n";
    return true;
}

std::vector<std::string> stringsOf(JNIEnv* env, jobjectArray array) {
    std::vector<std::string> strings;
    for (jsize i = 0; i < env->GetArrayLength(array); ++i) {
        jstring const element = static_cast<jstring>(env->GetObjectArrayElement(array, i));
        strings.emplace_back(ScopedUtfChars(env, element).c_str());
        env->DeleteLocalRef(element);
    }
    return strings;
}

void doNothing() {}

sp<IGraphicBufferProducer> producerOf(JNIEnv* env, jobject jsurface) {
    const sp<Surface> surface = android_view_Surface_getSurface(env, jsurface);
    return surface != nullptr ? surface->getIGraphicBufferProducer() : nullptr;
}

IGraphicBufferProducer* producerIn(jlong handle) {
    return reinterpret_cast<IGraphicBufferProducer*>(static_cast<uintptr_t>(handle));
}

}  // namespace

#define NATIVE(type, name) extern "C" JNIEXPORT type JNICALL Java_android_os_PlatformNatives_##name

NATIVE(jint, registerNatives)
(JNIEnv* env, jclass, jstring className, jobjectArray names, jobjectArray signatures) {
    const ScopedUtfChars path(env, className);
    const std::vector<std::string> nameTexts = stringsOf(env, names);
    const std::vector<std::string> signatureTexts = stringsOf(env, signatures);
    std::vector<JNINativeMethod> methods;
    for (size_t i = 0; i < nameTexts.size(); ++i) {
        methods.push_back(
            {nameTexts[i].c_str(), signatureTexts[i].c_str(), reinterpret_cast<void*>(doNothing)});
    }
    orvtest::installLogSink<takeLine>();
    const int result = AndroidRuntime::registerNativeMethods(env, path.c_str(), methods.data(),
                                                             static_cast<int>(methods.size()));
    __android_log_set_logger(__android_log_stderr_logger);
    return result;
}

NATIVE(jstring, takeLog)(JNIEnv* env, jclass) {
    std::lock_guard<std::mutex> lock(sLogLock);
    jstring const log = env->NewStringUTF(sLog.c_str());
    sLog.clear();
    return log;
}

NATIVE(jboolean, runtimeIsThisMachine)(JNIEnv* env, jclass) {
    JavaVM* vm = nullptr;
    env->GetJavaVM(&vm);
    return AndroidRuntime::getJavaVM() == vm && AndroidRuntime::getJNIEnv() == env;
}

NATIVE(jint, fdOf)(JNIEnv* env, jclass, jobject fileDescriptor) {
    return jniGetFDFromFileDescriptor(env, fileDescriptor);
}

NATIVE(jboolean, hasSurface)(JNIEnv* env, jclass, jobject jsurface) {
    return android_view_Surface_getSurface(env, jsurface) != nullptr;
}

NATIVE(jboolean, hasProducer)(JNIEnv* env, jclass, jobject jsurface) {
    return producerOf(env, jsurface) != nullptr;
}

NATIVE(jlong, holdProducer)(JNIEnv* env, jclass, jobject jsurface) {
    const sp<IGraphicBufferProducer> producer = producerOf(env, jsurface);
    producer->incStrong(&sLog);
    return static_cast<jlong>(reinterpret_cast<uintptr_t>(producer.get()));
}

NATIVE(void, dropProducer)(JNIEnv*, jclass, jlong handle) { producerIn(handle)->decStrong(&sLog); }

NATIVE(jint, draw)
(JNIEnv*, jclass, jlong handle, jint width, jint height, jint color, jlong timestampUs) {
    IGraphicBufferProducer* const producer = producerIn(handle);
    IGraphicBufferProducer::PixelBuffer buffer = {};
    const status_t status = producer->dequeueBuffer(width, height, &buffer);
    if (status != NO_ERROR) return status;
    for (int y = 0; y < height; ++y) {
        uint32_t* const row = reinterpret_cast<uint32_t*>(buffer.pixels + y * buffer.stride);
        for (int x = 0; x < width; ++x) row[x] = static_cast<uint32_t>(color);
    }
    return producer->queueBuffer(buffer.slot, timestampUs);
}

NATIVE(jintArray, defaultSize)(JNIEnv* env, jclass, jlong handle) {
    jint size[2] = {-1, -1};
    producerIn(handle)->getDefaultSize(&size[0], &size[1]);
    jintArray const result = env->NewIntArray(2);
    env->SetIntArrayRegion(result, 0, 2, size);
    return result;
}

// Reads an int, a long, a float, a double and a string with the C++ parcel and
// returns what the C++ parcel writes for them.
NATIVE(jbyteArray, rewriteParcel)(JNIEnv* env, jclass, jbyteArray marshalled) {
    std::vector<uint8_t> bytes(env->GetArrayLength(marshalled));
    env->GetByteArrayRegion(marshalled, 0, static_cast<jsize>(bytes.size()),
                            reinterpret_cast<jbyte*>(bytes.data()));
    Parcel in;
    in.setData(bytes.data(), bytes.size());
    int64_t wide = 0;
    float single = 0;
    double real = 0;
    String16 text;
    Parcel out;
    out.writeInt32(in.readInt32());
    in.readInt64(&wide);
    out.writeInt64(wide);
    in.readFloat(&single);
    out.writeFloat(single);
    in.readDouble(&real);
    out.writeDouble(real);
    in.readString16(&text);
    out.writeString16(text);

    const jsize size = static_cast<jsize>(out.dataSize());
    jbyteArray const result = env->NewByteArray(size);
    env->SetByteArrayRegion(result, 0, size, reinterpret_cast<const jbyte*>(out.data()));
    return result;
}
