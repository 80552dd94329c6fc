// SPDX-License-Identifier: Apache-2.0
#include "AllocationFailure.h"

#include <new>

namespace orvtest {
namespace {

struct Plan {
    int countdown = 0;  // the allocation that brings it from 1 to 0 fails
    size_t bytes = 0;   // allocations of this size fail; 0 for none
    int failed = 0;
};
thread_local Plan tPlan;

bool mustFail(size_t bytes) {
    const bool hit = (tPlan.countdown > 0 && --tPlan.countdown == 0) ||
                     (tPlan.bytes != 0 && tPlan.bytes == bytes);
    if (hit) tPlan.failed++;
    return hit;
}

}  // namespace

AllocationFailure::AllocationFailure(int n, size_t bytes) { tPlan = {n, bytes, 0}; }
AllocationFailure::~AllocationFailure() { tPlan = {}; }
int AllocationFailure::failed() const { return tPlan.failed; }

}  // namespace orvtest

// Replaces the library's for the whole test program; memory still comes from
// the ordinary operator, so that the ordinary delete takes it back.
void* operator new(size_t bytes, const std::nothrow_t&) noexcept {
    if (orvtest::mustFail(bytes)) return nullptr;
    try {
        return ::operator new(bytes);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}
