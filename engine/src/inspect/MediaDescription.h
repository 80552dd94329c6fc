// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/MediaDescription.h>
#include <orvtarn/TrackRecords.h>

#include <string>

#include "inspect/MediaFile.h"
#include "records/TrackRecords.h"

namespace orvtarn {

// The text of orvtarn/MediaDescription.h. The tables say which streams are
// tracks. Nothing is read from the file.
std::string describeMedia(const MediaFile& file, const TrackTables& tables);

// Fills the record with a piece of the text, counted from 0. False past the last
// one; the record is then left alone.
bool descriptionRecord(const std::string& text, int piece, SubtitleTrackInfo& info);

}  // namespace orvtarn
