// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/Errors.h>

namespace orvtest {

// While one lives, the service's two effect operations fail with its status,
// and its decoder command with false. They cannot fail by themselves: the
// engine has no such operations. The test program's linker leads their callers
// here. One at a time.
class ServiceFailure {
public:
    explicit ServiceFailure(android::status_t status);
    ~ServiceFailure();
    ServiceFailure(const ServiceFailure&) = delete;
    ServiceFailure& operator=(const ServiceFailure&) = delete;
};

// The length that the service's decoder command last came with.
int lastCliArgument();

}  // namespace orvtest
