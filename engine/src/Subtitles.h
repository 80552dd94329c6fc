// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mutex>
#include <string>
#include <vector>

#include "MpvHandle.h"
#include "PlayerState.h"
#include "SubtitleStyle.h"
#include "Tracks.h"

namespace orvtarn {

// Subtitles from other files, and how subtitles look. Files that are named
// before the media is prepared are opened with it.
class Subtitles {
public:
    Subtitles(MpvHandle& mpv, PlayerState& state, Tracks& tracks)
        : mMpv(mpv), mState(state), mTracks(tracks) {}

    // Adds a file's subtitles, turned on or left for later selection.
    bool add(const char* operation, const char* url, bool turnOn);
    // A VobSub pair; the two may lie in different folders.
    bool addPair(const char* sub, const char* idx);

    bool stage(int type, const void* record);
    bool flush();

    // For the load that is about to begin.
    void beforeLoad();
    // Forgets the files and the look.
    void reset();

private:
    struct Pending {
        std::string file;
        bool turnOn;
    };

    bool addNamed(const char* operation, const std::string& name, bool turnOn);
    bool addNow(const char* operation, const std::string& name, bool turnOn);
    void setPictureFile(const std::string& sub);

    MpvHandle& mMpv;
    PlayerState& mState;
    Tracks& mTracks;
    std::mutex mMutex;
    std::vector<Pending> mPending;
    SubtitleStyle mStyle;
};

}  // namespace orvtarn
