// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/PcmRecords.h>
#include <stdint.h>

#include <string>

#include "core/MpvLoad.h"

namespace orvtarn {

// How mpv is to read a stream of raw samples.
struct PcmFormat {
    MpvOptions options;  // all but the channels
    int channels = 0;
    int bytesPerSecond = 0;
    int64_t durationMs = 0;  // 0 when the description does not say
};

// Checks the whole description against orvtarn/PcmRecords.h. True with the
// format, or false with the reason, such as "blockAlign is 3, must be 4": a
// wrong description would play as noise.
bool pcmFormat(const IORV_PB_CTRL_SET_MEDIA_INFO_T& info, PcmFormat& format, std::string& reason);

}  // namespace orvtarn
