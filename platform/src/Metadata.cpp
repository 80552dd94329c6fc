// SPDX-License-Identifier: Apache-2.0
#include <binder/Parcel.h>
#include <media/Metadata.h>
#include <utils/String16.h>

namespace android {
namespace media {

namespace {

constexpr int32_t kMarker = ('M' << 24) | ('E' << 16) | ('T' << 8) | 'A';

// Overwrites the length word at begin with the number of bytes since begin,
// and goes back to the end.
bool writeLengthAt(Parcel* parcel, size_t begin) {
    const size_t end = parcel->dataPosition();
    parcel->setDataPosition(begin);
    const bool written = parcel->writeInt32(static_cast<int32_t>(end - begin)) == NO_ERROR;
    parcel->setDataPosition(end);
    return written;
}

// One record: the length word is known once the value is written.
template <typename WriteValue>
bool appendRecord(Parcel* parcel, Metadata::Type key, Metadata::ValueType type,
                  const WriteValue& writeValue) {
    const size_t begin = parcel->dataPosition();
    return parcel->writeInt32(0) == NO_ERROR && parcel->writeInt32(key) == NO_ERROR &&
           parcel->writeInt32(type) == NO_ERROR && writeValue() == NO_ERROR &&
           writeLengthAt(parcel, begin);
}

}  // namespace

Metadata::Metadata(Parcel* parcel) : mData(parcel), mBegin(parcel->dataPosition()) {}

bool Metadata::appendHeader() {
    return mData->writeInt32(0) == NO_ERROR && mData->writeInt32(kMarker) == NO_ERROR;
}

void Metadata::updateLength() { writeLengthAt(mData, mBegin); }

bool Metadata::appendBool(Type key, bool value) {
    return appendRecord(mData, key, BOOLEAN_VAL, [&] { return mData->writeInt32(value ? 1 : 0); });
}

bool Metadata::appendInt32(Type key, int32_t value) {
    return appendRecord(mData, key, INTEGER_VAL, [&] { return mData->writeInt32(value); });
}

bool Metadata::appendString(Type key, const char* utf8) {
    return appendRecord(mData, key, STRING_VAL,
                        [&] { return mData->writeString16(String16(utf8)); });
}

void Metadata::resetParcel() {
    mData->setDataSize(mBegin);
    mData->setDataPosition(mBegin);
}

}  // namespace media
}  // namespace android
