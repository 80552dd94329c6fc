// SPDX-License-Identifier: Apache-2.0
#include "playback/Subtitles.h"

#include "base/EngineLog.h"
#include "source/MediaSource.h"

namespace orvtarn {
namespace {

using android::status_t;

}  // namespace

status_t Subtitles::add(const char* operation, const char* url, bool turnOn) {
    std::string name;
    const status_t status = resolveName(url, name);
    if (status != android::NO_ERROR) return failed(status, operation, "no such file");
    return addFile(operation, {name, "", turnOn});
}

status_t Subtitles::addPair(const char* sub, const char* idx) {
    constexpr char kName[] = "setSubtitleDataSourceEx";
    std::string pictures;
    std::string index;
    status_t status = resolveName(sub, pictures);
    if (status == android::NO_ERROR) status = resolveName(idx, index);
    if (status != android::NO_ERROR) return failed(status, kName, "no such file");
    return addFile(kName, {index, pictures, true});
}

status_t Subtitles::addFile(const char* operation, const SubtitleFile& file) {
    const bool open = mState.read([](const PlayerState::Values& v) { return v.isOpen(); });
    if (open) return addNow(operation, file);
    const Phase phase = mState.phase();
    if (phase != Phase::Initialized && phase != Phase::Stopped) {
        return PlayerState::wrongPhase(operation, phase);
    }
    remember(file);
    return android::NO_ERROR;
}

status_t Subtitles::addNow(const char* operation, const SubtitleFile& file) {
    const int error = mLoader.open(file);
    if (error < 0) return failed(android::BAD_VALUE, operation, mpv_error_string(error));
    remember(file);
    if (!file.turnOn) return android::NO_ERROR;
    const bool shown = mTracks.showSubtitle(operation, mMpv.getInt("sid").value_or(0));
    return shown ? android::NO_ERROR : android::INVALID_OPERATION;
}

void Subtitles::remember(const SubtitleFile& file) {
    std::lock_guard<std::mutex> lock(mMutex);
    mFiles.push_back(file);
}

void Subtitles::addToMedia() {
    std::vector<SubtitleFile> files;
    {
        std::lock_guard<std::mutex> lock(mMutex);
        files = mFiles;
    }
    mLoader.openAll(files);
}

void Subtitles::readUsualLook() {
    std::lock_guard<std::mutex> lock(mMutex);
    mStyle.readUsual(mMpv.get());
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

void Subtitles::reset() {
    mLoader.cancel();
    std::lock_guard<std::mutex> lock(mMutex);
    mFiles.clear();
    mStyle.clear();
    for (const MpvAssignment& assignment : mStyle.usual()) {
        assign(mMpv.get(), assignment);
    }
}

}  // namespace orvtarn
