// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace orvtarn {

// The audio drivers that mpv shall try, in that order, as its option "ao" has
// them. The last keeps time without sound: media without video would fail.
// Drivers that complain at length where their sound system is not are left out
// there; those that mpv was built without do no harm.
std::string audioOutputs();

// The driver of that list that makes no sound.
constexpr char kSilentOutput[] = "null";

}  // namespace orvtarn
