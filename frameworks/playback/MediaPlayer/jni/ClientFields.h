// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

namespace android {

constexpr char kPlayerClassPath[] = "com/quintora/mmp/OrvMediaPlayer";

// The IDs of the Java player class: all null until native_init has filled
// them, then never written again but with the same values. Valid on every
// thread. Nobody checks them for null: calling into a player after a failed
// native_init is an error of the Java side.
struct ClientFields {
    jfieldID context;           // long mNativeContext
    jfieldID surfaceTexture;    // long mNativeSurfaceTexture
    jmethodID postEvent;        // static void postEventFromNative(Object, int, int, int, Object)
    jmethodID readStream;       // int readStream(int)
    jfieldID streamReadBuffer;  // byte[] mStreamReadBuffer
    jfieldID streamSize;        // long mStreamSize
    jfieldID streamCurPos;      // long mStreamCurPos
    jmethodID seekStream;       // long seekStream(int, long)
    jmethodID seekStreamEx;     // long seekStreamEx(int, long)
    jfieldID streamSeekable;    // boolean mStreamSeekable
    jfieldID dataSourceType;    // int mDataSourceType
    jmethodID timeSeekStream;   // long timeSeekStream(long, long)
    jmethodID getSeekType;      // int getSeekType()
    jfieldID stallingSupport;   // boolean mStallingSupport
    jfieldID streamDuration;    // long mStreamDuration
    jmethodID cancelRead;       // void cancelRead()
    jmethodID closeStream;      // void closeStream()
};

extern ClientFields gClientFields;

}  // namespace android
