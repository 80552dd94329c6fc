// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/SubtitleRecords.h>

#include <optional>
#include <vector>

#include "core/MpvValue.h"

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

    // Takes a fresh mpv's look for the usual one: releases differ.
    void readUsual(mpv_handle* mpv);
    // What brings subtitles back to their usual look.
    const std::vector<MpvAssignment>& usual() const { return mUsual; }

private:
    void addGround(const Subtitle_Color& color, std::vector<MpvAssignment>& style) const;
    void addHorizontal(int x, std::vector<MpvAssignment>& style) const;
    int64_t fontSize(const Subtitle_FontInfo& font) const;

    std::vector<MpvAssignment> mUsual;
    double mMediumFont = 55;
    int64_t mUsualMargin = 25;
    bool mHasBorderStyle = false;
    std::optional<Subtitle_TimeOffset> mTimeOffset;
    std::optional<Subtitle_FontInfo> mFontInfo;
    std::optional<Subtitle_Color> mBackColor;
    std::optional<Subtitle_Color> mTextColor;
    std::optional<Subtitle_Color> mEdgeColor;
    std::optional<Subtitle_TimeOffset> mDisplayOffset;
};

}  // namespace orvtarn
