// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.util.PcmMediaInfo;
import java.nio.file.Path;
import java.util.Arrays;

/** Makes the workloads; the benchmarks' program calls these methods by their names. */
final class Workloads {
    private static final String FILM = "feature.mkv";
    private static final String SAMPLES = "tone-s16le.pcm";
    private static final int FILM_AUDIO_TRACKS = 2;
    private static final int KEY_FRAME_MILLIS = 2000;
    private static final int LAST_KEY_FRAME_MILLIS = 8000;

    private Workloads() {}

    /** What a call into native code and back costs at least. */
    static Workload emptyNative() {
        EmptyNative empty = new EmptyNative();
        return new Workload() {
            @Override
            void run(int times) {
                for (int i = 0; i < times; i++) {
                    empty.nothing();
                }
            }
        };
    }

    /** A call of a C function that does nothing, by Java's own interface for such. */
    static Workload emptyForeign() throws Exception {
        return new ForeignWorkload();
    }

    /** The same by JNA, whose classes may be missing. */
    static Workload emptyJna() throws Exception {
        return (Workload)
                Class.forName("com.quintora.mmp.JnaWorkload").getDeclaredConstructor().newInstance();
    }

    /** A getter that logs nothing. */
    static Workload currentPosition() throws Exception {
        return new FilmWorkload() {
            @Override
            void run(int times) throws Exception {
                for (int i = 0; i < times; i++) {
                    player.native_getCurrentPosition();
                }
            }
        };
    }

    /** A getter that logs, as nearly all calls do. */
    static Workload duration() throws Exception {
        return new FilmWorkload() {
            @Override
            void run(int times) {
                for (int i = 0; i < times; i++) {
                    require(player.native_getDuration() > 0, "the film has no duration");
                }
            }
        };
    }

    /** A call that calls back with a record for each track, and eight texts in it. */
    static Workload audioTracks() throws Exception {
        return new FilmWorkload() {
            @Override
            void run(int times) {
                for (int i = 0; i < times; i++) {
                    int tracks = player.tracks().audio().size();
                    require(tracks == FILM_AUDIO_TRACKS, "the film has " + tracks + " tracks");
                }
            }
        };
    }

    static Workload oneTrack() throws Exception {
        return new TracksWorkload(1);
    }

    static Workload eightTracks() throws Exception {
        return new TracksWorkload(8);
    }

    static Workload sixtyFourTracks() throws Exception {
        return new TracksWorkload(64);
    }

    /** A call that reads two Java objects, field by field. */
    static Workload pcmDescription() {
        return new PcmWorkload();
    }

    static Workload createAndRelease() {
        return new Workload() {
            @Override
            void run(int times) {
                for (int i = 0; i < times; i++) {
                    new OrvMediaPlayer().close();
                }
            }
        };
    }

    /** From a path to the first frame on the surface. */
    static Workload open() throws Exception {
        return new FilmWorkload() {
            @Override
            void run(int times) throws Exception {
                for (int i = 0; i < times; i++) {
                    player.setDataSource(media(FILM));
                    player.prepareAndWait();
                }
            }

            @Override
            void rewind() throws Exception {
                player.resetAndWait();
            }
        };
    }

    /** To one key frame after the other, until it is on the surface. */
    static Workload seek() throws Exception {
        return new FilmWorkload() {
            private int target;

            @Override
            void run(int times) {
                for (int i = 0; i < times; i++) {
                    target = target == LAST_KEY_FRAME_MILLIS ? 0 : target + KEY_FRAME_MILLIS;
                    player.seekToAndWait(target);
                }
            }
        };
    }

    /** 320 x 180 pixels of a key frame of 1280 x 720: sought, decoded and scaled. */
    static Workload thumbnail() throws Exception {
        return new FilmWorkload() {
            @Override
            void run(int times) {
                for (int i = 0; i < times; i++) {
                    player.pictures().thumbnailAndWait(320, 180, ColorMode.RGBA8888).orElseThrow();
                }
            }
        };
    }

    /** A player whose source gives the letter m without end; it does nothing of itself. */
    static Workload stream() throws Exception {
        Workload workload = new Workload() {
            @Override
            void run(int times) {}
        };
        workload.player.setDataSource(new EndlessSource());
        return workload;
    }

    private static String media(String name) {
        return Path.of(System.getProperty("orv.bench.media"), name).toString();
    }

    private static void require(boolean holds, String otherwise) {
        if (!holds) {
            throw new IllegalStateException(otherwise);
        }
    }

    /** With a film that is prepared and paused, and a surface for it. */
    private abstract static class FilmWorkload extends Workload {
        private final FrameReader screen = new FrameReader();

        FilmWorkload() throws Exception {
            player.setSurface(screen.getSurface());
            player.setDataSource(media(FILM));
            player.prepareAndWait();
        }

        @Override
        void close() throws Exception {
            super.close();
            screen.close();
        }
    }

    /** Whether the native half took the description shows when samples are opened. */
    private static final class PcmWorkload extends Workload {
        private static final int MONO_MILLIS = 4000;
        private static final int TOLERANCE_MILLIS = 50;

        // The samples are two seconds of stereo: taken for mono, they last twice as long.
        private final PcmMediaInfo mono = PcmMediaInfo.of(44_100, 1, 16);

        @Override
        void run(int times) {
            for (int i = 0; i < times; i++) {
                player.native_setPcmMediaInfo(mono);
            }
        }

        @Override
        void close() throws Exception {
            try {
                player.native_setPcmFlag();
                player.setDataSource(media(SAMPLES));
                player.prepareAndWait();
                int millis = player.getDuration();
                require(Math.abs(millis - MONO_MILLIS) <= TOLERANCE_MILLIS,
                        "the samples last " + millis + " ms: the description was not taken");
            } finally {
                super.close();
            }
        }
    }

    /** As many tracks as the film has are described. */
    private static final class TracksWorkload extends Workload {
        private final int count;

        TracksWorkload(int count) throws Exception {
            this.count = count;
            player.setDataSource(media("bench/tracks-" + count + ".mka"));
            player.prepareAndWait();
        }

        @Override
        void run(int times) {
            for (int i = 0; i < times; i++) {
                int tracks = player.tracks().audio().size();
                require(tracks == count, "the media has " + tracks + " tracks");
            }
        }
    }

    private static final class EndlessSource implements MediaStreamSource {
        private static final byte LETTER = 'm';

        @Override
        public int read(byte[] buffer, int length) {
            Arrays.fill(buffer, 0, length, LETTER);
            return length;
        }

        @Override
        public void seek(long position) {}

        @Override
        public long size() {
            return -1;
        }
    }
}
