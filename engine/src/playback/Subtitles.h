// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/Errors.h>

#include <mutex>
#include <string>
#include <vector>

#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "playback/SubtitleLoader.h"
#include "playback/Tracks.h"
#include "records/SubtitleStyle.h"

namespace orvtarn {

// Subtitles from other files, and how subtitles look. Files that are named
// before the media is prepared are opened with it, and all again when it is
// prepared again.
class Subtitles {
public:
    Subtitles(MpvHandle& mpv, PlayerState& state, Tracks& tracks)
        : mMpv(mpv), mState(state), mTracks(tracks), mLoader(mpv) {}

    // Adds a file's subtitles, the first of them turned on or all left for later
    // selection. A name is refused as resolveName says it; INVALID_OPERATION
    // without media, BAD_VALUE for what are no subtitles. Blocks until they are
    // read, for those from a server for ten seconds at most.
    android::status_t add(const char* operation, const char* url, bool turnOn);
    // A VobSub pair; the two may lie in different folders.
    android::status_t addPair(const char* sub, const char* idx);

    // Of an mpv that nothing was set on yet.
    void readUsualLook();
    bool stage(int type, const void* record);
    bool flush();

    // The files, for the media that mpv is opening: before it chooses tracks.
    // Does not wait for those from servers.
    void addToMedia();
    // Forgets the files and the look.
    void reset();

private:
    android::status_t addFile(const char* operation, const SubtitleFile& file);
    android::status_t addNow(const char* operation, const SubtitleFile& file);
    void remember(const SubtitleFile& file);

    MpvHandle& mMpv;
    PlayerState& mState;
    Tracks& mTracks;
    SubtitleLoader mLoader;
    std::mutex mMutex;  // never held while a file is opened
    std::vector<SubtitleFile> mFiles;
    SubtitleStyle mStyle;
};

}  // namespace orvtarn
