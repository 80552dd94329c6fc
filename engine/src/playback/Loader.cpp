// SPDX-License-Identifier: Apache-2.0
#include "playback/Loader.h"

#include <fcntl.h>
#include <orvtarn/PlayerTypes.h>
#include <string.h>
#include <strings.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <utility>
#include <vector>

#include "base/EngineLog.h"
#include "core/MpvError.h"
#include "source/StreamMediaSource.h"
#include "source/UrlScheme.h"

namespace orvtarn {
namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

constexpr seconds kPrepareLimit{30};
constexpr seconds kUnloadLimit{10};
// How often a read that blocks is asked again to end.
constexpr milliseconds kCancelInterval{20};

// What raw samples are when nobody says.
const IORV_PB_CTRL_SET_MEDIA_INFO_T kUsualSamples = [] {
    IORV_PB_CTRL_SET_MEDIA_INFO_T info = {};
    info.eMediaType = E_ORV_MEDIA_TYPE_AUDIO_ES;
    info.uFormatInfo.tAudioEsInfo.tAudInfo.eAudEnc = E_ORV_AUD_ENC_PCM;
    info.uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info = {
        E_ORV_PCM_TYPE_SIGNED,         E_Orv_Aud_Ch_Num{2},
        E_Orv_Aud_Sample_Rate{44100},  4,
        E_Orv_Aud_Bits_Per_Sample{16}, 0};
    return info;
}();

// A line break would smuggle in headers of its own.
void dropBrokenHeaders(RequestHeaders& headers) {
    const auto isBroken = [](const RequestHeaders::value_type& header) {
        const bool broken =
            (header.first + header.second).find_first_of("\r\n") != std::string::npos;
        if (broken) ALOGW("setDataSource: header %s left out", header.first.c_str());
        return broken;
    };
    headers.erase(std::remove_if(headers.begin(), headers.end(), isBroken), headers.end());
}

}  // namespace

android::status_t Loader::setUrl(const char* url, RequestHeaders headers) {
    std::string name;
    const android::status_t status = resolveName(url, name);
    if (status != android::NO_ERROR) {
        return failed(status, "setDataSource", url != nullptr ? url : "no name");
    }
    dropBrokenHeaders(headers);
    return setSource("setDataSource", std::make_shared<UrlMediaSource>(name, std::move(headers)));
}

android::status_t Loader::setFd(int fd, int64_t offset, int64_t length) {
    struct stat status;
    if (offset < 0 || length < 0 || fstat(fd, &status) != 0) {
        return failed(android::BAD_VALUE, "setDataSource", "no such part of an open file");
    }
    if (!S_ISREG(status.st_mode) && !S_ISBLK(status.st_mode)) {
        return failed(android::BAD_VALUE, "setDataSource", "the descriptor is not of a file");
    }
    const int copy = fcntl(fd, F_DUPFD_CLOEXEC, 0);
    if (copy < 0) return failed(-errno, "setDataSource", strerror(errno));
    return setSource("setDataSource", std::make_shared<FdMediaSource>(copy, offset, length));
}

android::status_t Loader::setStream(std::unique_ptr<IOrvStreamSource> stream) {
    if (stream == nullptr) return failed(android::BAD_VALUE, "setDataSource", "no stream");
    // Asks the source nothing before the phase is known to be right.
    const Phase phase = mState.phase();
    if (phase != Phase::Idle) return PlayerState::wrongPhase("setDataSource", phase);
    return setSource("setDataSource", std::make_shared<StreamMediaSource>(std::move(stream)));
}

android::status_t Loader::setSource(const char* operation,
                                    const std::shared_ptr<MediaSource>& source) {
    std::lock_guard<std::mutex> load(mLoadMutex);
    const Phase phase = mState.phase();
    if (phase != Phase::Idle) return PlayerState::wrongPhase(operation, phase);
    {
        std::lock_guard<std::mutex> lock(mSourceMutex);
        mSource = source;
        mSecondReading = std::make_shared<SecondReading>(source);
        describeSource();
    }
    mProtocol.setSource(source);
    mMedia.setSource(source);
    mState.update([](PlayerState::Values& v) { v.phase = Phase::Initialized; });
    return android::NO_ERROR;
}

