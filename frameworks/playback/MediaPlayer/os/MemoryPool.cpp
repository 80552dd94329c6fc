// SPDX-License-Identifier: Apache-2.0
#include "os/MemoryPool.h"

#include <errno.h>
#include <stdio.h>
#include <sys/mman.h>

sem_t sem;
MemoryList memorys = {{0, 0, &memorys.head, &memorys.head}, 0};

namespace {

// The wrap of a negative size is that of 32-bit arithmetic on every target.
size_t mappingLength(int size) {
    return static_cast<uint32_t>(size) + static_cast<uint32_t>(MEMORY_HEADER_SIZE);
}

void linkAtTail(MemoryBlock* block) {
    block->next = &memorys.head;
    block->prev = memorys.head.prev;
    memorys.head.prev->next = block;
    memorys.head.prev = block;
}

void unlink(MemoryBlock* block) {
    block->next->prev = block->prev;
    block->prev->next = block->next;
}

}  // namespace

int mem_init() {
    if (sem_init(&sem, 0, 1) != 0) return printf("semaphore init error %d\n", errno);
    return 0;
}

int mem_uninit() { return sem_destroy(&sem); }

void* mem_alloc(int size) {
    sem_wait(&sem);
    void* mapping = mmap(nullptr, mappingLength(size), PROT_READ | PROT_WRITE,
                         MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (mapping == MAP_FAILED) {
        perror("mmap failed \n");
        sem_post(&sem);
        return nullptr;
    }
    MemoryBlock* block = static_cast<MemoryBlock*>(mapping);
    block->size = size;
    linkAtTail(block);
    void* memory = static_cast<char*>(mapping) + MEMORY_HEADER_SIZE;
    *static_cast<void**>(memory) = memory;
    sem_post(&sem);
    return memory;
}

void mem_free(void* p) {
    if (p == nullptr) return;
    sem_wait(&sem);
    MemoryBlock* block = reinterpret_cast<MemoryBlock*>(static_cast<char*>(p) - MEMORY_HEADER_SIZE);
    unlink(block);
    munmap(block, mappingLength(block->size));
    sem_post(&sem);
}
