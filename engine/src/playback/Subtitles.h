// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/Errors.h>

#include <mutex>
#include <string>
#include <vector>

#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "playback/Tracks.h"
#include "records/SubtitleStyle.h"

namespace orvtarn {

// Subtitles from other files, and how subtitles look. Files that are named
// before the media is prepared are opened with it, and all again when it is
// prepared again.
class Subtitles {
public:
    Subtitles(MpvHandle& mpv, PlayerState& state, Tracks& tracks)
        : mMpv(mpv), mState(state), mTracks(tracks) {}

    // Adds a file's subtitles, the first of them turned on or all left for later
    // selection. A name is refused as resolveName says it; INVALID_OPERATION
    // without media, BAD_VALUE for what are no subtitles.
    android::status_t add(const char* operation, const char* url, bool turnOn);
    // A VobSub pair; the two may lie in different folders.
    android::status_t addPair(const char* sub, const char* idx);

    // Of an mpv that nothing was set on yet.
    void readUsualLook();
    bool stage(int type, const void* record);
    bool flush();

    // The files, for the media that mpv is opening: before it chooses tracks.
    void addToMedia();
    // Forgets the files and the look.
    void reset();

private:
    struct File {
        std::string name;
        std::string pictures;  // of a VobSub index; empty for those beside it
        bool turnOn;
    };

    android::status_t addFile(const char* operation, const File& file);
    android::status_t addNow(const char* operation, const File& file);
    int open(const File& file);
    void remember(const File& file);

    MpvHandle& mMpv;
    PlayerState& mState;
    Tracks& mTracks;
    std::mutex mOpenMutex;  // one file at a time
    std::mutex mMutex;      // never held while a file is opened
    std::vector<File> mFiles;
    SubtitleStyle mStyle;
};

}  // namespace orvtarn
