// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "core/MpvHandle.h"

namespace orvtarn {

// How long a section of the media that are open must be at least to have two frames,
// in seconds. mpv takes what it plays of one frame alone for a still picture, which has
// no position, and never takes that back while the media are open.
double shortestSection(const MpvHandle& mpv);

}  // namespace orvtarn
