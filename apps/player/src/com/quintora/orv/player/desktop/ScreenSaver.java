// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

import java.util.List;

/**
 * Keeps the screen from going dark while media plays, by the desktop's screen saver, where there is
 * one. On the bus's thread. The desktop itself forgets it when the program ends.
 */
final class ScreenSaver {
    private static final Bus.Address SAVER =
            new Bus.Address(
                    "org.freedesktop.ScreenSaver",
                    "/org/freedesktop/ScreenSaver",
                    "org.freedesktop.ScreenSaver");

    private final Bus bus;
    private boolean isWanted;
    private boolean isAsked;
    private Integer cookie;

    ScreenSaver(Bus bus) {
        this.bus = bus;
    }

    void setInhibited(boolean inhibited) {
        isWanted = inhibited;
        bringAbout();
    }

    // One request at a time; the answer to it looks at what is wanted by then.
    private void bringAbout() {
        if (isWanted && cookie == null && !isAsked) {
            isAsked = true;
            bus.call(SAVER, "Inhibit", List.of("orv", "A video is playing"), this::onInhibited);
        } else if (!isWanted && cookie != null) {
            bus.call(SAVER, "UnInhibit", List.of(cookie), answer -> { });
            cookie = null;
        }
    }

    private void onInhibited(List<Object> answer) {
        isAsked = false;
        if (answer.size() == 1 && answer.get(0) instanceof Integer number) {
            cookie = number;
            bringAbout();
        }
    }
}
