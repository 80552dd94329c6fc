// SPDX-License-Identifier: Apache-2.0
#include "Subtitles.h"

#include <algorithm>

#include "EngineLog.h"
#include "MediaSource.h"

namespace orvtarn {
namespace {

// The demuxer for VobSub finds the pictures beside the index, unless told.
constexpr char kDemuxerOptions[] = "demuxer-lavf-o";

}  // namespace

bool Subtitles::add(const char* operation, const char* url, bool turnOn) {
    std::string name;
    if (resolveName(url, name) != android::NO_ERROR) return refused(operation, "no such file");
    return addNamed(operation, name, turnOn);
}

bool Subtitles::addPair(const char* sub, const char* idx) {
    std::string pictures;
    std::string index;
    if (resolveName(sub, pictures) != android::NO_ERROR ||
        resolveName(idx, index) != android::NO_ERROR) {
        return refused("setSubtitleDataSourceEx", "no such file");
    }
    setPictureFile(pictures);
    return addNamed("setSubtitleDataSourceEx", index, true);
}

void Subtitles::setPictureFile(const std::string& sub) {
    // A quoted value: the length in bytes, then the text as it is.
    const std::string option = "sub_name=%" + std::to_string(sub.size()) + "%" + sub;
    mMpv.set(kDemuxerOptions, option);
}

bool Subtitles::addNamed(const char* operation, const std::string& name, bool turnOn) {
    const bool open = mState.read([](const PlayerState::Values& v) { return v.isOpen(); });
    if (open) return addNow(operation, name, turnOn);
    const Phase phase = mState.phase();
    if (phase != Phase::Initialized && phase != Phase::Stopped) {
        return PlayerState::wrongPhase(operation, phase) == android::NO_ERROR;
    }
    std::lock_guard<std::mutex> lock(mMutex);
    mPending.push_back({name, turnOn});
    return true;
}

bool Subtitles::addNow(const char* operation, const std::string& name, bool turnOn) {
    const int error = mMpv.command({"sub-add", name.c_str(), "auto"});
    mMpv.set(kDemuxerOptions, "");
    if (error < 0) return refused(operation, mpv_error_string(error));
    int count = 0;
    if (!turnOn) return true;
    return mTracks.subtitleCount(count) && mTracks.selectSubtitle(count - 1);
}

bool Subtitles::stage(int type, const void* record) {
    std::lock_guard<std::mutex> lock(mMutex);
    return mStyle.stage(type, record) || refused("setSubtitleAttr", "no such type or value");
}

bool Subtitles::flush() {
    std::lock_guard<std::mutex> lock(mMutex);
    bool done = true;
    for (const MpvAssignment& assignment : mStyle.flush()) {
        const int error = assign(mMpv.get(), assignment);
        if (error < 0) done = refused("flushSubtitleAttr", mpv_error_string(error));
    }
    return done;
}

void Subtitles::beforeLoad() {
    std::lock_guard<std::mutex> lock(mMutex);
    std::vector<std::string> files;
    for (const Pending& pending : mPending) files.push_back(pending.file);
    mMpv.set("sub-files", files);
    // The core's own choice prefers files to the media's tracks.
    const bool turnOn = std::any_of(mPending.begin(), mPending.end(),
                                    [](const Pending& pending) { return pending.turnOn; });
    mMpv.set("sid", turnOn ? "auto" : "no");
}

void Subtitles::reset() {
    std::lock_guard<std::mutex> lock(mMutex);
    mPending.clear();
    mStyle.clear();
    mMpv.set(kDemuxerOptions, "");
    for (const MpvAssignment& assignment : SubtitleStyle::defaults()) {
        assign(mMpv.get(), assignment);
    }
}

}  // namespace orvtarn
