// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>

#include <string>
#include <utility>
#include <vector>

namespace orvtarn {

// Options of mpv: names and values, both as they are, nothing quoted.
using MpvOptions = std::vector<std::pair<std::string, std::string>>;

// Opens the media in place of those before, with these options for them alone.
// Returns before they are open. 0 or an mpv_error.
int loadMedia(mpv_handle* mpv, const std::string& name, const MpvOptions& options);

}  // namespace orvtarn
