// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.TrickPlay;

/** Where playing stands, and how time moves it. Times are milliseconds. Used under the guard. */
final class Playhead {
    private static final double NONE = -1;

    private double position;
    private double end;
    private double speed = 1;
    private double sectionStart = NONE;
    private double sectionEnd = NONE;
    boolean looping;

    /** Stands at the start of media of a length, 0 for an unknown one. */
    void begin(double length) {
        end = length;
        position = 0;
        speed = 1;
        repeatOff();
    }

    double position() {
        return position;
    }

    double speed() {
        return speed;
    }

    void setSpeed(double newSpeed) {
        speed = newSpeed;
    }

    static boolean inRange(double speed) {
        double size = Math.abs(speed);
        return size >= TrickPlay.MIN_SPEED && size <= TrickPlay.MAX_SPEED;
    }

    boolean endIsKnown() {
        return end > 0;
    }

    void toEnd() {
        position = end;
    }

    /** Goes there, or to the end of what there is, and returns whether there was as much. */
    boolean goTo(double target) {
        position = Math.max(0, endIsKnown() ? Math.min(target, end) : target);
        return position == target;
    }

    /** Lets time pass and returns whether the end was reached. */
    boolean play(double millis) {
        position = Math.max(0, position + millis * speed);
        if (sectionEnd > sectionStart && position >= sectionEnd) {
            position = sectionStart + (position - sectionStart) % (sectionEnd - sectionStart);
        }
        if (!endIsKnown() || position < end || speed < 0) {
            return false;
        }
        position = looping ? position % end : end;
        return !looping;
    }

    void repeatFromHere() {
        sectionStart = position;
        sectionEnd = NONE;
    }

    boolean repeatUntilHere() {
        boolean possible = sectionStart >= 0 && position > sectionStart;
        sectionEnd = possible ? position : sectionEnd;
        return possible;
    }

    void repeatOff() {
        sectionStart = NONE;
        sectionEnd = NONE;
    }
}
