// SPDX-License-Identifier: Apache-2.0
#include "PixelMemory.h"

#include <sys/mman.h>

#include <new>

namespace android {

namespace {

// Powers of two, so that a window that is dragged larger keeps its buffers most
// of the time. Pages nobody touches cost no memory.
size_t capacityFor(size_t bytes) {
    size_t capacity = 4096;
    while (capacity < bytes) capacity *= 2;
    return capacity;
}

}  // namespace

sp<PixelMemory> PixelMemory::allocate(size_t bytes) {
    const size_t capacity = capacityFor(bytes);
    void* const data =
        mmap(nullptr, capacity, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (data == MAP_FAILED) return nullptr;
    sp<PixelMemory> memory = new (std::nothrow) PixelMemory(static_cast<uint8_t*>(data), capacity);
    if (memory == nullptr) munmap(data, capacity);
    return memory;
}

PixelMemory::~PixelMemory() { munmap(mData, mCapacity); }

}  // namespace android
