// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/RefBase.h>

#include "os/Export.h"

namespace android {

class Parcel;

// Where a service sends its events. Called on the thread that notified the
// service; obj may be null and is not owned.
class ORV_EXPORT OrvMediaServiceListener : public virtual RefBase {
public:
    virtual void notify(int msg, int ext1, int ext2, const Parcel* obj) = 0;
    virtual ~OrvMediaServiceListener() = default;
};

}  // namespace android