std::shared_ptr<MediaSource> Loader::source() const {
    std::lock_guard<std::mutex> lock(mSourceMutex);
    return mSource;
}

std::shared_ptr<SecondReading> Loader::secondReading() const {
    const auto startUs = mState.read([](const PlayerState::Values& v) { return v.startUs; });
    std::lock_guard<std::mutex> lock(mSourceMutex);
    if (mSecondReading == nullptr) return std::make_shared<SecondReading>(nullptr);
    if (startUs) mSecondReading->setStartUs(*startUs);
    return mSecondReading;
}

android::status_t Loader::setRawFormat(const char* operation,
                                       const IORV_PB_CTRL_SET_MEDIA_INFO_T& info) {
    PcmFormat format;
    std::string reason;
    if (!pcmFormat(info, format, reason)) {
        return failed(android::BAD_VALUE, operation, reason.c_str());
    }
    std::lock_guard<std::mutex> load(mLoadMutex);
    const Phase phase = mState.phase();
    if (phase != Phase::Idle && phase != Phase::Initialized && phase != Phase::Stopped) {
        return PlayerState::wrongPhase(operation, phase);
    }
    std::lock_guard<std::mutex> lock(mSourceMutex);
    mRawFormat = format;
    describeSource();
    return android::NO_ERROR;
}

// What is known of raw samples beforehand.
void Loader::describeSource() {
    if (!mRawFormat || mSource == nullptr) return;
    mSource->setToldDuration(mRawFormat->durationMs);
    mSecondReading->setRaw();
}

android::status_t Loader::setRaw() {
    {
        std::lock_guard<std::mutex> lock(mSourceMutex);
        if (mRawFormat) return android::NO_ERROR;
    }
    return setRawFormat("setPcmFlag", kUsualSamples);
}

int Loader::rawBytesPerSecond() const {
    std::lock_guard<std::mutex> lock(mSourceMutex);
    return mRawFormat ? mRawFormat->bytesPerSecond : 0;
}

android::status_t Loader::prepare() {
    uint64_t session = 0;
    const android::status_t status = beginPrepare("prepare", session);
    return status == android::NO_ERROR ? awaitPrepared(session) : status;
}

android::status_t Loader::prepareAsync() {
    uint64_t session = 0;
    return beginPrepare("prepareAsync", session);
}

android::status_t Loader::beginPrepare(const char* operation, uint64_t& session) {
    std::lock_guard<std::mutex> load(mLoadMutex);
    const Phase before = mState.update([&](PlayerState::Values& v) {
        const Phase phase = v.phase;
        if (!v.isOneOf({Phase::Initialized, Phase::Stopped})) return phase;
        v.phase = Phase::Preparing;
        v.forgetMedia();
        v.fileOpen = true;
        session = ++v.session;
        return phase;
    });
    if (before != Phase::Initialized && before != Phase::Stopped) {
        return PlayerState::wrongPhase(operation, before);
    }
    return this->load();
}

android::status_t Loader::load() {
    const std::shared_ptr<MediaSource> media = source();
    media->setReadFailed(false);
    setHeaders();
    setReach(*media);
    secondReading()->tryAgain();
    if (mBeforeLoad) mBeforeLoad();
    const int error = loadMedia(mMpv.get(), media->name(), mediaOptions());
    if (error >= 0) return android::NO_ERROR;
    const android::status_t status = statusOfMpvError(error);
    mState.update([&](PlayerState::Values& v) {
        v.fail(status);
        v.fileOpen = false;
    });
    return failed(status, "prepare", mpv_error_string(error));
}

// The channels are no option of one media: mpv never frees those.
MpvOptions Loader::mediaOptions() {
    std::lock_guard<std::mutex> lock(mSourceMutex);
    if (!mRawFormat) return {};
    mMpv.set("demuxer-rawaudio-channels", std::to_string(mRawFormat->channels));
    return mRawFormat->options;
}

// mpv keeps headers for all its requests, so those of an earlier source
// are cleared, too.
void Loader::setHeaders() {
    std::vector<std::string> fields;
    std::string userAgent = "orvtarn";
    for (const auto& [name, value] : source()->headers()) {
        if (strcasecmp(name.c_str(), "User-Agent") == 0) {
            userAgent = value;
        } else {
            fields.push_back(name + ": " + value);
        }
    }
    mMpv.set("user-agent", userAgent);
    mMpv.set("http-header-fields", fields);
}

