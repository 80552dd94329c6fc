// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <deque>
#include <mutex>
#include <string>

namespace android {

// Keeps the newest lines of this process's log while it is open, of all
// priorities. Meanwhile the terminal gets the lines that it got before.
// Thread-safe.
class LogReader {
public:
    LogReader();
    ~LogReader();
    LogReader(const LogReader&) = delete;
    LogReader& operator=(const LogReader&) = delete;

    // The lines since the last call, the oldest first, and empties the reader.
    // Each is the number of its priority, its time in milliseconds since 1970,
    // its tag and its text, each of the four ended by a zero byte.
    std::string take();

    // How many lines found no room since the reader is open: the oldest go first.
    int64_t lost() const;

    // For the log alone.
    void add(int priority, const char* tag, const char* text);

private:
    mutable std::mutex mMutex;
    std::deque<std::string> mLines;
    int64_t mLost = 0;
};

// Gives a line to the open readers. Whether the terminal gets it, too.
bool giveToLogReaders(int priority, const char* tag, const char* text);

}  // namespace android
