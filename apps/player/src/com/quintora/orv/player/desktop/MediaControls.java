// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Optional;

/**
 * The player on the desktop's message bus: media keys, panels and remote controls find it there
 * (MPRIS), and the screen saver is kept away while a picture plays. Where there is no bus, nothing
 * happens. Thread-safe.
 */
public final class MediaControls implements AutoCloseable {
    private final String address;
    private final Remote remote;
    private Thread thread;
    private Bus bus;
    private Mpris mpris;
    private ScreenSaver saver;
    private Status newest;
    private long shownAt;
    private boolean keepsAwake;
    private boolean isClosed;

    /** On the bus at that address. */
    public MediaControls(String address, Remote remote) {
        this.address = address;
        this.remote = remote;
    }

    /** The address of the user's bus, if there is one. */
    public static Optional<String> busOfUser() {
        String named = System.getenv("DBUS_SESSION_BUS_ADDRESS");
        if (named != null && !named.isEmpty()) {
            return Optional.of(named);
        }
        String folder = System.getenv("XDG_RUNTIME_DIR");
        return folder != null && Files.exists(Path.of(folder, "bus"))
                ? Optional.of("unix:path=" + Path.of(folder, "bus"))
                : Optional.empty();
    }

    /**
     * Shows how things stand; the first time the player comes onto the bus. Returns at once.
     *
     * @param keepsAwake whether the screen is not to go dark
     */
    public synchronized void show(Status status, boolean keepsAwake) {
        boolean isNews =
                newest == null
                        || this.keepsAwake != keepsAwake
                        || !status.follows(newest, passed());
        this.keepsAwake = keepsAwake;
        if (isClosed || !isNews) {
            return;
        }
        newest = status;
        shownAt = System.nanoTime();
        if (thread == null) {
            thread = new Thread(this::run, "media controls");
            thread.setDaemon(true);
            thread.start();
        } else if (bus != null) {
            bus.later(this::publish);
        }
    }

    private double passed() {
        return (System.nanoTime() - shownAt) / 1e6;
    }

    private void run() {
        try {
            Bus made = open();
            publish();
            made.run(mpris);
        } catch (IOException | LinkageError e) {
            // Desktops without a bus, and machines without its library, have no media keys.
            isLost();
        }
    }

    private synchronized Bus open() throws IOException {
        bus = new Bus(address);
        mpris = new Mpris(remote, newest);
        saver = new ScreenSaver(bus);
        if (isClosed) {
            bus.close();
        } else if (!bus.takeName(Mpris.NAME)) {
            bus.takeName(Mpris.NAME + ".instance" + ProcessHandle.current().pid());
        }
        return bus;
    }

    private synchronized void isLost() {
        isClosed = true;
    }

    // What was shown in between is old by now.
    private void publish() {
        Status status;
        boolean awake;
        synchronized (this) {
            status = newest;
            awake = keepsAwake && !isClosed;
        }
        mpris.show(status, bus);
        saver.setInhibited(awake);
    }

    /** Leaves the bus within a moment; returns at once. */
    @Override
    public synchronized void close() {
        isClosed = true;
        if (bus != null) {
            bus.later(this::publish);
            bus.close();
        }
    }
}
