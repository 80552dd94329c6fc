// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Snapshot;
import com.quintora.orv.player.desktop.MediaControls;
import com.quintora.orv.player.desktop.Remote;
import com.quintora.orv.player.desktop.Status;
import com.quintora.orv.player.playlist.Entry;
import com.quintora.orv.player.playlist.Playlist;
import com.quintora.orv.player.playlist.Repeat;
import java.awt.EventQueue;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.List;

/** Between the window and the desktop's media keys, panels and screen saver. */
final class DesktopLink implements Remote, AutoCloseable {
    private static final List<String> LOOPS = List.of("None", "Track", "Playlist"); // As in Repeat.

    private final Controls controls;
    private final MediaControls media;
    private Playing shown;
    private String url = "";
    private int track;
    private boolean plays;
    private boolean hasBegun;

    DesktopLink(Controls controls, String bus) {
        this.controls = controls;
        media = new MediaControls(bus, this);
    }

    /**
     * Shows on the desktop how things stand, once media plays. On the window's thread; returns at
     * once.
     */
    void show(
            Playing playing, Snapshot now, double volume, boolean fillsScreen, boolean isWatched) {
        if (playing != shown) {
            shown = playing;
            track++;
            url = urlOf(playing.entry());
        }
        plays = now.playing();
        // The bus and its library would take their time from the first picture.
        hasBegun |= !plays || now.positionMs() > 0;
        if (!hasBegun) {
            return;
        }
        Playlist list = controls.list();
        MediaDetails details = playing.details();
        Status status =
                new Status(
                        track,
                        details.title().isEmpty() ? playing.entry().name() : details.title(),
                        details.artist(),
                        url,
                        plays,
                        now.durationMs(),
                        now.positionMs(),
                        now.speed(),
                        volume,
                        list.next().isPresent(),
                        list.previous().isPresent(),
                        list.isShuffled(),
                        LOOPS.get(list.repeat().ordinal()),
                        fillsScreen);
        media.show(status, plays && isWatched && details.hasVideo());
    }

    private static String urlOf(Entry entry) {
        if (entry.source().equals("-") || Entry.isUrl(entry.source())) {
            return Entry.isUrl(entry.source()) ? entry.source() : "";
        }
        try {
            return Path.of(entry.source()).toUri().toString();
        } catch (InvalidPathException e) {
            return "";
        }
    }

    @Override
    public void setPlaying(boolean wanted) {
        later(
                () -> {
                    if (plays != wanted) {
                        plays = wanted;
                        controls.togglePlaying();
                    }
                });
    }

    @Override
    public void togglePlaying() {
        later(controls::togglePlaying);
    }

    @Override
    public void next() {
        later(controls::next);
    }

    @Override
    public void previous() {
        later(controls::previous);
    }

    @Override
    public void skip(long millis) {
        later(() -> controls.skip(inRange(millis)));
    }

    @Override
    public void seekTo(long millis) {
        later(() -> controls.seekTo(inRange(millis)));
    }

    private static int inRange(long millis) {
        return (int) Math.max(-Integer.MAX_VALUE, Math.min(Integer.MAX_VALUE, millis));
    }

    @Override
    public void setVolume(double level) {
        later(() -> controls.setVolume(level));
    }

    @Override
    public void setSpeed(double speed) {
        later(() -> controls.setSpeed(speed));
    }

    @Override
    public void setShuffled(boolean shuffled) {
        later(
                () -> {
                    if (controls.list().isShuffled() != shuffled) {
                        controls.toggleShuffled();
                    }
                });
    }

    @Override
    public void setLoop(String loop) {
        int wanted = LOOPS.indexOf(loop);
        if (wanted >= 0) {
            later(() -> controls.setRepeat(Repeat.values()[wanted]));
        }
    }

    @Override
    public void setFullScreen(boolean fills) {
        later(() -> controls.setFullScreen(fills));
    }

    @Override
    public void open(String url) {
        later(() -> controls.open(List.of(url)));
    }

    @Override
    public void raise() {
        later(controls::raise);
    }

    @Override
    public void quit() {
        later(controls::quit);
    }

    private static void later(Runnable task) {
        EventQueue.invokeLater(task);
    }

    @Override
    public void close() {
        media.close();
    }
}
