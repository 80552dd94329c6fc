// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.Optional;

/** What all cycles share. */
final class Run implements AutoCloseable {
    /** Does something that may throw. */
    interface Step {
        void run() throws Exception;
    }

    final Settings settings;
    final Plant plant;
    final Journal journal;
    final Tally tally = new Tally();

    private final List<AutoCloseable> leftovers = new ArrayList<>();
    private final Optional<SmallDisk> disk;
    private final SoundServer sound;

    Run(Settings settings) throws Exception {
        this.settings = settings;
        plant = settings.plant();
        journal = new Journal(settings.folder().resolve("actions"));
        disk = settings.smallDisk().map(SmallDisk::new);
        sound = settings.soundSocket().isEmpty()
                ? null : new SoundServer(settings.soundSocket().get());
    }

    /** Media whose sound server dies; plain ones where there is none to kill. */
    Subject withoutSound(Path media) {
        return sound == null
                ? FileSubjects.whole(media) : EnvironmentSubject.withoutSound(media, sound);
    }

    /** Media on a full disk; plain ones where there is none to fill. */
    Subject onFullDisk(Path media) {
        return disk.map(small -> EnvironmentSubject.onFullDisk(media, small))
                .orElseGet(() -> FileSubjects.whole(media));
    }

    /** Closes that once all forgotten players are gone. */
    synchronized void closeLater(AutoCloseable leftover) {
        leftovers.add(leftover);
    }

    /** Waits until the garbage collector has found all that were forgotten. */
    void awaitForgotten() throws Exception {
        Journal.Action action = journal.begin(-1, "find forgotten players");
        while (tally.found.get() < tally.forgotten.get()) {
            System.gc();
            Thread.sleep(10);
        }
        action.end("all " + tally.found + " found");
        synchronized (this) {
            for (AutoCloseable leftover : leftovers) {
                leftover.close();
            }
            leftovers.clear();
        }
    }

    @Override
    public void close() {
        if (sound != null) {
            sound.close();
        }
    }
}
