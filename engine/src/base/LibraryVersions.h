// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

struct AVStream;

// All that the engine knows of the differences between releases of its
// libraries: mpv 0.35 to 0.40, FFmpeg 5.1 to 7.1.

namespace orvtarn {

// The name that earlier releases of mpv have for an option or property; null
// for a name that never changed.
const char* formerMpvName(const char* name);

// How the stream's picture is to be turned, as av_display_rotation_get takes
// it; null without a matrix. The stream keeps it.
const int32_t* displayMatrix(const AVStream& stream);

}  // namespace orvtarn
