// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <android/log.h>
#include <fcntl.h>
#include <stdio.h>
#include <unistd.h>

namespace orvbench {

// While it lives, the log is written as ever, to where nobody reads it.
class LogToNowhere {
public:
    LogToNowhere() : mStandardError(dup(STDERR_FILENO)) {
        const int nowhere = open("/dev/null", O_WRONLY | O_CLOEXEC);
        dup2(nowhere, STDERR_FILENO);
        close(nowhere);
        __android_log_set_minimum_priority(ANDROID_LOG_INFO);
    }
    ~LogToNowhere() {
        __android_log_set_minimum_priority(ANDROID_LOG_SILENT);
        dup2(mStandardError, STDERR_FILENO);
        close(mStandardError);
    }
    LogToNowhere(const LogToNowhere&) = delete;
    LogToNowhere& operator=(const LogToNowhere&) = delete;

private:
    const int mStandardError;
};

}  // namespace orvbench
