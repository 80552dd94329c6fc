// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <log/log.h>
#include <utils/Errors.h>

// Platform headers that log themselves leave a tag of their own.
#undef LOG_TAG
#define LOG_TAG "TarnPlayer"

namespace orvtarn {

// An operation's failure and its one log line.
inline android::status_t failed(android::status_t status, const char* operation,
                                const char* reason) {
    ALOGE("%s: %s (status %d)", operation, reason, status);
    return status;
}

// The same for operations that answer true or false.
inline bool refused(const char* operation, const char* reason) {
    ALOGE("%s: %s", operation, reason);
    return false;
}

}  // namespace orvtarn
