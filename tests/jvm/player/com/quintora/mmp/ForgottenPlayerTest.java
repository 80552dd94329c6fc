// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.lang.ref.WeakReference;
import java.nio.file.Path;
import java.util.List;
import java.util.concurrent.CopyOnWriteArrayList;
import java.util.logging.Handler;
import java.util.logging.Level;
import java.util.logging.LogRecord;
import java.util.logging.Logger;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** Players that nobody released. */
class ForgottenPlayerTest {
    private final List<LogRecord> warnings = new CopyOnWriteArrayList<>();
    private final Logger logger = Logger.getLogger(ForgottenPlayer.class.getName());
    private final Handler handler = new Handler() {
        @Override
        public void publish(LogRecord line) {
            warnings.add(line);
        }

        @Override
        public void flush() {}

        @Override
        public void close() {}
    };

    @BeforeEach
    void listen() {
        logger.addHandler(handler);
    }

    @AfterEach
    void stopListening() {
        logger.removeHandler(handler);
    }

    @Test
    void aForgottenPlayerIsFreedWithAWarningThatSaysWhereItWasMade() throws Exception {
        Screen screen = new Screen();
        WeakReference<OrvMediaPlayer> forgotten = playAndForget(screen);
        Wait.until("it was collected and reported", () -> {
            System.gc();
            return forgotten.get() == null && !warnings.isEmpty();
        });
        LogRecord warning = warnings.get(0);
        assertEquals(Level.WARNING, warning.getLevel());
        assertTrue(warning.getMessage().contains("nobody had released"), warning.getMessage());
        StackTraceElement[] made = warning.getThrown().getStackTrace();
        assertTrue(List.of(made).toString().contains("playAndForget"), List.of(made).toString());
        Wait.until("its threads have ended", () -> Thread.getAllStackTraces().keySet().stream()
                .noneMatch(thread -> thread.getName().startsWith("OrvMediaPlayer-")));
        screen.close();
    }

    @Test
    void aReleasedPlayerIsNotReported() throws Exception {
        WeakReference<OrvMediaPlayer> released = makeAndRelease();
        Wait.until("it was collected", () -> {
            System.gc();
            return released.get() == null;
        });
        WeakReference<OrvMediaPlayer> forgotten = makeAndForget();
        Wait.until("one made later was reported", () -> {
            System.gc();
            return forgotten.get() == null && !warnings.isEmpty();
        });
        assertEquals(1, warnings.size());
    }

    @Test
    void aReleasedPlayerOfAStreamIsCollected() throws Exception {
        for (boolean byReset : new boolean[] {false, true}) {
            WeakReference<OrvMediaPlayer> released = streamAndEnd(byReset);
            Wait.until("it was collected", () -> {
                System.gc();
                return released.get() == null;
            });
        }
    }

    private static WeakReference<OrvMediaPlayer> playAndForget(Screen screen) throws Exception {
        OrvMediaPlayer player = new OrvMediaPlayer();
        player.addListener(new Recorder());
        player.setSurface(screen.surface());
        player.setDataSource(Media.path("video.mp4"));
        player.prepareAndWait();
        player.start();
        return new WeakReference<>(player);
    }

    /** Ends the stream by a reset, and forgets the player; or releases it. */
    private static WeakReference<OrvMediaPlayer> streamAndEnd(boolean byReset) throws Exception {
        OrvMediaPlayer player = new OrvMediaPlayer();
        player.setDataSource(ChannelStreamSource.open(Path.of(Media.path("video.mp4"))));
        player.prepareAndWait();
        if (byReset) {
            player.resetAndWait();
        } else {
            player.close();
        }
        return new WeakReference<>(player);
    }

    private static WeakReference<OrvMediaPlayer> makeAndRelease() {
        OrvMediaPlayer player = new OrvMediaPlayer();
        player.close();
        return new WeakReference<>(player);
    }

    private static WeakReference<OrvMediaPlayer> makeAndForget() {
        return new WeakReference<>(new OrvMediaPlayer());
    }
}
