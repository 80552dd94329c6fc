// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.text.Bidi;

/**
 * Keeps words in their order where letters of both directions meet. Java takes the direction of a
 * line from its first letter, which in sentences of ours may be that of a Hebrew or Arabic name.
 */
public final class ReadingOrder {
    // Marks that nobody sees, and that fonts need not have.
    private static final char LEFT_TO_RIGHT = '\u200E';
    private static final char BEGIN_LEFT_TO_RIGHT = '\u202A';
    private static final char BEGIN_RIGHT_TO_LEFT = '\u202B';
    private static final char END = '\u202C';

    private ReadingOrder() {}

    /** From left to right as a whole, whatever it begins with. */
    public static String ofSentence(String words) {
        return hasBoth(words) ? LEFT_TO_RIGHT + words : words;
    }

    /** A name or title within a sentence, or alone: in the direction of its own first letter. */
    public static String ofName(String name) {
        if (!hasBoth(name)) {
            return name;
        }
        boolean isLeftToRight =
                new Bidi(name, Bidi.DIRECTION_DEFAULT_LEFT_TO_RIGHT).baseIsLeftToRight();
        return (isLeftToRight ? BEGIN_LEFT_TO_RIGHT : BEGIN_RIGHT_TO_LEFT) + name + END;
    }

    private static boolean hasBoth(String words) {
        return Bidi.requiresBidi(words.toCharArray(), 0, words.length());
    }
}
