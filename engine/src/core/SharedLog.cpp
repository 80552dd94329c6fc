// SPDX-License-Identifier: Apache-2.0
#include "core/SharedLog.h"

#include <mutex>

namespace orvtarn {
namespace {

std::mutex gCoresMutex;
int gCores = 0;
// The one that was made while there was no other; null when that one is gone or, of
// several that were made at once, not known.
const SharedLog* gFirst = nullptr;
bool gFirstIsMade = false;

}  // namespace

bool SharedLog::isOfFfmpeg(std::string_view writer) { return writer.substr(0, 6) == "ffmpeg"; }

void SharedLog::enter() {
    std::lock_guard<std::mutex> lock(gCoresMutex);
    mEntered = true;
    if (gCores++ == 0) {
        gFirst = this;
        gFirstIsMade = false;
    } else if (!gFirstIsMade) {
        gFirst = nullptr;
    }
}

void SharedLog::settle() {
    std::lock_guard<std::mutex> lock(gCoresMutex);
    if (gFirst == this) gFirstIsMade = true;
}

void SharedLog::leave() {
    std::lock_guard<std::mutex> lock(gCoresMutex);
    if (!mEntered) return;
    mEntered = false;
    gCores--;
    if (gFirst == this) gFirst = nullptr;
}

bool SharedLog::isOwn() const {
    std::lock_guard<std::mutex> lock(gCoresMutex);
    return gFirst == this && gCores == 1;
}

}  // namespace orvtarn
