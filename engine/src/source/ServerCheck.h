// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>

#include <atomic>
#include <string>
#include <vector>

#include "source/RequestHeaders.h"

namespace orvtarn {

// Asks the server of a URL that could not be played. 0 with the first bytes of
// the answer, at most 64 KiB; otherwise the cause: one of the statuses
// ORV_ERROR_UNKNOWN_HOST to ORV_ERROR_CERTIFICATE, ORV_ERROR_HTTP minus the HTTP
// status, or ORV_ERROR_IO for what is none of these or is not asked. Blocks for
// five seconds at most; ends early when another thread sets cancelled.
android::status_t checkServer(const std::string& url, const RequestHeaders& headers,
                              const std::atomic<bool>& cancelled, std::vector<uint8_t>& sample);

}  // namespace orvtarn
