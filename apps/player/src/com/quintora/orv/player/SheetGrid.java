// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.util.regex.Matcher;
import java.util.regex.Pattern;
import picocli.CommandLine.TypeConversionException;

/** How many pictures a sheet has beside and below one another, written 4x3. */
record SheetGrid(int columns, int rows) {
    private static final int MOST = 20;
    private static final Pattern TEXT = Pattern.compile("(\\d{1,3})[xX](\\d{1,3})");

    static SheetGrid parse(String text) {
        Matcher match = TEXT.matcher(text.trim());
        if (!match.matches()) {
            throw new TypeConversionException(
                    "'" + text + "' is no number of columns and rows such as 4x4");
        }
        SheetGrid grid =
                new SheetGrid(
                        Integer.parseInt(match.group(1)), Integer.parseInt(match.group(2)));
        if (!isPossible(grid.columns) || !isPossible(grid.rows)) {
            throw new TypeConversionException("a sheet has 1x1 to 20x20 pictures, not " + text);
        }
        return grid;
    }

    private static boolean isPossible(int count) {
        return count >= 1 && count <= MOST;
    }

    int pictures() {
        return columns * rows;
    }
}
