// SPDX-License-Identifier: Apache-2.0
#pragma once

// The log of the native bridge, the event poster, the stream adapter and the
// service's listener. For source files only: it sets the file's LOG_TAG.

#include <log/log.h>

#undef LOG_TAG
#define LOG_TAG "OrvMediaClient-JNI"

namespace android {

// The regular first and last line of a native method: its name and the word.
inline void logEnter(const char* function) { ALOGI("%s(): Enter\n", function); }
inline void logLeave(const char* function) { ALOGI("%s(): Leave\n", function); }
inline void logOccur(const char* function) { ALOGI("%s(): occur\n", function); }

}  // namespace android
