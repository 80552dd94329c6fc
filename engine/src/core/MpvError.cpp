// SPDX-License-Identifier: Apache-2.0
#include "core/MpvError.h"

#include <mpv/client.h>
#include <orvtarn/PlayerTypes.h>

namespace orvtarn {

android::status_t statusOfMpvError(int error) {
    switch (error) {
        case MPV_ERROR_SUCCESS:
            return android::NO_ERROR;
        case MPV_ERROR_LOADING_FAILED:
            return ORV_ERROR_IO;
        case MPV_ERROR_UNKNOWN_FORMAT:
            return ORV_ERROR_MALFORMED;
        case MPV_ERROR_NOTHING_TO_PLAY:
        // A picture without a decoder, for which mpv gives the sound up, too.
        case MPV_ERROR_GENERIC:
            return ORV_ERROR_UNSUPPORTED;
        case MPV_ERROR_NOMEM:
            return android::NO_MEMORY;
        default:
            return android::UNKNOWN_ERROR;
    }
}

}  // namespace orvtarn
