// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.util.regex.Matcher;
import java.util.regex.Pattern;
import picocli.CommandLine.TypeConversionException;

/** Times of media as people write them: seconds, or [h:]mm:ss with an optional fraction. */
public final class Times {
    private static final Pattern CLOCK =
            Pattern.compile("(?:(?:(\\d{1,3}):)?(\\d{1,4}):)?(\\d{1,7}(?:\\.\\d+)?)");

    private static final String UNKNOWN = "–:––";

    private Times() {}

    /** Milliseconds as m:ss, or h:mm:ss from an hour on. Negative times are shown as 0. */
    public static String clock(long millis) {
        long seconds = Math.max(0, millis) / 1000;
        long hours = seconds / 3600;
        return hours > 0
                ? String.format("%d:%02d:%02d", hours, seconds / 60 % 60, seconds % 60)
                : String.format("%d:%02d", seconds / 60, seconds % 60);
    }

    /** How long media are, as a clock shows it, or dashes for 0, which means that nobody knows. */
    public static String length(long millis) {
        return millis > 0 ? clock(millis) : UNKNOWN;
    }

    /** Milliseconds of a text such as 75.5, 1:15.5 or 0:01:15.5. */
    public static int parseMillis(String text) {
        Matcher match = CLOCK.matcher(text.trim());
        if (!match.matches()) {
            throw new TypeConversionException(
                    "'" + text + "' is not a time; write seconds (75.5) or h:mm:ss (0:01:15.5)");
        }
        double seconds = Double.parseDouble(match.group(3));
        seconds += 60.0 * number(match.group(2)) + 3600.0 * number(match.group(1));
        if (seconds > Integer.MAX_VALUE / 1000) {
            throw new TypeConversionException("'" + text + "' is beyond the longest media");
        }
        return (int) Math.round(seconds * 1000);
    }

    private static int number(String group) {
        return group == null ? 0 : Integer.parseInt(group);
    }
}
