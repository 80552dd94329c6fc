// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <orvtarn/DivxRecords.h>

namespace android {

// Hand a filled record to the Java player's callback. False, with a line in the
// log, when the class or the callback is missing. The getters end here once the
// service answers them.

bool deliverDivxTitleInfo(JNIEnv* env, jobject thiz, const DivxTitleInfo& info);
bool deliverDivxChapInfo(JNIEnv* env, jobject thiz, const DivxChapInfo& info);
bool deliverDivxPlayListInfo(JNIEnv* env, jobject thiz, const DivxPlayListInfo& info);
bool deliverDivxPositionInfo(JNIEnv* env, jobject thiz, const DivxPositionInfo& info);
// Passes the six numbers, text 1, the number and text 2 to a callback that
// declares five numbers, a string, a number, a string and a number.
bool deliverDivxDisplayInfo(JNIEnv* env, jobject thiz, DivxDisplayInfo& info);
// Passes seventeen 32-bit words to a callback that declares nine of its
// seventeen parameters as 64-bit: the calling convention assembles them.
bool deliverDivxLastMemoryFilePosition(JNIEnv* env, jobject thiz,
                                       const DivxLastMemoryFilePosition& position);

}  // namespace android
