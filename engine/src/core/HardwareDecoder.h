// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace orvtarn {

// The hardware decoder that mpv shall try, as its option "hwdec" has it: one that
// copies its pictures back, so that they can be drawn by software, and whose device
// is in that folder. mpv's own search would complain on machines without one. "no"
// where there is none; mpv decodes in software what the decoder cannot do.
const char* hardwareDecoder(const std::string& devices = "/dev");

// The same decoder without the copy, for pictures that OpenGL draws.
std::string directDecoder(const std::string& copying);
// What hands its pictures to OpenGL, as mpv's option "gpu-hwdec-interop" has it:
// by itself mpv would try all, and some complain.
const char* decoderInterop(const std::string& copying);

}  // namespace orvtarn
