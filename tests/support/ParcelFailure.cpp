// SPDX-License-Identifier: Apache-2.0
#include "ParcelFailure.h"

#include <binder/Parcel.h>

namespace {

bool sFails = false;

}  // namespace

namespace orvtest {

ParcelFailure::ParcelFailure() { sFails = true; }
ParcelFailure::~ParcelFailure() { sFails = false; }

}  // namespace orvtest

// What the linker's --wrap makes of Parcel::readInplace(size_t) const, whose
// mangled name spells the width of its argument.
#if __SIZEOF_POINTER__ == 8
#define READ_INPLACE(prefix) prefix##_ZNK7android6Parcel11readInplaceEm
#else
#define READ_INPLACE(prefix) prefix##_ZNK7android6Parcel11readInplaceEj
#endif

extern "C" {

const void* READ_INPLACE(__real_)(const android::Parcel* parcel, size_t length);

const void* READ_INPLACE(__wrap_)(const android::Parcel* parcel, size_t length) {
    return sFails ? nullptr : READ_INPLACE(__real_)(parcel, length);
}

}  // extern "C"
