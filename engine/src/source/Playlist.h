// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace orvtarn {

// Whether a file is a playlist or a manifest of streams, by the end of its name
// or by its first bytes. Reads the file, unless it is a pipe or a device.
bool isPlaylist(const std::string& path);

}  // namespace orvtarn
