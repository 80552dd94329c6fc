// SPDX-License-Identifier: Apache-2.0
#include "core/HardwareDecoder.h"

#include <glob.h>

namespace orvtarn {
namespace {

bool hasDevice(const char* pattern) {
    glob_t found;
    const bool isThere = glob(pattern, GLOB_NOSORT, nullptr, &found) == 0;
    globfree(&found);
    return isThere;
}

}  // namespace

const char* hardwareDecoder() {
    if (hasDevice("/dev/nvidiactl")) return "nvdec-copy";
    return hasDevice("/dev/dri/renderD*") ? "vaapi-copy" : "no";
}

}  // namespace orvtarn
