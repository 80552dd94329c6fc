// SPDX-License-Identifier: Apache-2.0
#include "playback/SubtitleLoader.h"

#include <algorithm>
#include <utility>

#include "base/EngineLog.h"
#include "base/ThreadName.h"
#include "source/UrlScheme.h"

namespace orvtarn {
namespace {

using Clock = std::chrono::steady_clock;

constexpr std::chrono::seconds kServerLimit{10};
constexpr double kPollSeconds = 0.05;
constexpr uint64_t kCommand = 1;

bool isLocal(const SubtitleFile& file) { return schemeOf(file.name).empty(); }

// The demuxer for VobSub finds the pictures beside the index, unless it gets them. A
// quoted value: the length in bytes, then the text as it is.
std::string demuxerOptions(const SubtitleFile& file) {
    std::string options =
        "protocol_whitelist=[" + std::string(protocolWhitelist(isLocal(file))) + "]";
    if (!file.pictures.empty()) {
        options += ",sub_name=%" + std::to_string(file.pictures.size()) + "%" + file.pictures;
    }
    return options;
}

void openOrLog(SubtitleLoader& loader, const SubtitleFile& file) {
    const int error = loader.open(file);
    if (error < 0) refused("prepare", ("no subtitles from " + file.name).c_str());
}

}  // namespace

int SubtitleLoader::open(const SubtitleFile& file) {
    std::lock_guard<std::mutex> lock(mOpenMutex);
    // As a tree: mpv does not take its own text for a list with commas in it.
    MpvNode usual;
    const bool hasUsual = mMpv.getNode("demuxer-lavf-o", usual);
    mMpv.set("demuxer-lavf-o", demuxerOptions(file));
    const int error = isLocal(file) ? openNow(file) : openInTime(file);
    if (hasUsual) mMpv.set("demuxer-lavf-o", usual);
    return error;
}

// mpv turns on the first of several languages.
int SubtitleLoader::openNow(const SubtitleFile& file) {
    return mMpv.command({"sub-add", file.name.c_str(), file.turnOn ? "select" : "auto"});
}

int SubtitleLoader::openInTime(const SubtitleFile& file) {
    mpv_handle* client = mpv_create_client(mMpv.get(), "subtitles");
    if (client == nullptr) return MPV_ERROR_NOMEM;
    const char* command[] = {"sub-add", file.name.c_str(), file.turnOn ? "select" : "auto",
                             nullptr};
    int error = mpv_command_async(client, kCommand, command);
    if (error >= 0) error = awaitReply(client, Clock::now() + kServerLimit);
    mpv_destroy(client);
    return error;
}

int SubtitleLoader::awaitReply(mpv_handle* client, Clock::time_point deadline) {
    bool aborted = false;
    for (;;) {
        const mpv_event& event = *mpv_wait_event(client, kPollSeconds);
        if (event.event_id == MPV_EVENT_COMMAND_REPLY) return event.error;
        if (event.event_id == MPV_EVENT_SHUTDOWN) return MPV_ERROR_GENERIC;
        if (aborted || (!mCancelled && Clock::now() < deadline)) continue;
        mpv_abort_async_command(client, kCommand);
        aborted = true;
    }
}

void SubtitleLoader::openAll(const std::vector<SubtitleFile>& files) {
    cancel();
    std::vector<SubtitleFile> served;
    for (auto file = files.begin(); file != files.end(); ++file) {
        if (isLocal(*file)) {
            openOrLog(*this, *file);
            continue;
        }
        served.push_back(*file);
        // Those that come later are the ones that were to be on in the end.
        served.back().turnOn = file->turnOn && std::none_of(file + 1, files.end(),
                                                            [](auto& next) { return next.turnOn; });
    }
    if (served.empty()) return;
    std::lock_guard<std::mutex> lock(mThreadMutex);
    mCancelled = false;
    mThread = std::thread([this, served = std::move(served)] {
        nameThisThread("orv-subtitles");
        for (const SubtitleFile& file : served) {
            if (!mCancelled) openOrLog(*this, file);
        }
    });
}

void SubtitleLoader::cancel() {
    std::lock_guard<std::mutex> lock(mThreadMutex);
    mCancelled = true;
    if (mThread.joinable()) mThread.join();
    mCancelled = false;
}

}  // namespace orvtarn
