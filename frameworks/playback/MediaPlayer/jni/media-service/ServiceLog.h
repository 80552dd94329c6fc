// SPDX-License-Identifier: Apache-2.0
#pragma once

// The service's log. Include it once per source file, after the headers.

#include <log/log.h>

#undef LOG_TAG
#define LOG_TAG "OrvMediaService"

namespace android {

// The standard entry line of a service operation.
inline void logEntry(const char* operation) { ALOGI("OrvMediaService::%s()", operation); }

}  // namespace android
