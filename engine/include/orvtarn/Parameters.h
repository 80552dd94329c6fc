// SPDX-License-Identifier: Apache-2.0
#pragma once

// The keys of setParameter and getParameter, and the methods of invoke. Values
// are written and read by the Parcel operations that the comments name, from
// the parcel's position on. Unknown keys and methods are BAD_VALUE, setting
// what can only be read is INVALID_OPERATION, a value that is missing is
// NOT_ENOUGH_DATA and one out of range is BAD_VALUE.

enum E_Orv_Parameter : int {
    // Read only.
    ORV_PARAMETER_ENGINE_NAME = 1,       // String16: the playback library and its version
    ORV_PARAMETER_FRAMES_DELIVERED = 2,  // Int64: frames handed to the surface so far
    ORV_PARAMETER_FRAMES_MISSED = 3,     // Int64: frames that found no free buffer
    ORV_PARAMETER_FRAMES_DROPPED = 4,    // Int64: frames of this media that came too late

    // Any time, for all media to come.
    ORV_PARAMETER_NETWORK_TIMEOUT = 16,    // Int32: milliseconds, 1000 to 600000
    ORV_PARAMETER_KEEP_ASPECT = 17,        // Int32: 1 (usual) or 0 to fill the surface
    ORV_PARAMETER_SUBTITLES_VISIBLE = 18,  // Int32: 1 (usual) or 0, whatever is selected
    ORV_PARAMETER_AUDIO_DELAY = 19,        // Int32: milliseconds, -10000 to 10000
    // String16: the name of the encoding of subtitle files that are not in
    // UTF-8, as iconv knows it, or "auto" (usual).
    ORV_PARAMETER_SUBTITLE_ENCODING = 20,
};

// The request of invoke begins with the method as Int32, its arguments follow.
// INVALID_OPERATION without media to operate on, BAD_VALUE for no such track or
// what are no subtitles.
enum E_Orv_Invoke : int {
    // Reply: Int32 number of tracks, then for each, in the numbering of
    // selectTrack, three Int32: kind (E_Orv_Track_Kind), codec and flags as in
    // orvtarn/TrackRecords.h.
    ORV_INVOKE_GET_TRACKS = 1,
    // Argument String16: as addTimedTextSource, a bad name as setDataSource says it.
    ORV_INVOKE_ADD_SUBTITLES = 2,
    ORV_INVOKE_SELECT_TRACK = 4,    // argument Int32: as selectTrack
    ORV_INVOKE_DESELECT_TRACK = 5,  // argument Int32: as deselectTrack
};

enum E_Orv_Track_Kind : int {
    ORV_TRACK_KIND_VIDEO = 1,
    ORV_TRACK_KIND_AUDIO = 2,
    ORV_TRACK_KIND_SUBTITLE = 3,
};
