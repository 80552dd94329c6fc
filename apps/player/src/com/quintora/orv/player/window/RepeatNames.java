// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.playlist.Repeat;

/** What the window calls the ways of repeating. */
final class RepeatNames {
    private RepeatNames() {}

    static String of(Repeat repeat) {
        return switch (repeat) {
            case OFF -> "Repeat off";
            case ONE -> "Repeat this one";
            case ALL -> "Repeat all";
        };
    }
}
