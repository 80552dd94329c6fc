// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

/**
 * What the desktop shows of the player.
 *
 * @param track counts the media that were played, from 1
 * @param url of the media, or empty when it has none
 * @param lengthMs 0 when it is not known
 * @param volume from 0 to 1
 * @param loop one of MPRIS's words: None, Track, Playlist
 */
public record Status(
        int track,
        String title,
        String artist,
        String url,
        boolean plays,
        long lengthMs,
        long positionMs,
        double speed,
        double volume,
        boolean hasNext,
        boolean hasPrevious,
        boolean isShuffled,
        String loop,
        boolean fillsScreen) {

    // A position that is further from where playing leads was sought.
    private static final long JUMP_MS = 1_000;

    /** Where the media is some milliseconds later, if nothing else happens. */
    long positionAfter(double millis) {
        double now = positionMs + (plays ? millis * speed : 0);
        return Math.round(Math.max(0, lengthMs > 0 ? Math.min(lengthMs, now) : now));
    }

    /** Whether this is what comes some milliseconds after another, if nothing else happens. */
    boolean follows(Status before, double millis) {
        return equals(before.at(positionMs))
                && Math.abs(positionMs - before.positionAfter(millis)) <= JUMP_MS;
    }

    /** Whether this is elsewhere than some milliseconds of playing lead. */
    boolean jumpsFrom(Status before, double millis) {
        return track == before.track
                && Math.abs(positionMs - before.positionAfter(millis)) > JUMP_MS;
    }

    /** The same at another moment of the media. */
    Status at(long millis) {
        return new Status(
                track, title, artist, url, plays, lengthMs, millis, speed, volume, hasNext,
                hasPrevious, isShuffled, loop, fillsScreen);
    }
}
