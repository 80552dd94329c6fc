// SPDX-License-Identifier: Apache-2.0
#include <errno.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <os/MemoryPool.h>
#include <stdint.h>
#include <string.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <future>
#include <thread>
#include <vector>

#include "PosixCalls.h"

namespace orvtest {
namespace {

using testing::internal::CaptureStderr;
using testing::internal::CaptureStdout;
using testing::internal::GetCapturedStderr;
using testing::internal::GetCapturedStdout;

MemoryBlock* blockOf(void* memory) {
    return reinterpret_cast<MemoryBlock*>(static_cast<char*>(memory) - MEMORY_HEADER_SIZE);
}

int semaphoreValue() {
    int value = -1;
    sem_getvalue(&sem, &value);
    return value;
}

// The live blocks from the head on, seen to be linked both ways.
std::vector<MemoryBlock*> liveBlocks() {
    std::vector<MemoryBlock*> blocks;
    for (MemoryBlock* block = memorys.head.next; block != &memorys.head; block = block->next) {
        EXPECT_EQ(block->prev->next, block);
        EXPECT_EQ(block->next->prev, block);
        blocks.push_back(block);
    }
    return blocks;
}

class MemoryPoolTest : public testing::Test {
protected:
    void SetUp() override { ASSERT_EQ(mem_init(), 0); }
    void TearDown() override {
        EXPECT_TRUE(liveBlocks().empty());
        EXPECT_EQ(semaphoreValue(), 1);
        EXPECT_EQ(mem_uninit(), 0);
    }
};

TEST_F(MemoryPoolTest, BlockHoldsItsSizeAndItsOwnAddress) {
    void* memory = mem_alloc(100);
    ASSERT_NE(memory, nullptr);
    EXPECT_EQ(blockOf(memory)->size, 100);
    EXPECT_EQ(blockOf(memory)->reserved, 0);
    void* first = nullptr;
    memcpy(&first, memory, sizeof(first));
    EXPECT_EQ(first, memory);
    const char* bytes = static_cast<char*>(memory);
    for (int i = sizeof(first); i < 100; i++) ASSERT_EQ(bytes[i], 0) << "byte " << i;
    mem_free(memory);
}

TEST_F(MemoryPoolTest, BlockBeginsWithItsMapping) {
    size_t length = 0;
    void* mapping = nullptr;
    int protection = 0;
    int flags = 0;
    auto record = mmapCall.replace([&](void* a, size_t l, int p, int f, int fd, off_t o) {
        EXPECT_EQ(semaphoreValue(), 0);
        EXPECT_EQ(a, nullptr);
        EXPECT_EQ(fd, -1);
        EXPECT_EQ(o, 0);
        length = l;
        protection = p;
        flags = f;
        return mapping = mmapCall.real(a, l, p, f, fd, o);
    });
    void* memory = mem_alloc(1000);
    EXPECT_EQ(length, 1000 + MEMORY_HEADER_SIZE);
    EXPECT_EQ(protection, PROT_READ | PROT_WRITE);
    EXPECT_EQ(flags, MAP_PRIVATE | MAP_ANONYMOUS);
    EXPECT_EQ(blockOf(memory), mapping);
    mem_free(memory);
}

TEST_F(MemoryPoolTest, HeaderIsTheContractsOnA32BitTarget) {
    EXPECT_EQ(offsetof(MemoryBlock, size), 0u);
    EXPECT_EQ(offsetof(MemoryBlock, reserved), 4u);
    EXPECT_EQ(offsetof(MemoryBlock, next), 8u);
    EXPECT_EQ(offsetof(MemoryBlock, prev), 8u + sizeof(void*));
    EXPECT_EQ(MEMORY_HEADER_SIZE, sizeof(void*) == 4 ? 16u : 32u);
}

// Whoever has the semaphore finds whole blocks on the list.
TEST_F(MemoryPoolTest, BlockIsWholeBeforeTheSemaphoreIsGivenBack) {
    void* itself = nullptr;
    int size = 0;
    auto look = semPostCall.replace([&](sem_t* semaphore) {
        const MemoryBlock* block = memorys.head.prev;
        if (block != &memorys.head) {
            size = block->size;
            memcpy(&itself, reinterpret_cast<const char*>(block) + MEMORY_HEADER_SIZE,
                   sizeof(itself));
        }
        return semPostCall.real(semaphore);
    });
    void* memory = mem_alloc(100);
    EXPECT_EQ(itself, memory);
    EXPECT_EQ(size, 100);
    mem_free(memory);
}

TEST_F(MemoryPoolTest, BlocksStandInTheOrderOfTheirAllocation) {
    void* first = mem_alloc(1);
    void* second = mem_alloc(2);
    void* third = mem_alloc(3);
    EXPECT_EQ(liveBlocks(),
              (std::vector<MemoryBlock*>{blockOf(first), blockOf(second), blockOf(third)}));
    mem_free(second);
    EXPECT_EQ(liveBlocks(), (std::vector<MemoryBlock*>{blockOf(first), blockOf(third)}));
    mem_free(third);
    mem_free(first);
}

TEST_F(MemoryPoolTest, FreeingTheFirstOfTwoLeavesTheSecondLinkedBothWays) {
    void* first = mem_alloc(10);
    void* second = mem_alloc(20);
    mem_free(first);
    EXPECT_EQ(memorys.head.next, blockOf(second));
    EXPECT_EQ(memorys.head.prev, blockOf(second));
    EXPECT_EQ(blockOf(second)->next, &memorys.head);
    EXPECT_EQ(blockOf(second)->prev, &memorys.head);
    mem_free(second);
}

TEST_F(MemoryPoolTest, FreeGivesTheWholeMappingBackUnderTheSemaphore) {
    void* memory = mem_alloc(10000);
    MemoryBlock* const block = blockOf(memory);
    size_t length = 0;
    int result = -1;
    auto record = munmapCall.replace([&](void* address, size_t l) {
        if (address != block) return munmapCall.real(address, l);
        length = l;
        EXPECT_EQ(semaphoreValue(), 0);
        EXPECT_TRUE(liveBlocks().empty());
        return result = munmapCall.real(address, l);
    });
    mem_free(memory);
    EXPECT_EQ(length, 10000 + MEMORY_HEADER_SIZE);
    EXPECT_EQ(result, 0);
}

TEST_F(MemoryPoolTest, SizeZeroIsAMappingOfTheHeaderAlone) {
    size_t length = 0;
    auto record = mmapCall.replace([&](void* a, size_t l, int p, int f, int fd, off_t o) {
        length = l;
        return mmapCall.real(a, l, p, f, fd, o);
    });
    void* memory = mem_alloc(0);
    ASSERT_NE(memory, nullptr);
    EXPECT_EQ(length, MEMORY_HEADER_SIZE);
    EXPECT_EQ(reinterpret_cast<uintptr_t>(memory) % sysconf(_SC_PAGESIZE), MEMORY_HEADER_SIZE);
    mem_free(memory);
}

TEST_F(MemoryPoolTest, NegativeSizeWraps) {
    size_t length = 0;
    auto record = mmapCall.replace([&](void*, size_t l, int, int, int, off_t) {
        length = l;
        errno = ENOMEM;
        return MAP_FAILED;
    });
    CaptureStderr();
    EXPECT_EQ(mem_alloc(-8), nullptr);
    GetCapturedStderr();
    EXPECT_EQ(length, MEMORY_HEADER_SIZE - 8);
}

TEST_F(MemoryPoolTest, FailedMappingIsReportedAndLeavesTheListAsItWas) {
    void* kept = mem_alloc(10);
    CaptureStderr();
    {
        auto failure = mmapCall.replace([](void*, size_t, int, int, int, off_t) {
            errno = ENOMEM;
            return MAP_FAILED;
        });
        auto post = semPostCall.replace([](sem_t* semaphore) {
            fputs("given back\n", stderr);
            return semPostCall.real(semaphore);
        });
        EXPECT_EQ(mem_alloc(4096), nullptr);
    }
    EXPECT_EQ(GetCapturedStderr(),
              std::string("mmap failed \n: ") + strerror(ENOMEM) + "\ngiven back\n");
    EXPECT_EQ(liveBlocks(), std::vector<MemoryBlock*>{blockOf(kept)});
    EXPECT_EQ(semaphoreValue(), 1);
    mem_free(kept);
}

// Every thread finds its blocks as it left them, and the list is whole at the end.
TEST_F(MemoryPoolTest, ManyThreadsAllocateAndFree) {
    constexpr int kThreads = 4;
    std::atomic<int> damaged{0};
    std::vector<void*> kept(kThreads);
    std::vector<std::thread> threads;
    for (int id = 0; id < kThreads; id++) {
        threads.emplace_back([&, id] {
            const auto isWhole = [id](void* memory, int size) {
                const auto* bytes = static_cast<const char*>(memory);
                return blockOf(memory)->size == size &&
                       std::all_of(bytes, bytes + size, [id](char c) { return c == id; });
            };
            for (int i = 0; i < 200; i++) {
                void* first = mem_alloc(i);
                void* second = mem_alloc(i + 1);
                memset(first, id, i);
                memset(second, id, i + 1);
                damaged += !isWhole(first, i);
                mem_free(first);
                damaged += !isWhole(second, i + 1);
                mem_free(second);
            }
            kept[id] = mem_alloc(id);
        });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(damaged, 0);
    std::vector<MemoryBlock*> expected;
    for (void* memory : kept) expected.push_back(blockOf(memory));
    EXPECT_THAT(liveBlocks(), testing::UnorderedElementsAreArray(expected));
    for (void* memory : kept) mem_free(memory);
}

TEST(MemoryPoolSemaphoreTest, FreeingNullDoesNotTouchTheSemaphore) {
    sem_init(&sem, 0, 0);
    mem_free(nullptr);
    EXPECT_EQ(semaphoreValue(), 0);
}

TEST(MemoryPoolSemaphoreTest, AllocationWaitsForTheSemaphore) {
    sem_init(&sem, 0, 0);
    std::atomic<bool> opened{false};
    std::promise<void> waiting;
    auto wait = semWaitCall.replace([&](sem_t* s) {
        if (!opened) waiting.set_value();
        return semWaitCall.real(s);
    });
    auto record = mmapCall.replace([&](void* a, size_t l, int p, int f, int fd, off_t o) {
        EXPECT_TRUE(opened);
        return mmapCall.real(a, l, p, f, fd, o);
    });
    auto memory = std::async(std::launch::async, [] { return mem_alloc(1); });
    EXPECT_EQ(waiting.get_future().wait_for(std::chrono::seconds(10)), std::future_status::ready);
    opened = true;
    sem_post(&sem);
    mem_free(memory.get());
    EXPECT_EQ(semaphoreValue(), 1);
    mem_uninit();
}

TEST(MemoryPoolSemaphoreTest, UninitialisationDestroysTheSemaphoreAndKeepsTheBlocks) {
    ASSERT_EQ(mem_init(), 0);
    void* kept = mem_alloc(1);
    sem_t* destroyed = nullptr;
    {
        auto failure = semDestroyCall.replace([&](sem_t* s) {
            destroyed = s;
            return -1;
        });
        EXPECT_EQ(mem_uninit(), -1);
    }
    EXPECT_EQ(destroyed, &sem);
    EXPECT_EQ(liveBlocks(), std::vector<MemoryBlock*>{blockOf(kept)});
    EXPECT_EQ(blockOf(kept)->size, 1);
    mem_free(kept);
    EXPECT_EQ(mem_uninit(), 0);
}

TEST(MemoryPoolSemaphoreTest, SemaphoreIsNotSharedWithOtherProcesses) {
    int shared = -1;
    auto record = semInitCall.replace([&](sem_t* s, int isShared, unsigned value) {
        if (s == &sem) shared = isShared;
        return semInitCall.real(s, isShared, value);
    });
    ASSERT_EQ(mem_init(), 0);
    EXPECT_EQ(shared, 0);
    EXPECT_EQ(mem_uninit(), 0);
}

TEST(MemoryPoolSemaphoreTest, FailedInitialisationIsPrintedAndGivesTheLinesLength) {
    auto failure = semInitCall.replace([](sem_t*, int, unsigned) {
        errno = ENOSYS;
        return -1;
    });
    CaptureStdout();
    const int result = mem_init();
    const std::string line = GetCapturedStdout();
    EXPECT_EQ(line, "semaphore init error " + std::to_string(ENOSYS) + "\n");
    EXPECT_EQ(result, static_cast<int>(line.size()));
}

}  // namespace
}  // namespace orvtest
