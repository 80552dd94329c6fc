// SPDX-License-Identifier: Apache-2.0
#include "playback/ShortestSection.h"

namespace orvtarn {
namespace {

// Of media that name no rate.
constexpr double kUsualRate = 25;  // frames a second
constexpr double kFewestFrames = 1.5;

}  // namespace

double shortestSection(const MpvHandle& mpv) {
    const double rate = mpv.getDouble("container-fps").value_or(0);
    return kFewestFrames / (rate > 0 ? rate : kUsualRate);
}

}  // namespace orvtarn
