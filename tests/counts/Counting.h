// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <functional>

namespace orvcounts {

// Runs a body, on the calling thread.
using Runner = std::function<void(const std::function<void()>& body)>;
// One run of a path: what it gives to its runner counts, the rest does not.
using Round = std::function<void(const Runner& counted)>;

// Runs the round once uncounted, for what happens the first time alone, then so
// often counted.
void repeat(int times, const Round& round);

// Ends the program with status 1 and a line on standard error unless it holds: a
// path that did not do its work has no count.
void require(bool holds, const char* what);

}  // namespace orvcounts
