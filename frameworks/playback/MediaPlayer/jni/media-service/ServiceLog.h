// SPDX-License-Identifier: Apache-2.0
#pragma once

// The service's log. For source files only: it sets the file's LOG_TAG.

#include <log/log.h>

#undef LOG_TAG
#define LOG_TAG "OrvMediaService"

namespace android {

// The standard entry line of a service operation.
inline void logEntry(const char* operation) { ALOGI("OrvMediaService::%s()", operation); }

}  // namespace android
