// SPDX-License-Identifier: Apache-2.0
#include <binder/Parcel.h>
#include <media/Metadata.h>

namespace android {
namespace media {

namespace {

constexpr int32_t kMarker = ('M' << 24) | ('E' << 16) | ('T' << 8) | 'A';

enum ValueType : int32_t {
    INTEGER_VAL = 2,
    BOOLEAN_VAL = 3,
};

// Overwrites the length word at begin with the number of bytes since begin,
// and goes back to the end.
bool writeLengthAt(Parcel* parcel, size_t begin) {
    const size_t end = parcel->dataPosition();
    parcel->setDataPosition(begin);
    const bool written = parcel->writeInt32(static_cast<int32_t>(end - begin)) == NO_ERROR;
    parcel->setDataPosition(end);
    return written;
}

bool appendRecord(Parcel* parcel, Metadata::Type key, ValueType type, int32_t value) {
    const int32_t words[] = {4 * sizeof(int32_t), key, type, value};
    return parcel->write(words, sizeof(words)) == NO_ERROR;
}

}  // namespace

Metadata::Metadata(Parcel* parcel) : mData(parcel), mBegin(parcel->dataPosition()) {}

bool Metadata::appendHeader() {
    return mData->writeInt32(0) == NO_ERROR && mData->writeInt32(kMarker) == NO_ERROR;
}

void Metadata::updateLength() { writeLengthAt(mData, mBegin); }

bool Metadata::appendBool(Type key, bool value) {
    return appendRecord(mData, key, BOOLEAN_VAL, value ? 1 : 0);
}

bool Metadata::appendInt32(Type key, int32_t value) {
    return appendRecord(mData, key, INTEGER_VAL, value);
}

void Metadata::resetParcel() {
    mData->setDataSize(mBegin);
    mData->setDataPosition(mBegin);
}

}  // namespace media
}  // namespace android
