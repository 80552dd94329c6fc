// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.VideoTrack;

/**
 * The way to the frame that is shown at a time: its own time is not after that, the next frame's
 * is. It leads from the frame that is shown now where that is near, otherwise from the key frame at
 * which a seek ends. Times are in milliseconds. For one thread at a time.
 */
final class Approach {
    /** What is moved; it rests meanwhile. */
    interface Film {
        /** Goes to a key frame near that time, usually before it. */
        void seekTo(int millis);

        /**
         * Goes some frames on, or back when negative; of many frames possibly only about that
         * many. Returns false when there are fewer: it is at the last of them then.
         */
        boolean step(int frames);

        /** The time of the frame that is shown. */
        int position();

        /** Whether it is that of a frame, as after the end of the media it is not. */
        boolean isAtFrame();
    }

    private enum Pace {
        UNKNOWN,
        STEADY,
        VARIABLE
    }

    // Positions are rounded.
    private static final int ROUNDING_MS = 1;

    // Rates are rounded, too.
    private static final double RATE_PRECISION = 1e-4;

    // In frames: a whole number of them is one.
    private static final double COUNT_PRECISION = 0.01;

    // For pictures of which nobody knows how often they come.
    private static final double USUAL_RATE = 25;

    // A step over all frames on the way is one exact seek, but their packets are counted: as
    // many as are just behind or ahead of what plays, and so have been read.
    private static final int NEAR_MS = 15_000;

    // Far more than any way needs; none shall go on for ever.
    private static final int MOST_STEPS = 60;

    private final Film film;
    private final double periodMs;
    private Pace pace = Pace.UNKNOWN;

    /** For a player with a picture, which must not play meanwhile. */
    static Approach of(OrvMediaPlayer player) {
        double rate = player.tracks().currentVideo().map(VideoTrack::frameRate).orElse(0.0);
        return new Approach(new PlayerFilm(player), rate > 0 ? rate : USUAL_RATE);
    }

    /** Media of about so many frames a second. */
    Approach(Film film, double framesPerSecond) {
        this.film = film;
        periodMs = 1000 / framesPerSecond;
    }

    /**
     * Goes to the frame of that time, to the first one when all are later.
     *
     * @throws IllegalStateException when the media cannot seek
     */
    void to(int millis) {
        int latest = millis + ROUNDING_MS;
        boolean isFromHere = isNear(latest);
        if (!isFromHere) {
            film.seekTo(millis);
        }
        walkTo(latest, isFromHere);
    }

    private boolean isNear(int latest) {
        return pace != Pace.VARIABLE
                && film.isAtFrame()
                && Math.abs(latest - film.position()) <= NEAR_MS;
    }

    private void walkTo(int latest, boolean isFromHere) {
        int most = Integer.MAX_VALUE;
        boolean isLast = false;
        for (int i = 0; i < MOST_STEPS && !isArrived(latest, isLast); i++) {
            int before = film.position();
            int frames = framesTo(latest, before, most);
            boolean found = step(frames, isFromHere && i == 0);
            boolean isPast = film.position() > latest;
            if (!found && frames < 0 && isPast) {
                return; // The first frame of all.
            }
            isLast = !isPast && (found ? frames == -1 && before > latest : frames > 0);
            if (film.position() == before) {
                most = 1; // Many frames by their usual length may be fewer than one.
            } else if (isPast != before > latest) {
                most = Math.max(1, Math.abs(frames) / 2);
            }
        }
    }

    private boolean isArrived(int latest, boolean isLast) {
        int left = latest - film.position();
        boolean isExact = left <= 2 * ROUNDING_MS;
        return left >= 0 && (isExact || isLast || pace == Pace.STEADY && left < periodMs);
    }

    /** How many frames to step: at least one, forward or back, and not more than so many. */
    private int framesTo(int latest, int position, int most) {
        int left = latest - position;
        double periods = Math.abs(left) / periodMs;
        double frames = left >= 0 ? Math.floor(periods + COUNT_PRECISION) : Math.ceil(periods);
        int count = (int) Math.max(1, Math.min(frames, most));
        return left >= 0 ? count : -count;
    }

    /** A long step may meet frames that were left out and does not say how the others come. */
    private boolean step(int frames, boolean isLong) {
        int before = film.position();
        boolean found = film.step(frames);
        if (found && pace != Pace.VARIABLE) {
            double expected = frames * periodMs;
            double error = Math.abs(film.position() - before - expected);
            boolean isAsExpected =
                    error <= 2 * ROUNDING_MS + Math.abs(expected) * RATE_PRECISION;
            if (isAsExpected || !isLong) {
                pace = isAsExpected ? Pace.STEADY : Pace.VARIABLE;
            }
        }
        return found;
    }

    private record PlayerFilm(OrvMediaPlayer player) implements Film {
        @Override
        public void seekTo(int millis) {
            player.seekToAndWait(millis);
        }

        @Override
        public boolean step(int frames) {
            try {
                player.trickPlay().stepAndWait(frames);
                return true;
            } catch (IllegalStateException e) {
                PlayerState state = player.getState();
                if (state != PlayerState.PAUSED && state != PlayerState.COMPLETED) {
                    throw e; // The media failed, or was released.
                }
                return false;
            }
        }

        @Override
        public int position() {
            return player.getCurrentPosition();
        }

        @Override
        public boolean isAtFrame() {
            PlayerState state = player.getState();
            return state == PlayerState.PREPARED || state == PlayerState.PAUSED;
        }
    }
}
