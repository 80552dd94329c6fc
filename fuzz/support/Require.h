// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace orvfuzz {

// Ends the program with that message unless the promise holds: a fuzzer then
// keeps the input, and a replay fails.
void require(bool holds, const char* promise);
void require(bool holds, const std::string& promise);

}  // namespace orvfuzz
