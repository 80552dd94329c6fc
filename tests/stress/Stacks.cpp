// SPDX-License-Identifier: Apache-2.0
#include "Stacks.h"

#include <dirent.h>
#include <dlfcn.h>
#include <execinfo.h>
#include <semaphore.h>
#include <signal.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/prctl.h>
#include <sys/syscall.h>
#include <time.h>
#include <unistd.h>

#include <string>
#include <vector>

namespace stress {

namespace {

const int kSignal = SIGUSR2;
const int kMostFrames = 64;

// What the thread that was asked last answered.
void* sFrames[kMostFrames];
int sCount = 0;
sem_t sAnswered;

void answer(int) {
    sCount = backtrace(sFrames, kMostFrames);
    sem_post(&sAnswered);
}

std::vector<int> threads() {
    std::vector<int> ids;
    DIR* folder = opendir("/proc/self/task");
    if (folder == nullptr) return ids;
    while (const dirent* entry = readdir(folder)) {
        if (entry->d_name[0] != '.') ids.push_back(atoi(entry->d_name));
    }
    closedir(folder);
    return ids;
}

bool awaitAnswer() {
    timespec limit;
    clock_gettime(CLOCK_REALTIME, &limit);
    limit.tv_sec += 5;
    return sem_timedwait(&sAnswered, &limit) == 0;
}

// "function at file:line", or what the library's own tables say.
void printFrame(void* frame) {
    Dl_info info;
    if (dladdr(frame, &info) == 0 || info.dli_fname == nullptr) {
        fprintf(stderr, "    %p\n", frame);
        return;
    }
    // The call stands before the address that it returns to.
    const auto offset = static_cast<char*>(frame) - static_cast<char*>(info.dli_fbase) - 1;
    char command[4096];
    snprintf(command, sizeof command, "addr2line -Cpfi -e '%s' %#tx 2>&1", info.dli_fname, offset);
    fflush(stderr);
    FILE* output = popen(command, "r");
    char line[2048];
    bool any = false;
    while (output != nullptr && fgets(line, sizeof line, output) != nullptr) {
        any = true;
        fprintf(stderr, "    %s", line);
    }
    if (output != nullptr) pclose(output);
    if (!any) fprintf(stderr, "    %s+%#tx\n", info.dli_fname, offset);
}

void printBySignal() {
    const int self = static_cast<int>(syscall(SYS_gettid));
    for (const int thread : threads()) {
        if (thread == self) continue;
        fprintf(stderr, "  thread %d\n", thread);
        if (syscall(SYS_tgkill, getpid(), thread, kSignal) != 0 || !awaitAnswer()) {
            fprintf(stderr, "    does not answer\n");
            continue;
        }
        // The first two are the signal's own.
        for (int i = 2; i < sCount; ++i) printFrame(sFrames[i]);
    }
}

bool printByGdb() {
    // It may attach: it is a child, not a parent.
    prctl(PR_SET_PTRACER, PR_SET_PTRACER_ANY, 0, 0, 0);
    const std::string command =
        "command -v gdb >/dev/null && gdb -p " + std::to_string(getpid()) +
        " -batch -nx -ex 'set pagination off' -ex 'thread apply all bt' >&2 2>/dev/null";
    return system(("{ " + command + "; }").c_str()) == 0;
}

}  // namespace

void prepareStacks() {
    sem_init(&sAnswered, 0, 0);
    void* frame;
    backtrace(&frame, 1);  // the first call loads a library
    struct sigaction action = {};
    action.sa_handler = answer;
    action.sa_flags = SA_RESTART;
    sigaction(kSignal, &action, nullptr);
}

void printStacks() {
    if (getenv("ORV_STACKS_BY_SIGNAL") != nullptr || !printByGdb()) printBySignal();
}

}  // namespace stress
