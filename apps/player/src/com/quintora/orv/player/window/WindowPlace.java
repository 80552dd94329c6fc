// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.GraphicsDevice;
import java.awt.GraphicsEnvironment;
import java.awt.Rectangle;
import java.util.Map;
import java.util.Optional;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/** A window's place on the screen, as it is remembered: "X Y WIDTHxHEIGHT". */
final class WindowPlace {
    /** Its name in what is remembered. */
    static final String NAME = "window";

    private static final Pattern FORM =
            Pattern.compile("(-?\\d{1,5}) (-?\\d{1,5}) (\\d{1,5})x(\\d{1,5})");
    // So much of it must be on a screen for the mouse to get at it.
    private static final int SEEN = 80;

    private WindowPlace() {}

    static String of(Rectangle place) {
        return place.x + " " + place.y + " " + place.width + "x" + place.height;
    }

    /** The remembered place, if there is one, and it is on a screen that is there today. */
    static Optional<Rectangle> in(Map<String, String> remembered) {
        Matcher form = FORM.matcher(remembered.getOrDefault(NAME, ""));
        if (!form.matches()) {
            return Optional.empty();
        }
        Rectangle place =
                new Rectangle(number(form, 1), number(form, 2), number(form, 3), number(form, 4));
        return Optional.of(place).filter(WindowPlace::isSeen);
    }

    private static int number(Matcher form, int group) {
        return Integer.parseInt(form.group(group));
    }

    private static boolean isSeen(Rectangle place) {
        for (GraphicsDevice screen :
                GraphicsEnvironment.getLocalGraphicsEnvironment().getScreenDevices()) {
            Rectangle seen = screen.getDefaultConfiguration().getBounds().intersection(place);
            if (seen.width >= SEEN && seen.height >= SEEN) {
                return true;
            }
        }
        return false;
    }
}
