// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvcounts {

// A path through the library that programs take often. run takes it so many
// times, counted. "NAME/10" and "NAME/0" are one row, NAME: a tenth of what the
// ten cost more than none.
struct Path {
    const char* name;
    void (*run)(int times);
};

// Commands and records, then streams and memory, then events.
extern const Path kCallPaths[9];
extern const Path kMemoryPaths[4];
extern const Path kEventPaths[2];

}  // namespace orvcounts
