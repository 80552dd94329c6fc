// SPDX-License-Identifier: Apache-2.0
// Notes which functions each test calls: linked into a test program whose other
// sources are compiled with -finstrument-functions. ORV_REACH names the file it
// appends to, a line for each test: its name, then addresses in the program.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <atomic>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

extern "C" const char __executable_start;

namespace {

constexpr size_t kSlots = 1 << 16;
std::atomic<uintptr_t> slots[kSlots];
std::atomic<bool> isChild{false};  // the program again, for a death test
pid_t mainProcess = getpid();
std::string childsTest;

void append(const std::string& text) {
    const char* path = getenv("ORV_REACH");
    const int file = path ? open(path, O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0644) : -1;
    if (file < 0) return;
    if (write(file, text.data(), text.size()) < 0) perror(path);
    close(file);
}

std::string addressText(uintptr_t address) {
    char text[24];
    snprintf(text, sizeof text, " %zx",
             static_cast<size_t>(address - reinterpret_cast<uintptr_t>(&__executable_start)));
    return text;
}

bool insert(uintptr_t address) {
    size_t at = (address >> 4) * 0x9E3779B97F4A7C15u >> 48;
    for (size_t i = 0; i < kSlots; ++i, at = (at + 1) % kSlots) {
        uintptr_t there = slots[at].load(std::memory_order_relaxed);
        if (there == address) return false;
        if (there == 0 && slots[at].compare_exchange_strong(there, address)) return true;
        if (there == address) return false;
    }
    return false;
}

// What another of its tests reached is not forgotten by a child, which dies.
void noteInChild(uintptr_t address) {
    if (isChild || getpid() != mainProcess) append(childsTest + addressText(address) + "\n");
}

void note(uintptr_t address) {
    if (insert(address)) noteInChild(address);
}

// What a thread is within. A loop that an earlier test began on a thread of its own is
// of each later test, too, that has the thread call something.
constexpr size_t kDepth = 256;
thread_local uintptr_t frames[kDepth];
thread_local size_t depth = 0;
thread_local unsigned notedFor = 0;
std::atomic<unsigned> testNumber{1};

class Reach : public testing::EmptyTestEventListener {
    void OnTestStart(const testing::TestInfo& info) override {
        childsTest = name(info);
        ++testNumber;
    }
    void OnTestEnd(const testing::TestInfo& info) override {
        std::string line = name(info);
        for (auto& slot : slots) {
            if (const uintptr_t address = slot.exchange(0)) line += addressText(address);
        }
        append(line + "\n");
    }
    static std::string name(const testing::TestInfo& info) {
        return std::string(info.test_suite_name()) + "." + info.name();
    }
};

// A death test's child is the program again, with a filter for that test.
std::string testOfDeathTestsChild() {
    std::string words;
    if (FILE* file = fopen("/proc/self/cmdline", "r")) {
        for (int c; (c = fgetc(file)) != EOF;) words += static_cast<char>(c ? c : '\n');
        fclose(file);
    }
    const std::string filter = "--gtest_filter=";
    if (words.find("--gtest_internal_run_death_test") == std::string::npos) return "";
    const size_t start = words.rfind(filter) + filter.size();
    return words.substr(start, words.find('\n', start) - start);
}

const bool listens = [] {
    childsTest = testOfDeathTestsChild();
    isChild = !childsTest.empty();
    testing::UnitTest::GetInstance()->listeners().Append(new Reach);
    return true;
}();

}  // namespace

extern "C" void __cyg_profile_func_enter(void* function, void*) {
    const auto address = reinterpret_cast<uintptr_t>(function);
    if (depth < kDepth) frames[depth] = address;
    ++depth;
    const unsigned number = testNumber;
    if (notedFor != number) {
        notedFor = number;
        for (size_t i = 0; i < depth && i < kDepth; ++i) note(frames[i]);
    }
    note(address);
}

extern "C" void __cyg_profile_func_exit(void*, void*) { --depth; }
