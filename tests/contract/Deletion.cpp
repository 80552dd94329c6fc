// SPDX-License-Identifier: Apache-2.0
#include "Deletion.h"

#include <gtest/gtest.h>
#include <stddef.h>

#include <atomic>
#include <new>

extern "C" {
void* __real_malloc(size_t);
void __real_free(void*);
}

namespace orvtest {
namespace {

// Without code at load time: memory is deleted before and after everything else.
std::atomic<const void*> gAwaited[8];
const char gFree = 0;  // its address stands for a deletion that has happened

void noteDeletion(const void* block) {
    if (block == nullptr) return;
    for (auto& awaited : gAwaited) {
        const void* expected = block;
        awaited.compare_exchange_strong(expected, &gFree);
    }
}

}  // namespace

Deletion::Deletion(const void* block) {
    for (auto& awaited : gAwaited) {
        const void* none = nullptr;
        if (awaited.compare_exchange_strong(none, block)) return;
        mSlot++;
    }
    ADD_FAILURE() << "too many at a time";
    mSlot = 0;
}

Deletion::~Deletion() { gAwaited[mSlot] = nullptr; }

bool Deletion::happened() const { return gAwaited[mSlot] == &gFree; }

}  // namespace orvtest

// These replace the library's for the whole test program. The memory is not counted
// among what the code under test asks malloc for.
void* operator new(size_t bytes) {
    void* block = __real_malloc(bytes > 0 ? bytes : 1);
    if (block == nullptr) throw std::bad_alloc();
    return block;
}

void operator delete(void* block) noexcept {
    orvtest::noteDeletion(block);
    __real_free(block);
}

void operator delete(void* block, size_t) noexcept { operator delete(block); }
