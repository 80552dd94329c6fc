// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/Errors.h>

namespace orvtarn {

// The engine's status for what ended a load or a playback.
android::status_t statusOfMpvError(int error);

}  // namespace orvtarn
