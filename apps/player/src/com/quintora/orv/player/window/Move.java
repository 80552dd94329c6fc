// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.util.OptionalInt;

/**
 * Where the user wants to go from where the media stands: first to a place, then on or back by a
 * time, then by frames. What is pressed before it is carried out adds up.
 *
 * @param place milliseconds from the start; empty for where the media stands
 * @param skip milliseconds, negative for back
 * @param frames negative for back
 */
record Move(OptionalInt place, int skip, int frames) {
    static final Move NONE = new Move(OptionalInt.empty(), 0, 0);

    /** Whatever was to come before does not count. */
    static Move to(int millis) {
        return new Move(OptionalInt.of(millis), 0, 0);
    }

    Move plusSkip(int millis) {
        return new Move(place, limited((long) skip + millis), frames);
    }

    Move plusFrames(int count) {
        return new Move(place, skip, limited((long) frames + count));
    }

    boolean seeks() {
        return place.isPresent() || skip != 0;
    }

    /**
     * Where it leads before the frames, in milliseconds.
     *
     * @param from where the media stands
     * @param duration of the media; without one (0) nobody knows where to stop
     */
    int goal(int from, int duration) {
        long end = duration > 0 ? duration : Integer.MAX_VALUE;
        return (int) Math.max(0, Math.min((long) place.orElse(from) + skip, end));
    }

    private static int limited(long value) {
        return (int) Math.max(Integer.MIN_VALUE, Math.min(Integer.MAX_VALUE, value));
    }
}
