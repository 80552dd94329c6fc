// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvbench {

// The parts of the library that need no loop in Java, and what stands beside
// them: the same by hand.
void registerLibraryBenchmarks();

}  // namespace orvbench
