// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/TrackRecords.h>
#include <stdint.h>

#include <memory>
#include <mutex>
#include <optional>

#include "core/MpvHandle.h"
#include "core/PlayerState.h"
#include "playback/Loader.h"
#include "playback/Seeker.h"
#include "playback/VideoFilters.h"
#include "records/TrackRecords.h"

namespace orvtarn {

// The tables of tracks and the choice among them. Indices are positions in the
// table of a kind; those that are not in it are refused before mpv hears
// of them, which would take any number.
class Tracks {
public:
    Tracks(MpvHandle& mpv, PlayerState& state, Loader& loader, Seeker& seeker,
           VideoFilters& filters)
        : mMpv(mpv), mState(state), mLoader(loader), mSeeker(seeker), mFilters(filters) {}

    // All tracks as they are now, without what only the container knows.
    bool tables(const char* operation, TrackTables& tables);
    bool videoCount(int& count);
    bool audioCount(int& count);
    bool subtitleCount(int& count);
    bool videoInfo(int index, VideoCodecInfo& info);
    bool currentVideoInfo(VideoCodecInfo& info);
    // The place of the video track that is shown in the MediaFile; -1 for none.
    int shownVideoStream();
    bool audioInfo(bool withTexts, int index, AudioTrackInfo& info);
    // Chapters and the description, too; see ORV_CHAPTER_INDEX_BASE and
    // ORV_DESCRIPTION_INDEX_BASE.
    bool subtitleInfo(int index, SubtitleTrackInfo& info);

    // -1 for none. False before the media is prepared.
    bool currentAudio(int* index);
    bool currentSubtitle(int* index);
    bool selectAudio(int index);
    bool selectSubtitle(int index);
    bool subtitlesOff();
    // Numbers over all kinds: video, audio, subtitles.
    bool select(int number);
    bool deselect(int number);

    // A subtitle track turned on or another one chosen: brings the line of now
    // on screen.
    bool showSubtitle(const char* operation, int64_t id);

private:
    // What changes with the tables, though it is read in a moment.
    struct Stand {
        uint64_t session;
        std::optional<int64_t> count;
        std::optional<int64_t> video;
        std::optional<int64_t> audio;
        std::optional<int64_t> subtitle;

        bool operator==(const Stand& other) const;
    };

    Stand stand() const;
    // The tables with what the container knows, kept: each of many tracks is asked for
    // on its own. Null where there are none.
    std::shared_ptr<const TrackTables> details(const char* operation);
    std::shared_ptr<const TrackTables> keptDetails(const Stand& now);
    template <class Table>
    bool countOf(const char* operation, Table TrackTables::* table, int& count);
    template <class Table>
    bool currentOf(const char* operation, Table TrackTables::* table, int* index);
    bool chooseVideo(int64_t id);
    bool choose(const char* operation, const char* property, int64_t id);
    bool chapterInfo(int chapter, SubtitleTrackInfo& info);
    bool descriptionPiece(int piece, SubtitleTrackInfo& info);

    MpvHandle& mMpv;
    PlayerState& mState;
    Loader& mLoader;
    Seeker& mSeeker;
    VideoFilters& mFilters;
    std::mutex mKeptMutex;
    Stand mKeptStand{};
    std::shared_ptr<const TrackTables> mKept;
};

}  // namespace orvtarn
