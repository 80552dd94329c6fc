// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <semaphore.h>
#include <stddef.h>
#include <stdint.h>

#include "os/Export.h"

// A pool in which every allocation is a private anonymous mapping of its own:
// at least one page each. Live blocks stand on one circular list.

// The head of each mapping; the caller's memory begins MEMORY_HEADER_SIZE
// bytes from its start.
struct MemoryBlock {
    int32_t size;  // bytes, as asked for
    int32_t reserved;
    MemoryBlock* next;
    MemoryBlock* prev;
};

struct MemoryList {
    MemoryBlock head;  // its own next and prev while the list is empty
    int32_t reserved;
};

enum : size_t { MEMORY_HEADER_SIZE = (sizeof(MemoryBlock) + 15) / 16 * 16 };

extern sem_t sem;  // guards the list; count 0 until mem_init
extern MemoryList memorys;

extern "C" {

// Must run before mem_alloc and mem_free, which block for ever otherwise. 0,
// or the length of the error line that it printed.
ORV_EXPORT int mem_init();
// Outstanding blocks stay mapped. The result of sem_destroy.
ORV_EXPORT int mem_uninit();
// Zero-filled memory whose first word holds its own address; null when it
// cannot be mapped. The size is not checked: a negative one wraps.
ORV_EXPORT void* mem_alloc(int size);
// Null is ignored.
ORV_EXPORT void mem_free(void* p);

}  // extern "C"
