// SPDX-License-Identifier: Apache-2.0
#include <binder/Parcel.h>
#include <string.h>
#include <utils/String16.h>

#include <algorithm>
#include <new>

namespace android {

namespace {

// Sizes cross the wire as signed 32-bit numbers.
constexpr size_t kMaxSize = INT32_MAX;

constexpr size_t padded(size_t len) { return (len + 3) & ~size_t{3}; }

bool resize(std::vector<uint8_t>* bytes, size_t size) {
    try {
        bytes->resize(size);
        return true;
    } catch (const std::bad_alloc&) {
        return false;
    }
}

// The length word of a string against the bytes behind it, which hold one
// zero unit more than the text. A length of -1 stands for a null string.
status_t checkStringLength(int32_t length, size_t avail) {
    if (length == -1) return UNEXPECTED_NULL;
    if (length < 0) return BAD_VALUE;
    const bool complete = static_cast<size_t>(length) < avail / sizeof(char16_t);
    return complete ? NO_ERROR : NOT_ENOUGH_DATA;
}

template <typename T>
status_t readValue(const Parcel& parcel, T* out) {
    return parcel.read(out, sizeof(T));
}

}  // namespace

const uint8_t* Parcel::data() const { return mData.data(); }

size_t Parcel::dataSize() const { return mData.size(); }

size_t Parcel::dataAvail() const { return mPos < mData.size() ? mData.size() - mPos : 0; }

size_t Parcel::dataPosition() const { return mPos; }

void Parcel::setDataPosition(size_t pos) const { mPos = pos; }

status_t Parcel::setDataSize(size_t size) {
    if (size > kMaxSize) return BAD_VALUE;
    if (!resize(&mData, size)) return NO_MEMORY;
    mPos = std::min(mPos, size);
    return NO_ERROR;
}

status_t Parcel::setData(const uint8_t* buffer, size_t len) {
    if ((buffer == nullptr && len > 0) || len > kMaxSize) return BAD_VALUE;
    // By way of a copy: the buffer may lie inside this parcel.
    std::vector<uint8_t> content;
    if (!resize(&content, len)) return NO_MEMORY;
    std::copy(buffer, buffer + len, content.begin());
    mData.swap(content);
    mPos = 0;
    return NO_ERROR;
}

status_t Parcel::write(const void* data, size_t len) {
    if ((data == nullptr && len > 0) || len > kMaxSize) return BAD_VALUE;
    if (mPos > kMaxSize || padded(len) > kMaxSize - mPos) return BAD_VALUE;
    const size_t end = mPos + padded(len);
    if (end > mData.size() && !resize(&mData, end)) return NO_MEMORY;
    if (len > 0) memcpy(&mData[mPos], data, len);
    std::fill(mData.begin() + mPos + len, mData.begin() + end, uint8_t{0});
    mPos = end;
    return NO_ERROR;
}

status_t Parcel::writeInt32(int32_t value) { return write(&value, sizeof(value)); }
status_t Parcel::writeInt64(int64_t value) { return write(&value, sizeof(value)); }
status_t Parcel::writeFloat(float value) { return write(&value, sizeof(value)); }
status_t Parcel::writeDouble(double value) { return write(&value, sizeof(value)); }

status_t Parcel::writeString16(const String16& text) {
    const size_t begin = mPos;
    status_t status = writeInt32(static_cast<int32_t>(text.size()));
    // String16 keeps a zero unit behind its text.
    if (status == NO_ERROR)
        status = write(static_cast<const char16_t*>(text), (text.size() + 1) * sizeof(char16_t));
    if (status != NO_ERROR) mPos = begin;
    return status;
}

const void* Parcel::readInplace(size_t len) const {
    if (len > dataAvail()) return nullptr;
    const void* const bytes = mData.data() + mPos;
    // The last value of a parcel set from outside may lack its padding.
    mPos = std::min(mPos + padded(len), mData.size());
    return bytes;
}

status_t Parcel::read(void* out, size_t len) const {
    if (len > dataAvail()) return NOT_ENOUGH_DATA;
    const void* const bytes = readInplace(len);
    if (len > 0) memcpy(out, bytes, len);
    return NO_ERROR;
}

status_t Parcel::readInt32(int32_t* out) const { return readValue(*this, out); }
status_t Parcel::readInt64(int64_t* out) const { return readValue(*this, out); }
status_t Parcel::readFloat(float* out) const { return readValue(*this, out); }
status_t Parcel::readDouble(double* out) const { return readValue(*this, out); }

int32_t Parcel::readInt32() const {
    int32_t value = 0;
    return readInt32(&value) == NO_ERROR ? value : 0;
}

status_t Parcel::readString16(String16* out) const {
    const size_t begin = mPos;
    int32_t length = 0;
    status_t status = readInt32(&length);
    if (status != NO_ERROR) return status;
    status = checkStringLength(length, dataAvail());
    if (status != NO_ERROR) {
        mPos = begin;
        return status;
    }
    const void* const units = readInplace((static_cast<size_t>(length) + 1) * sizeof(char16_t));
    out->setTo(static_cast<const char16_t*>(units), length);
    return NO_ERROR;
}

}  // namespace android
