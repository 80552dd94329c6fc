// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/**
 * A playback at one moment.
 *
 * @param positionMs milliseconds from the start of the media
 * @param durationMs milliseconds, 0 when unknown
 * @param speed times the normal speed, negative for backward
 * @param bufferedPercent how much of the media has been read ahead, 0 to 100
 * @param framesShown frames that reached the screen, or were decoded where there is none
 * @param framesDropped frames of the media that were missed between those
 */
public record Snapshot(
        int positionMs,
        int durationMs,
        boolean playing,
        double speed,
        int bufferedPercent,
        long framesShown,
        long framesDropped) {}
