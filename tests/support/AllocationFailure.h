// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>

namespace orvtest {

// While one lives, chosen allocations of `new (std::nothrow)` on its thread
// yield null. One at a time per thread.
class AllocationFailure {
public:
    // Fails the n-th such allocation from now, counted from 1.
    static AllocationFailure nth(int n) { return AllocationFailure(n, 0); }
    // Fails every such allocation of that many bytes.
    static AllocationFailure ofSize(size_t bytes) { return AllocationFailure(0, bytes); }
    template <class T>
    static AllocationFailure of() {
        return ofSize(sizeof(T));
    }

    ~AllocationFailure();
    AllocationFailure(const AllocationFailure&) = delete;
    AllocationFailure& operator=(const AllocationFailure&) = delete;

    // How many allocations were failed so far.
    int failed() const;

private:
    AllocationFailure(int n, size_t bytes);
};

}  // namespace orvtest
