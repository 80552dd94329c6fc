// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "jni/media-service/OrvMediaServiceListener.h"

// Hands each event of a service to the process-wide dispatcher, without
// waiting for its delivery. A parcel is not copied: it must outlive that.
class ORV_EXPORT MediaClientListener : public android::OrvMediaServiceListener {
public:
    MediaClientListener();
    ~MediaClientListener() override;

    void notify(int msg, int ext1, int ext2, const android::Parcel* obj) override;
};
