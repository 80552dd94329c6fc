// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <stdint.h>
#include <utils/Errors.h>

#include <vector>

namespace android {

class String16;

// A growing block of 32-bit aligned values with one position for reading and
// writing. No binders, no descriptors: only the marshalled bytes. Not
// thread-safe.
class Parcel {
public:
    const uint8_t* data() const;
    size_t dataSize() const;
    // Bytes from the position to the end.
    size_t dataAvail() const;
    size_t dataPosition() const;
    void setDataPosition(size_t pos) const;
    status_t setDataSize(size_t size);
    // Replaces the whole content and rewinds. Null with length 0 empties.
    status_t setData(const uint8_t* buffer, size_t len);

    // Written at the position, padded with zeros to a multiple of 4 bytes.
    status_t write(const void* data, size_t len);
    status_t writeInt32(int32_t value);
    status_t writeInt64(int64_t value);
    status_t writeFloat(float value);
    status_t writeDouble(double value);
    // Length in UTF-16 units, the units, a terminating zero unit.
    status_t writeString16(const String16& text);

    // NOT_ENOUGH_DATA, with the position unmoved, when too few bytes are left.
    status_t read(void* out, size_t len) const;
    status_t readInt32(int32_t* out) const;
    status_t readInt64(int64_t* out) const;
    status_t readFloat(float* out) const;
    status_t readDouble(double* out) const;
    status_t readString16(String16* out) const;
    int32_t readInt32() const;  // 0 when too few bytes are left
    // A pointer to the next len bytes inside the parcel, valid until the next
    // write; null when fewer are left.
    const void* readInplace(size_t len) const;

private:
    std::vector<uint8_t> mData;
    mutable size_t mPos = 0;
};

}  // namespace android
