// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace orvtarn {

// Distinguishes files from other media. True with the path for a path, which is taken
// as it is, and for a "file:" URL, whose percent codes are decoded; false for
// URLs of other kinds.
bool filePath(const std::string& name, std::string& path);

}  // namespace orvtarn
