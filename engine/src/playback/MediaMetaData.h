// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <binder/Parcel.h>
#include <orvtarn/MetaDataInfo.h>
#include <utils/Errors.h>
#include <utils/SortedVector.h>

#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "playback/Loader.h"

namespace orvtarn {

// What the media say about themselves, as a record and as the platform's
// metadata.
class MediaMetaData {
public:
    MediaMetaData(MpvHandle& mpv, PlayerState& state, Loader& loader)
        : mMpv(mpv), mState(state), mLoader(loader) {}

    // False before the media is prepared.
    bool get(MetaDataInfo& info);
    // Appends a record for each wanted key that has a value; an empty set or
    // key 0 wants all.
    android::status_t write(const android::SortedVector<int>& keys, android::Parcel* records);

private:
    MetaDataInfo fromMpv() const;

    MpvHandle& mMpv;
    PlayerState& mState;
    Loader& mLoader;
};

}  // namespace orvtarn
