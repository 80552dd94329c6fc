// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <mutex>
#include <string>

#include "base/PictureFilters.h"
#include "core/MpvHandle.h"
#include "playback/HardwareDecoding.h"

namespace orvtarn {

// Has mpv do to decoded pictures what its software renderer leaves undone: they
// are turned, deinterlaced and brought to the standard dynamic range. The
// filters follow the selected video track. Any thread.
class VideoFilters {
public:
    VideoFilters(MpvHandle& mpv, HardwareDecoding& decoding) : mMpv(mpv), mDecoding(decoding) {}

    // Media are open and mpv is about to choose their tracks: what the container
    // says of the track to come is acted on before its first picture.
    void onOpened();
    // That video track is about to be selected.
    void beforeTrack(int64_t id);
    // Looks at the picture of now. True when it asks for other filters than
    // those before; mpv has them, for the pictures to come.
    bool adapt();

private:
    void begin(Orientation orientation);
    void keepChroma();
    bool apply();

    MpvHandle& mMpv;
    HardwareDecoding& mDecoding;
    std::mutex mMutex;
    PictureTraits mTraits;  // of the selected track, as far as they were seen
    std::string mGraph;     // that mpv has
};

}  // namespace orvtarn
