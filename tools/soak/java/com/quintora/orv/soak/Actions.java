// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.ColorMode;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Track;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.desktop.VideoFrame;
import java.io.IOException;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.Random;
import java.util.concurrent.CompletableFuture;

/** What a program does with a player that has media. */
final class Actions {
    private static final double[] SPEEDS = {-32, -4, -1, 0.25, 0.5, 1.5, 2, 8, 32};
    private static final int MOST_SEEKS = 5;

    private final Session session;
    private final MediaPlayer player;
    private final Random random;
    private final List<Run.Step> all;

    Actions(Session session) {
        this.session = session;
        player = session.player;
        random = session.random;
        all = List.of(this::play, this::play, this::pause, this::seek, this::seek, this::seekOften,
                this::selectSound, this::selectSubtitles, this::selectSubtitles, this::restyle,
                this::thumbnail, this::thumbnail, this::inform, this::step, this::changeSpeed,
                this::changeVolume, this::repeat, this::addSubtitles, this::addNoSubtitles,
                this::prepareAgain, this::openAgain, this::changeSurface, this::cover,
                this::seekToByte);
    }

    /** One of them. */
    void any() throws Exception {
        all.get(random.nextInt(all.size())).run();
    }

    void play() throws Exception {
        int millis = random.nextInt(150);
        session.act("play for " + millis + " ms", () -> {
            player.start();
            session.awaitMoving();
            watch(millis);
        });
    }

    private void watch(int millis) throws InterruptedException {
        long until = System.nanoTime() + millis * 1_000_000L;
        while (System.nanoTime() < until) {
            if (session.screen == null) {
                Thread.sleep(1);
                continue;
            }
            try (VideoFrame frame = session.screen.awaitFrame(10)) {
                if (frame != null && frame.getWidth() < 1) {
                    throw new AssertionError("a frame without a size");
                }
            }
        }
    }

    private void pause() throws Exception {
        session.act("pause", () -> {
            player.start();
            player.pause();
        });
    }

    private int anyTime() {
        return random.nextInt(Math.max(player.getDuration(), 1));
    }

    private void seek() throws Exception {
        int millis = anyTime();
        long from = System.nanoTime();
        if (session.act("seek to " + millis, () -> player.seekToAndWait(millis))
                && session.subject.kind.equals("file")) {
            session.run.tally.sought((System.nanoTime() - from) / 1e9);
        }
    }

    private void seekOften() throws Exception {
        int times = 2 + random.nextInt(MOST_SEEKS);
        session.act(times + " seeks at once", () -> {
            List<CompletableFuture<Boolean>> seeks = new ArrayList<>();
            for (int i = 0; i < times; i++) {
                seeks.add(player.seekTo(anyTime()));
            }
            for (CompletableFuture<Boolean> seek : seeks) {
                seek.get();
            }
        });
    }

    private void selectSound() throws Exception {
        select(player.tracks().audio());
    }

    private void selectSubtitles() throws Exception {
        List<? extends Track> tracks = player.tracks().subtitles();
        if (!tracks.isEmpty() && random.nextInt(3) == 0) {
            session.act("no subtitles",
                    () -> player.tracks().selectNoneAndWait(Track.Kind.SUBTITLE));
        } else {
            select(tracks);
        }
    }

    private void select(List<? extends Track> tracks) throws Exception {
        if (tracks.isEmpty()) {
            return;
        }
        Track track = tracks.get(random.nextInt(tracks.size()));
        session.act("select " + track.kind() + " " + track.index(), () -> {
            if (random.nextBoolean()) {
                player.tracks().selectAndWait(track);
            } else {
                player.tracks().select(track).get();
            }
        });
    }

    private void restyle() throws Exception {
        session.act("restyle subtitles", () -> player.subtitles().setStyle(SubtitleAttr.builder()
                .textColor(random.nextInt())
                .edgeColor(random.nextInt())
                .backgroundColor(random.nextInt())
                .fontSize(1 + random.nextInt(255))
                .delay(random.nextInt(2000) - 1000)
                .displayOffset(random.nextInt(2001) - 1000, random.nextInt(2001) - 1000)
                .build()));
    }

