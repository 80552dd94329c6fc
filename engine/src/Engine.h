// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/TarnPlayer.h>

#include <mutex>
#include <optional>

#include "Gate.h"
#include "base/EngineLog.h"
#include "core/EventLoop.h"
#include "core/FrameTiming.h"
#include "core/HardwareDecoder.h"
#include "core/MpvHandle.h"
#include "core/Notifier.h"
#include "core/OpenMedia.h"
#include "core/PlayerState.h"
#include "core/VideoOutput.h"
#include "playback/AbRepeat.h"
#include "playback/Audio.h"
#include "playback/BytePosition.h"
#include "playback/HardwareDecoding.h"
#include "playback/Loader.h"
#include "playback/MediaMetaData.h"
#include "playback/OutputChange.h"
#include "playback/Parameters.h"
#include "playback/Seeker.h"
#include "playback/Speed.h"
#include "playback/Stepper.h"
#include "playback/Subtitles.h"
#include "playback/Tracks.h"
#include "playback/Transport.h"
#include "playback/VideoFilters.h"
#include "source/StreamProtocol.h"

namespace android {

// The units of one player and the order in which they come and go.
class TarnPlayer::Engine {
public:
    explicit Engine(orvtarn::Notifier::Deliver deliver);
    ~Engine() { release(); }

    // Runs one operation, unless the player is released: then answers closed.
    template <class Result, class Operation>
    Result call(const char* name, Result closed, Operation operation) {
        orvtarn::Gate::Pass pass(gate);
        if (pass) return operation();
        orvtarn::refused(name, "the player is released");
        return closed;
    }

    // The same for operations that answer a status, and for those that answer
    // whether they succeeded.
    template <class Operation>
    status_t status(const char* name, Operation operation) {
        return call(name, status_t{INVALID_OPERATION}, operation);
    }
    template <class Operation>
    bool flag(const char* name, Operation operation) {
        return call(name, false, operation);
    }

    // The same for operations that need mpv, with the first of which it is made, and
    // its threads are. Where that fails the player is released.
    template <class Result, class Operation>
    Result callWithCore(const char* name, Result closed, Operation operation) {
        bool made = true;
        const Result result = call(name, closed, [&] {
            made = requireCore();
            return made ? operation() : closed;
        });
        if (!made) release();  // outside of the gate, which it waits for
        return result;
    }
    template <class Operation>
    status_t statusWithCore(const char* name, Operation operation) {
        return callWithCore(name, status_t{INVALID_OPERATION}, operation);
    }

    // Ends the operations under way and takes the units apart. Once; later
    // calls wait for the first.
    void release();
    // Returns when a release that has begun is done. Not for the listener,
    // whose return that release waits for: it goes on at once.
    void awaitReleased();

private:
    orvtarn::Gate gate;
    orvtarn::Notifier notifier;
    orvtarn::StreamProtocol protocol;

public:
    orvtarn::MpvHandle mpv;
    orvtarn::PlayerState state;
    orvtarn::VideoOutput video;

private:
    orvtarn::FrameTiming frameTiming;
    orvtarn::OpenMedia media;
    orvtarn::EventLoop events;
    orvtarn::HardwareDecoding decoding;
    orvtarn::OutputChange outputChange;

public:
    orvtarn::Loader loader;
    orvtarn::Transport transport;
    orvtarn::Seeker seeker;
    orvtarn::Speed speed;
    orvtarn::Stepper stepper;
    orvtarn::AbRepeat abRepeat;
    orvtarn::Audio audio;
    orvtarn::VideoFilters videoFilters;
    orvtarn::Tracks tracks;
    orvtarn::Subtitles subtitles;
    orvtarn::BytePosition bytes;
    orvtarn::MediaMetaData metaData;
    orvtarn::Parameters parameters;

    // The picture of the current position.
    bool drawThumbnail(const _Media_Thumbnail_Info_T* thumbnail);
    MediaAlbumArt* copyAlbumArt();

private:
    bool requireCore();
    bool createCore();
    void beforeLoad();

    std::mutex coreMutex;
    std::optional<bool> hasCore;  // nothing before it was tried
};

}  // namespace android