// What the media may open beyond themselves.
void Loader::setReach(const MediaSource& media) {
    const bool isFile = media.isLocal() && !media.isOfBytes();
    mMpv.set("access-references", media.mayReference());
    mMpv.set("demuxer-lavf-o",
             "protocol_whitelist=[" + std::string(protocolWhitelist(isFile)) + "]");
}

android::status_t Loader::awaitPrepared(uint64_t session) {
    const auto settled = [session](const PlayerState::Values& v) {
        return v.session != session || v.phase != Phase::Preparing;
    };
    if (!mState.wait(kPrepareLimit, settled)) return giveUp(session);
    const PlayerState::Values now = mState.read([](const PlayerState::Values& v) { return v; });
    if (now.session != session) {
        return failed(android::INVALID_OPERATION, "prepare", "ended by another operation");
    }
    return now.phase == Phase::Error ? failed(now.error, "prepare", "the media did not open")
                                     : android::NO_ERROR;
}

android::status_t Loader::giveUp(uint64_t session) {
    mState.update([&](PlayerState::Values& v) {
        if (v.session == session) v.fail(android::TIMED_OUT);
    });
    unloadIn(session);
    return failed(android::TIMED_OUT, "prepare", "the media took too long");
}

android::status_t Loader::stop() {
    Phase before = Phase::Idle;
    const uint64_t session = mState.update([&](PlayerState::Values& v) {
        before = v.phase;
        const bool allowed = v.isOpen() || v.isOneOf({Phase::Preparing, Phase::Stopped});
        if (!allowed) return uint64_t{0};
        v.phase = Phase::Stopped;
        return ++v.session;
    });
    if (session == 0) return PlayerState::wrongPhase("stop", before);
    unloadIn(session);
    return android::NO_ERROR;
}

void Loader::reset() {
    overtake(Phase::Idle);
    std::lock_guard<std::mutex> load(mLoadMutex);
    overtake(Phase::Idle);
    unload();
    forgetSource();
    mState.update([](PlayerState::Values& v) {
        v.phase = Phase::Idle;
        v.error = android::NO_ERROR;
        v.forgetMedia();
    });
}

void Loader::release() {
    overtake(Phase::Released);
    std::lock_guard<std::mutex> load(mLoadMutex);
    unload();
    forgetSource();
}

// Ends the waits of operations under way.
void Loader::overtake(Phase phase) {
    mState.update([phase](PlayerState::Values& v) {
        v.session++;
        v.phase = phase;
    });
}

// Closes the media of that session. Another thread may have closed them, or
// opened others, meanwhile.
void Loader::unloadIn(uint64_t session) {
    std::lock_guard<std::mutex> load(mLoadMutex);
    if (mState.read([](const PlayerState::Values& v) { return v.session; }) == session) unload();
}

void Loader::unload() {
    closeFile();
    if (mOnUnload) mOnUnload();
}

void Loader::closeFile() {
    const std::shared_ptr<MediaSource> media = source();
    // A stop before mpv has taken the load up would go unanswered.
    const auto settled = [](const PlayerState::Values& v) { return !v.fileOpen; };
    mState.wait(seconds(1),
                [&](const PlayerState::Values& v) { return settled(v) || v.fileStarted; });
    if (mState.read(settled)) return;
    mMpv.command({"stop"});
    const auto deadline = std::chrono::steady_clock::now() + kUnloadLimit;
    while (!mState.wait(kCancelInterval, settled)) {
        if (media != nullptr) media->cancelReads();
        if (std::chrono::steady_clock::now() < deadline) continue;
        ALOGE("stop: the media does not close");
        break;
    }
    mMpv.set("pause", true);
    mVideo.forgetPicture();
}

void Loader::forgetSource() {
    std::shared_ptr<MediaSource> media;
    std::shared_ptr<SecondReading> details;
    {
        std::lock_guard<std::mutex> lock(mSourceMutex);
        media.swap(mSource);
        details.swap(mSecondReading);
        mRawFormat.reset();
    }
    if (mOnForget) mOnForget();
    mProtocol.setSource(nullptr);
    mMedia.setSource(nullptr);
    if (details != nullptr) details->close();
    if (media != nullptr) media->close();
}

}  // namespace orvtarn
