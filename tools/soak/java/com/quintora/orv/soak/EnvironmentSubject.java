// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import com.quintora.mmp.MediaPlayer;
import java.io.IOException;
import java.nio.file.Path;
import java.util.concurrent.Semaphore;

/**
 * A file without a fault in surroundings with one, of which nobody may notice anything. One at a
 * time: others are plain files.
 */
final class EnvironmentSubject extends Subject {
    private static final Semaphore ONE = new Semaphore(1);

    /** A change of the surroundings. */
    interface Change {
        void make() throws IOException, InterruptedException;
    }

    private final Path media;
    private final Change before;
    private final Change during;
    private final Change after;
    private boolean opened;

    private EnvironmentSubject(
            String kind, Path media, Change before, Change during, Change after) {
        super(kind, media.getFileName().toString(), Expectation.WELL);
        this.media = media;
        this.before = before;
        this.during = during;
        this.after = after;
    }

    /** The sound server dies while they play, and is back afterwards. */
    static Subject withoutSound(Path media, SoundServer sound) {
        return alone(media, new EnvironmentSubject(
                "no sound server", media, () -> {}, sound::kill, sound::start));
    }

    /** The disk is full before they are opened. */
    static Subject onFullDisk(Path media, SmallDisk disk) {
        return alone(media, new EnvironmentSubject(
                "full disk", media, disk::fill, () -> {}, disk::clear));
    }

    private static Subject alone(Path media, EnvironmentSubject subject) {
        return ONE.tryAcquire() ? subject : FileSubjects.whole(media);
    }

    @Override
    void open(MediaPlayer player) throws IOException {
        opened = true;
        make(before);
        player.setDataSource(media);
    }

    @Override
    void disturb() throws IOException {
        make(during);
    }

    @Override
    boolean mayBeForgotten() {
        return false;
    }

    @Override
    public void close() throws IOException {
        try {
            if (opened) {
                make(after);
            }
        } finally {
            ONE.release();
        }
    }

    private static void make(Change change) throws IOException {
        try {
            change.make();
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }
}
