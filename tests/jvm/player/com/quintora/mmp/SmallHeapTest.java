// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertInstanceOf;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.Optional;
import java.util.concurrent.Callable;
import java.util.concurrent.ExecutionException;
import java.util.concurrent.TimeUnit;
import org.junit.jupiter.api.Test;

/** Playing in a heap of 16 MB. */
class SmallHeapTest extends PlayerFixture {
    // Pictures of the largest size, of which two do not fit.
    private static final int TOO_MANY = 2;
    private static final int WIDTH = Pictures.MAX_THUMBNAIL_WIDTH;
    private static final int HEIGHT = Pictures.MAX_THUMBNAIL_HEIGHT;

    @Test
    void aPictureThatDoesNotFitIsReportedAndThePlayerWorksOn() throws Exception {
        assertTrue(Runtime.getRuntime().maxMemory() <= 16 << 20, "the heap is small");
        prepare("video.mp4");
        player.setLooping(true);
        player.start();
        Pictures pictures = player.pictures();
        assertThrows(OutOfMemoryError.class, () -> hold(
                () -> pictures.thumbnailAndWait(WIDTH, HEIGHT, ColorMode.ABGR8888)));
        ExecutionException later = assertThrows(ExecutionException.class, () -> hold(
                () -> pictures.thumbnail(WIDTH, HEIGHT, ColorMode.ABGR8888)
                        .get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS)));
        assertInstanceOf(OutOfMemoryError.class, later.getCause());
        Thumbnail small = pictures.thumbnailAndWait(64, 36, ColorMode.ABGR8888).orElseThrow();
        assertEquals(64 * 36 * 4, small.pixels().remaining());
        assertEquals(PlayerState.STARTED, player.getState());
        awaitMoving();
        player.resetAndWait();
        prepare("video.mp4");
        player.start();
        awaitMoving();
        assertEquals(0, recorder.count("error"));
    }

    @Test
    void aStreamPlaysToItsEnd() throws Exception {
        byte[] media = Files.readAllBytes(Path.of(Media.path("silent.mkv")));
        player.setDataSource(new ScriptedSource(media));
        player.prepareAndWait();
        player.start();
        recorder.await("completion");
        assertEquals(0, recorder.count("error"));
    }

    @Test
    void forgottenPlayersOfMediaGiveTheirThreadsAndDescriptorsBack() throws Exception {
        Wait.until("earlier players have ended", () -> ProcessCounts.engineThreads() == 0);
        long before = ProcessCounts.descriptors();
        try (WarningCount warnings = new WarningCount()) {
            for (int i = 0; i < 20; i++) {
                forget();
            }
            Wait.until("all were collected", () -> {
                System.gc();
                return warnings.count() == 20;
            });
        }
        Wait.until("the engine's threads have ended", () -> ProcessCounts.engineThreads() == 0);
        Wait.until("the descriptors were closed", () -> ProcessCounts.descriptors() <= before);
    }

    private static void hold(Callable<Optional<Thumbnail>> request) throws Exception {
        List<Thumbnail> held = new ArrayList<>();
        while (held.size() < TOO_MANY) {
            held.add(request.call().orElseThrow());
        }
    }

    private static void forget() throws Exception {
        OrvMediaPlayer player = new OrvMediaPlayer();
        player.setDataSource(Media.path("silent.mkv"));
        player.prepareAndWait();
        player.start();
    }
}
