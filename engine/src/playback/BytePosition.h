// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>

#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "playback/Loader.h"
#include "playback/Seeker.h"

namespace orvtarn {

// Positions as bytes of the media. The bytes of a frame are found in the media
// themselves, by the packets that hold it.
class BytePosition {
public:
    BytePosition(MpvHandle& mpv, PlayerState& state, Loader& loader, Seeker& seeker)
        : mMpv(mpv), mState(state), mLoader(loader), mSeeker(seeker) {}

    // Where the frame of now begins, low 32 bits. For media that are costly to
    // read twice, where mpv has read to.
    android::status_t get(int* position);
    // To the frame that holds the byte, or ends before it.
    bool seekTo(unsigned long long position);

private:
    MpvHandle& mMpv;
    PlayerState& mState;
    Loader& mLoader;
    Seeker& mSeeker;
};

}  // namespace orvtarn
