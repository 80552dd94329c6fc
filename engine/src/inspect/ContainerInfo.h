// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/MetaDataInfo.h>
#include <orvtarn/TrackRecords.h>

#include "inspect/MediaFile.h"

// What a media file says about itself. Nothing here reads from the file.
namespace orvtarn {

// Every member of the record, from the container's tags and, where it has none,
// those of its streams (Ogg keeps them there).
MetaDataInfo metaDataInfo(const MediaFile& file);

int chapterCount(const MediaFile& file);
// Fills the record as ORV_CHAPTER_INDEX_BASE describes, counting chapters from
// 0. False past the last one; the record is then left alone.
bool chapterRecord(const MediaFile& file, int chapter, SubtitleTrackInfo& info);

}  // namespace orvtarn
