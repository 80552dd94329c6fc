// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvtest {

// While one lives, no parcel gives its bytes in place, as if it had none. None
// that has as many as are asked for does so by itself. The test program's
// linker leads the library's calls here. One at a time.
class ParcelFailure {
public:
    ParcelFailure();
    ~ParcelFailure();
    ParcelFailure(const ParcelFailure&) = delete;
    ParcelFailure& operator=(const ParcelFailure&) = delete;
};

}  // namespace orvtest
