// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.Pictures;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import picocli.CommandLine.TypeConversionException;

/** A picture's size in pixels, written WxH. */
record Size(int width, int height) {
    private static final Pattern TEXT = Pattern.compile("(\\d{1,5})[xX](\\d{1,5})");

    static Size parse(String text) {
        Matcher match = TEXT.matcher(text.trim());
        if (!match.matches()) {
            throw new TypeConversionException("'" + text + "' is not a size such as 320x180");
        }
        Size size = new Size(Integer.parseInt(match.group(1)), Integer.parseInt(match.group(2)));
        if (size.width == 0 || size.height == 0) {
            throw new TypeConversionException("a picture of " + text + " has no pixels");
        }
        return size;
    }

    /** Of the same shape, as near as whole pixels come. */
    Size withHeight(int rows) {
        int columns = (int) Math.round((double) rows * width / height);
        return new Size(Math.max(1, Math.min(Pictures.MAX_THUMBNAIL_WIDTH, columns)), rows);
    }

    @Override
    public String toString() {
        return width + "x" + height;
    }
}
