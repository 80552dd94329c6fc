// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/RefBase.h>

#include "jni/media-service/OrvMediaService.h"

// One event on its way to Java. The parcel is carried, never copied or freed.
struct NotifyMessage {
    int32_t msg;
    int32_t ext1;
    int32_t ext2;
    const android::Parcel* obj;
};

namespace ORV {

// What the dispatcher does next. Made with new by the caller, owned by the
// dispatcher from addAction on.
struct SyncToAsyncAction {
    int32_t kind = 0;                  // 0: an event; others are dropped without a word
    NotifyMessage* payload = nullptr;  // made with new; may be null
    int32_t cancelled = 0;             // non-zero once aborted
    android::sp<android::OrvMediaService> service;  // whose poster gets it
    bool valid = false;                             // delivered only when true
};

}  // namespace ORV
