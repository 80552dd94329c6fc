// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <utils/KeyedVector.h>
#include <utils/String8.h>

namespace android {

// Adds the pairs of two Java string arrays to out. Both null: none. False for
// arrays of unequal length, with an IllegalArgumentException, and at the first
// string whose characters cannot be had; pairs added before it stay.
bool ConvertKeyValueArraysToKeyedVector(JNIEnv* env, jobjectArray keys, jobjectArray values,
                                        KeyedVector<String8, String8>* out);

}  // namespace android
