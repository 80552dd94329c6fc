// SPDX-License-Identifier: Apache-2.0
#include "core/HardwareDecoder.h"

#include <glob.h>

namespace orvtarn {
namespace {

bool isThere(const std::string& pattern) {
    glob_t found;
    const bool matches = glob(pattern.c_str(), GLOB_NOSORT, nullptr, &found) == 0;
    globfree(&found);
    return matches;
}

}  // namespace

const char* hardwareDecoder(const std::string& devices) {
    if (isThere(devices + "/nvidiactl")) return "nvdec-copy";
    return isThere(devices + "/dri/renderD*") ? "vaapi-copy" : "no";
}

std::string directDecoder(const std::string& copying) {
    return copying.substr(0, copying.rfind("-copy"));
}

const char* decoderInterop(const std::string& copying) {
    if (copying == "nvdec-copy") return "cuda";
    return copying == "vaapi-copy" ? "vaapi" : "no";
}

}  // namespace orvtarn
