// SPDX-License-Identifier: Apache-2.0
#include <android/log.h>
#include <stdlib.h>
#include <string.h>

namespace {

struct Level {
    const char* name;
    android_LogPriority priority;
};

constexpr Level kLevels[] = {
    {"verbose", ANDROID_LOG_VERBOSE}, {"debug", ANDROID_LOG_DEBUG}, {"info", ANDROID_LOG_INFO},
    {"warn", ANDROID_LOG_WARN},       {"error", ANDROID_LOG_ERROR}, {"silent", ANDROID_LOG_SILENT},
};

// A television's log is a service of its own; here it is the terminal, where
// a program wants to hear of what went wrong alone unless it asks for more.
__attribute__((constructor)) void setLogPriority() {
    __android_log_set_minimum_priority(ANDROID_LOG_WARN);
    const char* name = getenv("ORV_LOG");
    if (name == nullptr) return;
    for (const Level& level : kLevels) {
        if (strcmp(level.name, name) == 0) __android_log_set_minimum_priority(level.priority);
    }
}

}  // namespace
