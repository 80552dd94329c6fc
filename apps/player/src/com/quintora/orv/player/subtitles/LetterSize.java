// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.subtitles;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.util.SubtitleAttr.Subtitle_FontInfo;
import java.util.function.Consumer;

/** The sizes of letters that are offered, the smallest first. */
public enum LetterSize {
    TINY("Tiny", builder -> builder.fontSize(24)),
    SMALL("Small", builder -> builder.fontSizeType(Subtitle_FontInfo.SMALL)),
    MEDIUM("Medium", builder -> builder.fontSizeType(Subtitle_FontInfo.MEDIUM)),
    LARGE("Large", builder -> builder.fontSizeType(Subtitle_FontInfo.LARGE)),
    HUGE("Huge", builder -> builder.fontSize(110)),
    GIANT("Giant", builder -> builder.fontSize(160));

    private final String label;
    private final Consumer<SubtitleAttr.Builder> giveTo;

    LetterSize(String label, Consumer<SubtitleAttr.Builder> giveTo) {
        this.label = label;
        this.giveTo = giveTo;
    }

    public String label() {
        return label;
    }

    void giveTo(SubtitleAttr.Builder builder) {
        giveTo.accept(builder);
    }

    /** Some sizes larger, or smaller when negative; the last one there is beyond the ends. */
    public LetterSize plus(int steps) {
        int last = values().length - 1;
        return values()[Math.max(0, Math.min(last, ordinal() + steps))];
    }
}
