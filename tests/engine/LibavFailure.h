// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace orvtest {

// While it lives, one of libav's functions fails wherever the engine itself calls it, as
// it does without memory or for damaged media: from the n-th call on, counted from 1. The
// linker's --wrap leads the calls here; mpv's own calls are not among them. One at a time.
class LibavFailure {
public:
    explicit LibavFailure(const std::string& function, int from = 1);
    ~LibavFailure();
    LibavFailure(const LibavFailure&) = delete;
    LibavFailure& operator=(const LibavFailure&) = delete;

    // How many calls were failed so far.
    int count() const;
};

}  // namespace orvtest
