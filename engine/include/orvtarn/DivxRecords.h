// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/RecordText.h>
#include <stdint.h>

struct DivxTitleInfo {
    int32_t mTitle = 0;
    int32_t mPlayListCount = 0;
    int32_t mChapterCount = 0;
};

// The same shape as a title: title, playlist, chapter being played.
typedef DivxTitleInfo DivxPositionInfo;

struct DivxChapInfo {
    int32_t mTitle = 0;
    int32_t mPlayList = 0;
    int32_t mChapter = 0;
    int32_t mStart = 0;
};

// The same shape as a chapter.
typedef DivxChapInfo DivxPlayListInfo;

struct DivxDisplayInfo {
    DivxDisplayInfo() {
        clearFirstHalf(mText1);
        clearFirstHalf(mText2);
    }

    int32_t mValues[6] = {};
    OrvWideText mText1;
    int32_t mValue7 = 0;
    OrvWideText mText2;
};

// Where a viewer left the media.
struct DivxLastMemoryFilePosition {
    uint32_t ui8_clip_id = 0;
    uint32_t ui4_title_idx = 0;
    uint32_t ui4_playlist_idx = 0;
    uint32_t ui4_chap_idx = 0;
    uint32_t ui2_aud_idx = 0;
    uint32_t ui2_sub_idx = 0;
    uint32_t ui8_aud_pts_info = 0;
    uint32_t ui8_aud_frame_position = 0;
    uint32_t ui8_i_pts_info = 0;
    uint32_t ui8_pts_info = 0;
    uint32_t ui8_i_frame_position = 0;
    uint32_t ui8_frame_position = 0;
    uint32_t i4_temporal_reference = 0;
    uint32_t ui2_decoding_order = 0;
    uint32_t ui8_stc = 0;
    uint32_t ui8_frame_position_disp = 0;
    uint32_t ui4_timestap = 0;
};
