// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "os/Export.h"

namespace os {

// What ScopedMutex can hold. Results are those of the POSIX call.
class ORV_EXPORT Lock {
public:
    virtual ~Lock() = default;
    virtual int lock() = 0;
    virtual int unlock() = 0;
};

}  // namespace os
