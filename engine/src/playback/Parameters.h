// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <binder/Parcel.h>
#include <utils/Errors.h>

#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "core/VideoOutput.h"
#include "playback/Subtitles.h"
#include "playback/Tracks.h"

namespace orvtarn {

// The settings and methods of orvtarn/Parameters.h.
class Parameters {
public:
    Parameters(MpvHandle& mpv, PlayerState& state, VideoOutput& video, Tracks& tracks,
               Subtitles& subtitles)
        : mMpv(mpv), mState(state), mVideo(video), mTracks(tracks), mSubtitles(subtitles) {}

    android::status_t set(int key, const android::Parcel& request);
    android::status_t get(int key, android::Parcel* reply);
    android::status_t invoke(const android::Parcel& request, android::Parcel* reply);

private:
    android::status_t setNumber(int key, int32_t value);
    android::status_t setText(const android::Parcel& request);
    android::status_t getNumber(int key, android::Parcel* reply);
    android::status_t getTracks(android::Parcel* reply);
    android::status_t selectOrDeselect(int method, const android::Parcel& request);
    android::status_t addSubtitles(const android::Parcel& request);

    MpvHandle& mMpv;
    PlayerState& mState;
    VideoOutput& mVideo;
    Tracks& mTracks;
    Subtitles& mSubtitles;
};

}  // namespace orvtarn
