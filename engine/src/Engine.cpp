// SPDX-License-Identifier: Apache-2.0
#include "Engine.h"

#include <utility>

namespace android {

TarnPlayer::Engine::Engine(int decoder, orvtarn::Notifier::Deliver deliver)
    : notifier(std::move(deliver)),
      video([this] { events.onFrame(); }),
      events(mpv, state, video, notifier),
      loader(mpv, state, video, events, protocol),
      seeker(mpv, state, notifier),
      transport(mpv, state) {
    loader.setBeforeLoad([this] { beforeLoad(); });
    if (!create(decoder >= 0)) release();
}

bool TarnPlayer::Engine::create(bool hardwareDecoder) {
    return mpv.create(hardwareDecoder) && protocol.install(mpv.get()) && video.create(mpv.get()) &&
           events.start();
}

void TarnPlayer::Engine::release() {
    if (!gate.close()) return;
    loader.release();
    gate.awaitEmpty();
    video.destroy();
    events.stop();
    mpv.destroy();
    notifier.stop();
}

void TarnPlayer::Engine::beforeLoad() {
    mpv.set("pause", true);
    mpv.set("aid", "auto");
    mpv.set("vid", "auto");
    mpv.set("sid", "no");
}

}  // namespace android
