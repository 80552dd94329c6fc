// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <functional>

#include "core/EventLoop.h"
#include "core/MpvHandle.h"
#include "playback/HardwareDecoding.h"

namespace orvtarn {

// Changes the way in which pictures are drawn, also while media plays: mpv has no
// video meanwhile, and shows the same place afterwards.
class OutputChange {
public:
    OutputChange(MpvHandle& mpv, EventLoop& events, HardwareDecoding& decoding)
        : mMpv(mpv), mEvents(events), mDecoding(decoding) {}

    // onWindow: the new way is by OpenGL. Blocks until mpv has video again.
    void run(bool onWindow, const std::function<void()>& change);

private:
    MpvHandle& mMpv;
    EventLoop& mEvents;
    HardwareDecoding& mDecoding;
};

}  // namespace orvtarn
