// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mutex>
#include <string>

#include "core/MpvHandle.h"

namespace orvtarn {

// Which hardware decoder mpv tries. Its pictures stay in the graphics processor's
// memory where that draws them and nothing else has to see them; else they are
// copied. Any thread.
class HardwareDecoding {
public:
    // decoder: see hardwareDecoder.
    HardwareDecoding(MpvHandle& mpv, std::string decoder)
        : mMpv(mpv), mDecoder(std::move(decoder)) {}

    // Whether pictures are drawn by OpenGL.
    void setOnWindow(bool onWindow);
    // Whether filters see the pictures, which they do by software.
    void setFiltered(bool filtered);

private:
    void apply();

    MpvHandle& mMpv;
    const std::string mDecoder;
    std::mutex mMutex;
    bool mOnWindow = false;
    bool mFiltered = false;
    bool mDirect = false;  // what mpv was given last
};

}  // namespace orvtarn
