// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/SubtitleRecords.h>

#include <optional>
#include <vector>

#include "MpvValue.h"

namespace orvtarn {

// The subtitle attributes of one player: records are staged one by one, a later
// one of the same type in place of the earlier, and given out together. Not
// locked.
class SubtitleStyle {
public:
    // Stages a copy of the record that the type stands for. False for a null
    // record, an unknown attribute type or a value out of its range (see
    // orvtarn/SubtitleRecords.h); what was staged then stays.
    bool stage(int type, const void* record);

    // What to set for the staged records, in that order; empty when there are
    // none. The stage is empty afterwards.
    std::vector<MpvAssignment> flush();

    // Forgets the staged records.
    void clear();

    // What brings a player's subtitles back to their usual look.
    static std::vector<MpvAssignment> defaults();

private:
    std::optional<Subtitle_TimeOffset> mTimeOffset;
    std::optional<Subtitle_FontInfo> mFontInfo;
    std::optional<Subtitle_Color> mBackColor;
    std::optional<Subtitle_Color> mTextColor;
    std::optional<Subtitle_Color> mEdgeColor;
    std::optional<Subtitle_TimeOffset> mDisplayOffset;
};

}  // namespace orvtarn
