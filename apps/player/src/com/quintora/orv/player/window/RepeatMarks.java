// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

/** Where a section that is repeated begins and ends, in milliseconds; negative for nowhere. */
record RepeatMarks(int from, int to) {
    static final RepeatMarks NONE = new RepeatMarks(-1, -1);

    RepeatMarks withStart(int millis) {
        return new RepeatMarks(millis, -1);
    }

    RepeatMarks withEnd(int millis) {
        return new RepeatMarks(from, millis);
    }

    boolean hasStart() {
        return from >= 0;
    }

    boolean hasEnd() {
        return to >= 0;
    }
}
