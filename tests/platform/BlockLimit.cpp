// SPDX-License-Identifier: Apache-2.0

// For the whole test program: no block of memory is larger than a gibibyte, on
// machines of every size.

#include <stddef.h>
#include <stdlib.h>

#include <new>

void* operator new(size_t bytes, const std::nothrow_t&) noexcept {
    constexpr size_t kLimit = size_t{1} << 30;
    return bytes < kLimit ? malloc(bytes != 0 ? bytes : 1) : nullptr;
}

void* operator new(size_t bytes) {
    void* const memory = operator new(bytes, std::nothrow);
    if (memory == nullptr) throw std::bad_alloc();
    return memory;
}

void operator delete(void* memory) noexcept { free(memory); }
void operator delete(void* memory, size_t) noexcept { free(memory); }
