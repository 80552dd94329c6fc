// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>
#include <orvtarn/TrackRecords.h>
#include <stdint.h>

#include <vector>

#include "inspect/MediaFile.h"

namespace orvtarn {

// A track's record and its two addresses.
template <typename Record>
struct Track {
    Record record;
    int64_t id = 0;        // for the properties vid, aid and sid
    int streamIndex = -1;  // in the MediaFile; -1 for tracks from another file
    bool selected = false;
    int rotation = 0;  // clockwise, degrees, by which a picture is turned to be seen
};

struct TrackTables {
    std::vector<Track<VideoCodecInfo>> video;  // embedded pictures are no tracks
    std::vector<Track<AudioTrackInfo>> audio;
    std::vector<Track<SubtitleTrackInfo>> subtitles;
};

// From mpv's property "track-list" as a node. A node of another shape, entries
// without a type or an id and members of unexpected types are passed over.
TrackTables trackTables(const mpv_node& trackList);

// Fills in what only the container knows. file is the media that the tables are
// of; tracks from other files are left alone.
void addContainerDetails(const MediaFile& file, TrackTables& tables);
// The descriptive texts of one audio track, for callers that ask for them.
void addAudioTexts(const MediaFile& file, Track<AudioTrackInfo>& track);

}  // namespace orvtarn
