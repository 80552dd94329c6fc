// SPDX-License-Identifier: Apache-2.0
// Metadata filters and records, and the opaque request to the engine.

#include <binder/Parcel.h>
#include <media/Metadata.h>
#include <string.h>

#include "jni/media-service/OrvMediaService.h"
#include "jni/media-service/ServiceLog.h"

namespace android {

namespace {

const int kMaxFilterLength = 64;

// Reads a count and that many codes. The set is emptied before the codes are
// known to be there.
bool unmarshallFilter(const Parcel& p, SortedVector<int>* filter, int* status) {
    int32_t count;
    if (p.readInt32(&count) != NO_ERROR) {
        ALOGE("Failed to read filter's length");
        *status = NOT_ENOUGH_DATA;
        return false;
    }
    if (count > kMaxFilterLength || count < 0) {
        ALOGE("Invalid filter len %d", count);
        *status = BAD_VALUE;
        return false;
    }
    filter->clear();
    filter->setCapacity(count);

    const size_t bytes = count * sizeof(int32_t);
    if (p.dataAvail() < bytes) {
        *status = NOT_ENOUGH_DATA;
        return false;
    }
    const auto* codes = static_cast<const uint8_t*>(p.readInplace(bytes));
    if (codes == nullptr) {
        ALOGE("Filter had no data");
        *status = BAD_VALUE;
        return false;
    }
    for (int32_t i = 0; i < count; ++i) {
        int code;  // the parcel's position may be at any byte
        memcpy(&code, codes + i * sizeof(code), sizeof(code));
        filter->add(code);
    }
    *status = NO_ERROR;
    return true;
}

// Codes are sorted: a set that holds the code for any type begins with it.
bool findMetadata(const SortedVector<int>& set, int code) {
    if (set.isEmpty()) return false;
    if (set[0] == media::Metadata::kAny) return true;
    return set.indexOf(code) >= 0;
}

}  // namespace

status_t OrvMediaService::invoke(const Parcel& request, Parcel* reply) {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::invoke, request, reply);
}

status_t OrvMediaService::setMetadataFilter(const Parcel& filter) {
    ALOGD("OrvMediaService::setMetadataFilter():");
    int status = NO_ERROR;
    SortedVector<int> allow;
    SortedVector<int> drop;
    if (unmarshallFilter(filter, &allow, &status) && unmarshallFilter(filter, &drop, &status)) {
        // Without mMetadataLock, which guards the sets' readers only.
        mMetadataAllow = allow;
        mMetadataDrop = drop;
    }
    return status;
}

status_t OrvMediaService::getMetadata(bool update_only, bool, Parcel* reply) {
    ALOGD("OrvMediaService::getMetadata(): not implement");
    if (!hasPlayer(__func__)) return NO_INIT;
    reply->writeInt32(-1);  // the place of the caller's return code

    SortedVector<int> ids;  // empty for all types
    {
        Mutex::Autolock lock(mMetadataLock);
        if (update_only) ids = mMetadataUpdated;
        mMetadataUpdated.clear();
    }

    media::Metadata metadata(reply);
    metadata.appendHeader();
    const status_t status = mPlayer->getMetadata(ids, reply);
    if (status != NO_ERROR) {
        metadata.resetParcel();
        ALOGE("OrvMediaService::getMetadata(): getMetadata failed %d", status);
        return status;
    }
    metadata.updateLength();
    return NO_ERROR;
}

bool OrvMediaService::shouldDropMetadata(int code) const {
    Mutex::Autolock lock(mMetadataLock);
    if (findMetadata(mMetadataDrop, code)) return true;
    if (mMetadataAllow.isEmpty()) return false;
    return !findMetadata(mMetadataAllow, code);
}

void OrvMediaService::addNewMetadataUpdate(int code) {
    Mutex::Autolock lock(mMetadataLock);
    if (mMetadataUpdated.indexOf(code) < 0) mMetadataUpdated.add(code);
}

}  // namespace android
