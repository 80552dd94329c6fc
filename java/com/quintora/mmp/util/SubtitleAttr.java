// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.util;

/**
 * How subtitles look and where they stand, as the native half reads it: {@link #mMask} says which
 * of the groups count. {@link com.quintora.SubtitleAttr#builder()} makes complete ones.
 */
public class SubtitleAttr {
    /** {@link #mMask}: {@link #mTimeOffset} counts. */
    public static final int FLAG_SUBTITLE_TIME_OFFSET = 0x01;

    /** {@link #mMask}: {@link #mFontInfo} counts. */
    public static final int FLAG_SUBTITLE_FONT_INFO = 0x04;

    /** {@link #mMask}: {@link #mBgColor} counts. */
    public static final int FLAG_SUBTITLE_BG_COLOR = 0x08;

    /** {@link #mMask}: {@link #mTextColor} counts. */
    public static final int FLAG_SUBTITLE_TEXT_COLOR = 0x10;

    /** {@link #mMask}: {@link #mEdgColor} counts. */
    public static final int FLAG_SUBTITLE_EDGE_COLOR = 0x20;

    /** {@link #mMask}: {@link #mDisplayOffset} counts. */
    public static final int FLAG_SUBTITLE_DISPLAY_OFFSET = 0x80;

    /** Which groups count; bits without a flag are ignored. */
    public int mMask;

    /** When the texts are shown. */
    public Subtitle_TimeOffset mTimeOffset;

    /** How large they are. */
    public Subtitle_FontInfo mFontInfo;

    /** The colour behind them. */
    public Subtitle_Color mBgColor;

    /** The letters' colour. */
    public Subtitle_Color mTextColor;

    /** The colour of the letters' edge. */
    public Subtitle_Color mEdgColor;

    /** Where they stand. */
    public Subtitle_DisplayOffset mDisplayOffset;

    /** Attributes without any group. */
    public SubtitleAttr() {}

    /** A shift in time. */
    public static class Subtitle_TimeOffset {
        /** {@link #mTimeOffsetType}: show later. */
        public static final int DELAY = 0;

        /** {@link #mTimeOffsetType}: show earlier. */
        public static final int ADVANCE = 1;

        /** {@link #DELAY} or {@link #ADVANCE}. */
        public int mTimeOffsetType;

        /** Milliseconds. */
        public int mOffsetValue;

        /** No shift. */
        public Subtitle_TimeOffset() {}
    }

    /** A size of letters. */
    public static class Subtitle_FontInfo {
        /** {@link #mFontSizeType}: small. */
        public static final int SMALL = 0;

        /** {@link #mFontSizeType}: medium. */
        public static final int MEDIUM = 1;

        /** {@link #mFontSizeType}: large. */
        public static final int LARGE = 2;

        /** {@link #mFontSizeType}: {@link #mCustomSize} counts. */
        public static final int CUSTOM = 3;

        /** One of the constants. */
        public int mFontSizeType;

        /** Pixels on a picture of 720 rows, 0 to 255 as an unsigned byte. */
        public byte mCustomSize;

        /** Small letters. */
        public Subtitle_FontInfo() {}
    }

    /** A colour of four unsigned bytes; alpha 0 is transparent, 255 opaque. */
    public static class Subtitle_Color {
        /** Alpha. */
        public byte mA;

        /** Red. */
        public byte mR;

        /** Green. */
        public byte mG;

        /** Blue. */
        public byte mB;

        /** Transparent black. */
        public Subtitle_Color() {}
    }

    /** A place, counted from the usual one. */
    public static class Subtitle_DisplayOffset {
        /**
         * Thousandths of the picture's width: above 0 lines begin that far from the left edge,
         * below 0 they end that far from the right edge, 0 centres them.
         */
        public int mX;

        /** Thousandths of the picture's height, downward. */
        public int mY;

        /** The usual place. */
        public Subtitle_DisplayOffset() {}
    }
}