    private void thumbnail() throws Exception {
        int width = 1 + random.nextInt(400);
        int height = 1 + random.nextInt(255);
        ColorMode[] modes = ColorMode.values();
        ColorMode mode = modes[random.nextInt(modes.length)];
        boolean hasPicture = player.getVideoWidth() > 0;
        session.act("thumbnail " + width + "x" + height + " " + mode, () -> {
            boolean drawn = player.pictures().thumbnailAndWait(width, height, mode).isPresent();
            if (!drawn && hasPicture && session.subject.expectation.isWell()) {
                throw new AssertionError("no thumbnail of media with a picture");
            }
        });
    }

    private void inform() throws Exception {
        session.act("ask for everything", () -> {
            player.tracks().video();
            player.tracks().audio();
            player.tracks().subtitles();
            player.tracks().currentVideo();
            player.tracks().currentAudio();
            player.tracks().currentSubtitle();
            player.tracks().chapters();
            player.tracks().metadata();
            player.tracks().description();
            player.getBufferedPercent();
            player.isPlaying();
        });
    }

    private void step() throws Exception {
        int frames = random.nextInt(7) - 3;
        session.actIfPossible("step by " + frames, () -> player.trickPlay().stepAndWait(frames));
    }

    private void changeSpeed() throws Exception {
        double speed = SPEEDS[random.nextInt(SPEEDS.length)];
        if (!player.trickPlay().canPlayAt(speed)) {
            return;
        }
        session.act("speed " + speed, () -> {
            player.start();
            player.trickPlay().setSpeed(speed);
            watch(random.nextInt(100));
        });
        session.act("normal speed", () -> player.trickPlay().setSpeed(1));
    }

    private void changeVolume() throws Exception {
        session.act("volume", () -> {
            player.audio().setVolume(random.nextFloat(), random.nextFloat());
            player.setMuted(random.nextBoolean());
        });
    }

    private void repeat() throws Exception {
        session.act("repeat", () -> {
            player.setLooping(random.nextBoolean());
            player.trickPlay().repeatFromHere();
            player.start();
            watch(random.nextInt(60));
            player.trickPlay().repeatUntilHere();
            watch(random.nextInt(60));
            player.trickPlay().repeatOff();
        });
    }

    private void addSubtitles() throws Exception {
        String name = List.of("lines.srt", "lines.ass", "latin1.srt").get(random.nextInt(3));
        Path file = session.run.settings.media().resolve(name);
        session.act("add " + name, () -> {
            if (random.nextBoolean()) {
                player.subtitles().add(file).get();
            } else {
                player.subtitles().addTimedTextAndWait(file.toString());
            }
        });
    }

    private void addNoSubtitles() throws Exception {
        String name = List.of("missing.srt", "empty.bin", "garbage.bin").get(random.nextInt(3));
        String file = session.run.settings.media().resolve(name).toString();
        session.actIfPossible("add no subtitles: " + name, () -> {
            try {
                player.subtitles().addAndWait(file);
            } catch (MediaException e) {
                session.run.tally.count("subtitles refused");
                return;
            }
            throw new AssertionError("no subtitles were added from " + file);
        });
    }

    private void prepareAgain() throws Exception {
        if (session.act("stop", player::stop)) {
            session.act("prepare again", player::prepareAndWait);
        }
    }

    private void openAgain() throws Exception {
        if (session.act("reset", player::resetAndWait)) {
            session.open();
        }
    }

    private void changeSurface() throws Exception {
        session.act("change the surface", () -> {
            FrameReader old = session.screen;
            session.screen = random.nextBoolean() ? new FrameReader() : null;
            player.setSurface(session.screen == null ? null : session.screen.getSurface());
            if (old != null) {
                old.close();
            }
        });
    }

    private void cover() throws Exception {
        session.act("embedded picture", () -> player.pictures().embedded());
    }

    private void seekToByte() throws Exception {
        int position = random.nextInt(100_000);
        session.actIfPossible("seek to byte " + position, () -> {
            player.trickPlay().seekToByteAndWait(position);
            try {
                player.trickPlay().getBytePosition();
            } catch (IOException e) {
                return; // The engine does not know it.
            }
        });
    }

    /** Whether the player is where actions are possible. */
    boolean arePossible() {
        PlayerState state = player.getState();
        return session.isUsable() && state != PlayerState.IDLE && state != PlayerState.INITIALIZED
                && state != PlayerState.STOPPED;
    }
}
