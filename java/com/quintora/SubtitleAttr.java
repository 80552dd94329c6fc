// SPDX-License-Identifier: Apache-2.0
package com.quintora;

/**
 * The attributes that a player's native method takes: those of {@link
 * com.quintora.mmp.util.SubtitleAttr}, whose fields it reads, with a builder.
 */
public class SubtitleAttr extends com.quintora.mmp.util.SubtitleAttr {
    /** Attributes without any group. */
    public SubtitleAttr() {}

    /**
     * A builder that has no group yet.
     *
     * @return the builder
     */
    public static Builder builder() {
        return new Builder();
    }

    /**
     * Checks that every group that {@link #mMask} names is there.
     *
     * @throws IllegalArgumentException naming the group that is missing
     */
    public void check() {
        require(FLAG_SUBTITLE_TIME_OFFSET, mTimeOffset, "mTimeOffset");
        require(FLAG_SUBTITLE_FONT_INFO, mFontInfo, "mFontInfo");
        require(FLAG_SUBTITLE_BG_COLOR, mBgColor, "mBgColor");
        require(FLAG_SUBTITLE_TEXT_COLOR, mTextColor, "mTextColor");
        require(FLAG_SUBTITLE_EDGE_COLOR, mEdgColor, "mEdgColor");
        require(FLAG_SUBTITLE_DISPLAY_OFFSET, mDisplayOffset, "mDisplayOffset");
    }

    private void require(int flag, Object group, String name) {
        if ((mMask & flag) != 0 && group == null) {
            throw new IllegalArgumentException("the mask names " + name + ", which is null");
        }
    }

    /** Collects attributes; what is not given stays as it is on the screen. */
    public static final class Builder {
        private final SubtitleAttr attr = new SubtitleAttr();

        private Builder() {}

        /**
         * Shifts the texts in time.
         *
         * @param millis milliseconds; positive for later, negative for earlier
         * @return this
         */
        public Builder delay(int millis) {
            Subtitle_TimeOffset offset = new Subtitle_TimeOffset();
            offset.mTimeOffsetType =
                    millis < 0 ? Subtitle_TimeOffset.ADVANCE : Subtitle_TimeOffset.DELAY;
            offset.mOffsetValue = Math.absExact(millis);
            attr.mTimeOffset = offset;
            return with(FLAG_SUBTITLE_TIME_OFFSET);
        }

        /**
         * Chooses one of the sizes of letters.
         *
         * @param type SMALL, MEDIUM or LARGE of {@link
         *     com.quintora.mmp.util.SubtitleAttr.Subtitle_FontInfo}
         * @return this
         * @throws IllegalArgumentException for another number
         */
        public Builder fontSizeType(int type) {
            if (type < Subtitle_FontInfo.SMALL || type > Subtitle_FontInfo.LARGE) {
                throw new IllegalArgumentException("no such font size type: " + type);
            }
            return font(type, 0);
        }

        /**
         * Gives the letters a size of their own.
         *
         * @param pixels 1 to 255, on a picture of 720 rows
         * @return this
         * @throws IllegalArgumentException for a size out of range
         */
        public Builder fontSize(int pixels) {
            if (pixels < 1 || pixels > 255) {
                throw new IllegalArgumentException("font size must be 1 to 255: " + pixels);
            }
            return font(Subtitle_FontInfo.CUSTOM, pixels);
        }

        /**
         * Colours what is behind the letters.
         *
         * @param argb a colour as 0xAARRGGBB
         * @return this
         */
        public Builder backgroundColor(int argb) {
            attr.mBgColor = color(argb);
            return with(FLAG_SUBTITLE_BG_COLOR);
        }

        /**
         * Colours the letters.
         *
         * @param argb a colour as 0xAARRGGBB
         * @return this
         */
        public Builder textColor(int argb) {
            attr.mTextColor = color(argb);
            return with(FLAG_SUBTITLE_TEXT_COLOR);
        }

        /**
         * Colours the letters' edge.
         *
         * @param argb a colour as 0xAARRGGBB
         * @return this
         */
        public Builder edgeColor(int argb) {
            attr.mEdgColor = color(argb);
            return with(FLAG_SUBTITLE_EDGE_COLOR);
        }

        /**
         * Moves the texts from their usual place, which is in the middle at the bottom.
         *
         * @param x thousandths of the picture's width, -1000 to 1000: above 0 lines begin that far
         *     from the left edge, below 0 they end that far from the right edge, 0 centres them
         * @param y thousandths of the picture's height, -1000 to 1000: above 0 further down, below
         *     0 further up
         * @return this
         * @throws IllegalArgumentException for an offset out of range
         */
        public Builder displayOffset(int x, int y) {
            requireOffset(x);
            requireOffset(y);
            Subtitle_DisplayOffset offset = new Subtitle_DisplayOffset();
            offset.mX = x;
            offset.mY = y;
            attr.mDisplayOffset = offset;
            return with(FLAG_SUBTITLE_DISPLAY_OFFSET);
        }

        /**
         * Hands over what was collected. The builder must not be used any more.
         *
         * @return the attributes
         */
        public SubtitleAttr build() {
            return attr;
        }

        private Builder font(int type, int pixels) {
            attr.mFontInfo = new Subtitle_FontInfo();
            attr.mFontInfo.mFontSizeType = type;
            attr.mFontInfo.mCustomSize = (byte) pixels;
            return with(FLAG_SUBTITLE_FONT_INFO);
        }

        private Builder with(int flag) {
            attr.mMask |= flag;
            return this;
        }

        private static void requireOffset(int thousandths) {
            if (thousandths < -1000 || thousandths > 1000) {
                throw new IllegalArgumentException(
                        "a display offset is -1000 to 1000: " + thousandths);
            }
        }

        private static Subtitle_Color color(int argb) {
            Subtitle_Color color = new Subtitle_Color();
            color.mA = (byte) (argb >>> 24);
            color.mR = (byte) (argb >>> 16);
            color.mG = (byte) (argb >>> 8);
            color.mB = (byte) argb;
            return color;
        }
    }
}
