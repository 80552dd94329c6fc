// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/RecordText.h>
#include <stdint.h>

struct MetaDataInfo {
    MetaDataInfo() {
        clearFirstHalf(mTitle);
        clearFirstHalf(mArtist);
        clearFirstHalf(mAlbum);
        clearFirstHalf(mGenre);
        clearFirstHalf(mComposer);
        clearFirstHalf(mContainer);
        clearFirstHalf(mComment);
    }

    int32_t mDuration = 0;     // milliseconds, 0 when unknown
    int32_t mBitRate = 0;      // bits per second of the whole file, 0 when unknown
    int32_t mYear = 0;         // 0 when unknown
    int32_t mDiscNumber = 0;   // 0 when unknown
    int32_t mTrackNumber = 0;  // 0 when unknown
    int32_t mTrackTotal = 0;   // 0 when unknown
    OrvWideText mTitle;
    OrvWideText mArtist;
    OrvWideText mAlbum;
    OrvWideText mGenre;
    int32_t mChapterCount = 0;
    OrvWideText mComposer;
    OrvWideText mContainer;  // the file format's name
    OrvWideText mComment;
};
