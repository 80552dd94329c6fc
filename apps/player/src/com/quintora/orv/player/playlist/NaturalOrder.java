// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

import java.util.Locale;

/** Compares names as people do: numbers by their value, letters without regard to case. */
final class NaturalOrder {
    private NaturalOrder() {}

    static int compare(String a, String b) {
        int result = compareParts(a.toLowerCase(Locale.ROOT), b.toLowerCase(Locale.ROOT));
        return result != 0 ? result : a.compareTo(b);
    }

    private static int compareParts(String a, String b) {
        int i = 0;
        int j = 0;
        while (i < a.length() && j < b.length()) {
            int result;
            if (isDigit(a.charAt(i)) && isDigit(b.charAt(j))) {
                int endA = endOfNumber(a, i);
                int endB = endOfNumber(b, j);
                result = compareNumbers(a.substring(i, endA), b.substring(j, endB));
                i = endA;
                j = endB;
            } else {
                result = Character.compare(a.charAt(i++), b.charAt(j++));
            }
            if (result != 0) {
                return result;
            }
        }
        return Integer.compare(a.length() - i, b.length() - j);
    }

    // However many digits they have.
    private static int compareNumbers(String a, String b) {
        String plainA = a.replaceFirst("^0+(?=.)", "");
        String plainB = b.replaceFirst("^0+(?=.)", "");
        int result = Integer.compare(plainA.length(), plainB.length());
        return result != 0 ? result : plainA.compareTo(plainB);
    }

    private static int endOfNumber(String text, int from) {
        int end = from;
        while (end < text.length() && isDigit(text.charAt(end))) {
            end++;
        }
        return end;
    }

    private static boolean isDigit(char letter) {
        return letter >= '0' && letter <= '9';
    }
}
