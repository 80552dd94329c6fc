// SPDX-License-Identifier: Apache-2.0
#include "Engine.h"

#include <optional>
#include <utility>

#include "inspect/AlbumArt.h"
#include "inspect/KeyFrames.h"
#include "inspect/PictureCanvas.h"

namespace android {

TarnPlayer::Engine::Engine(orvtarn::Notifier::Deliver deliver)
    : notifier(std::move(deliver)),
      video([this] { events.onFrame(); },
            [this](uint64_t frame, int64_t due) { return frameTiming.begin(frame, due); },
            [this](bool onWindow, const std::function<void()>& change) {
                outputChange.run(onWindow, change);
            }),
      frameTiming(mpv, state, video),
      media(mpv, state, notifier),
      events(mpv, state, video, notifier, media, frameTiming),
      decoding(mpv, orvtarn::hardwareDecoder()),
      outputChange(mpv, events, decoding),
      loader(mpv, state, video, media, protocol),
      transport(mpv, state, events),
      seeker(mpv, state, notifier, events, transport),
      speed(mpv, state, seeker, transport, events, frameTiming),
      stepper(mpv, state, seeker, transport, events),
      abRepeat(mpv, state),
      audio(mpv, video),
      videoFilters(mpv, decoding),
      tracks(mpv, state, loader, seeker, videoFilters),
      subtitles(mpv, state, tracks),
      bytes(mpv, state, loader, seeker),
      metaData(mpv, state, loader),
      parameters(mpv, state, video, tracks, subtitles) {
    media.setEndHandler([this] { return !speed.onEndReached() && transport.complete(); });
    events.setPictureHandler([this] { return videoFilters.adapt(); });
    events.setOpenedHandler([this] {
        videoFilters.onOpened();
        subtitles.addToMedia();
    });
    stepper.setFrameFrom([this](double seconds, int amount) {
        std::optional<orvtarn::FrameAt> found;
        if (loader.source()->isLocal()) {
            loader.secondReading()->withFile([&](orvtarn::MediaFile& file) {
                found = orvtarn::frameFrom(file, tracks.shownVideoStream(), seconds, amount);
            });
        }
        return found;
    });
    seeker.setKeyFrameBefore([this](double seconds) {
        std::optional<double> found;
        loader.secondReading()->withFile(
            [&](orvtarn::MediaFile& file) { found = orvtarn::keyFrameBefore(file, seconds); });
        return found;
    });
    loader.setBeforeLoad([this] { beforeLoad(); });
    loader.setOnUnload([this] { speed.reset(); });
    loader.setOnForget([this] { subtitles.reset(); });
}

bool TarnPlayer::Engine::requireCore() {
    std::lock_guard<std::mutex> lock(coreMutex);
    if (!hasCore) hasCore = createCore();
    return *hasCore;
}

bool TarnPlayer::Engine::createCore() {
    if (!mpv.create()) return false;
    audio.restore();
    subtitles.readUsualLook();
    notifier.start();
    return protocol.install(mpv.get()) && video.create(mpv.get()) && events.start();
}

void TarnPlayer::Engine::release() {
    if (!gate.close()) return awaitReleased();
    loader.release();
    gate.awaitEmpty();
    speed.shutDown();
    video.destroy();
    events.stop();
    mpv.destroy();
    notifier.stop();
    gate.setDone();
}

void TarnPlayer::Engine::awaitReleased() {
    if (!notifier.isDelivering()) gate.awaitDone();
}

void TarnPlayer::Engine::beforeLoad() {
    mpv.set("pause", true);
    mpv.set("aid", "auto");
    mpv.set("vid", "auto");
    mpv.set("sid", "no");
    speed.reset();
    abRepeat.reset();
}

bool TarnPlayer::Engine::drawThumbnail(const _Media_Thumbnail_Info_T* thumbnail) {
    constexpr char kName[] = "getThumbnailInfo";
    if (thumbnail == nullptr) return orvtarn::refused(kName, "null argument");
    if (orvtarn::checkThumbnail(*thumbnail) != NO_ERROR) {
        return orvtarn::refused(kName, "no such mode or size, or too small a buffer");
    }
    int position = 0;
    if (state.requireOpen(kName) != NO_ERROR) return false;
    transport.getCurrentPosition(&position);
    const status_t status =
        loader.secondReading()->draw(position, tracks.shownVideoStream(), *thumbnail);
    return status == NO_ERROR || orvtarn::failed(status, kName, "no picture") == NO_ERROR;
}

MediaAlbumArt* TarnPlayer::Engine::copyAlbumArt() {
    MediaAlbumArt* art = nullptr;
    loader.secondReading()->withFile(
        [&](orvtarn::MediaFile& file) { art = orvtarn::extractAlbumArt(file); });
    if (art == nullptr) orvtarn::refused("extractAlbumArt", "no picture");
    return art;
}

}  // namespace android
