// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <chrono>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "core/MpvHandle.h"

namespace orvtarn {

struct SubtitleFile {
    std::string name;
    std::string pictures;  // of a VobSub index; empty for those beside it
    bool turnOn;
};

// Has mpv open subtitle files as tracks of the media that it has open. Those
// from servers get ten seconds each. Any thread.
class SubtitleLoader {
public:
    explicit SubtitleLoader(MpvHandle& mpv) : mMpv(mpv) {}
    ~SubtitleLoader() { cancel(); }

    // Blocks until the file is open. 0 or an mpv_error.
    int open(const SubtitleFile& file);
    // Opens the local files, then those from servers on a thread of its own.
    // One that cannot be opened is a line in the log.
    void openAll(const std::vector<SubtitleFile>& files);
    // Ends the opening of files from servers that openAll began.
    void cancel();

private:
    int openNow(const SubtitleFile& file);
    int openInTime(const SubtitleFile& file);
    int awaitReply(mpv_handle* client, std::chrono::steady_clock::time_point deadline);

    MpvHandle& mMpv;
    std::mutex mOpenMutex;  // one file at a time: mpv's options are of the next one
    std::atomic<bool> mCancelled{false};
    std::mutex mThreadMutex;
    std::thread mThread;
};

}  // namespace orvtarn
