// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.internal.events.EndOfMedia;
import java.io.FileInputStream;
import java.io.RandomAccessFile;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.EnumSet;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Opening and playing media on the real engine. */
class PlaybackTest extends PlayerFixture {
    @Test
    void aFileIsPreparedPlayedPausedAndStopped() throws Exception {
        assertEquals(PlayerState.IDLE, player.getState());
        player.setDataSource(Media.path("video.mp4"));
        assertEquals(PlayerState.INITIALIZED, player.getState());
        assertEquals(0, player.getDuration());
        assertEquals(0, player.getCurrentPosition());
        player.prepareAndWait();
        assertEquals(PlayerState.PREPARED, player.getState());
        assertEquals(10_000, player.getDuration(), 50);
        assertEquals(320, player.getVideoWidth());
        assertEquals(180, player.getVideoHeight());
        assertFalse(player.isPlaying());
        player.start();
        assertEquals(PlayerState.STARTED, player.getState());
        awaitMoving();
        assertTrue(player.isPlaying());
        player.pause();
        assertEquals(PlayerState.PAUSED, player.getState());
        assertFalse(player.isPlaying());
        int paused = player.getCurrentPosition();
        player.pause();
        assertEquals(paused, player.getCurrentPosition());
        player.start();
        awaitMoving();
        player.stop();
        assertEquals(PlayerState.STOPPED, player.getState());
        assertFalse(player.isPlaying());
    }

    @Test
    void aStoppedPlayerCanBePreparedAgain() throws Exception {
        prepare("video.mp4");
        player.start();
        player.stop();
        player.stop();
        player.prepareAndWait();
        assertEquals(PlayerState.PREPARED, player.getState());
        player.start();
        awaitMoving();
    }

    @Test
    void resetMakesRoomForOtherMedia() throws Exception {
        prepare("video.mp4");
        player.start();
        awaitMoving();
        player.resetAndWait();
        assertEquals(PlayerState.IDLE, player.getState());
        assertEquals(0, player.getDuration());
        prepare("video.avi");
        assertEquals(5000, player.getDuration(), 100);
        player.start();
        awaitMoving();
    }

    @Test
    void theEndIsReachedAndLeftAgain() throws Exception {
        prepare("silent.mkv");
        player.start();
        awaitState(PlayerState.COMPLETED);
        assertEquals(player.getDuration(), player.getCurrentPosition());
        assertFalse(player.isPlaying());
        player.pause();
        assertEquals(PlayerState.COMPLETED, player.getState());
        player.start();
        assertEquals(PlayerState.STARTED, player.getState());
        Wait.until("it plays from the start", () -> player.getCurrentPosition() < 1500);
        awaitState(PlayerState.COMPLETED);
        Wait.until("both ends were reported", () -> recorder.count("completion") == 2);
    }

    @Test
    void aSeekLeavesTheEnd() throws Exception {
        prepare("silent.mkv");
        player.start();
        awaitState(PlayerState.COMPLETED);
        player.seekToAndWait(0);
        PlayerState after = player.getState();
        assertTrue(EnumSet.of(PlayerState.PAUSED, PlayerState.STARTED).contains(after),
                after.toString());
        assertTrue(player.getCurrentPosition() < 1000);
        player.start();
        awaitState(PlayerState.COMPLETED);
    }

    @Test
    void anEndThatNobodySawIsToldBeforeTheSeekThatLeavesIt() throws Exception {
        playToAnUnseenEnd();
        player.seekToAndWait(0);
        assertEquals(PlayerState.PAUSED, player.getState());
        goOnWatching();
        recorder.await("seek");
        assertTrue(recorder.reported.indexOf("completion") < recorder.reported.indexOf("seek"));
        assertEquals(1, recorder.count("completion"));
        player.start();
        awaitMoving();
    }

    @Test
    void anEndThatNobodySawIsNotPaused() throws Exception {
        playToAnUnseenEnd();
        player.pause();
        assertEquals(PlayerState.COMPLETED, player.getState());
        goOnWatching();
        recorder.await("completion");
    }

    @Test
    void aSeekOfAPlayingPlayerLeavesItPlaying() throws Exception {
        prepare("video.mp4");
        player.start();
        player.native_pause(); // As the engine does when a seek leaves the end.
        player.seekToAndWait(2000);
        awaitMoving();
        assertTrue(player.isPlaying());
    }

    /** The engine is at the end; the watcher is kept from seeing it. */
    private void playToAnUnseenEnd() throws Exception {
        prepare("silent.mkv");
        player.start();
        EndOfMedia end = new EndOfMedia(new NativeCalls(player), player.units.source);
        player.units.states.commands.lock();
        Wait.until("the engine is at the end", end::isReached);
        assertEquals(PlayerState.STARTED, player.getState());
    }

    private void goOnWatching() {
        player.units.states.commands.unlock();
        player.units.events.flush();
    }

    @Test
    void seeksGoToTheKeyFrameBefore() throws Exception {
        prepare("video.mp4");
        player.seekToAndWait(5300);
        assertEquals(4000, player.getCurrentPosition(), 40);
        player.seekToAndWait(6000);
        assertEquals(6000, player.getCurrentPosition(), 40);
        player.seekToAndWait(0);
        assertEquals(0, player.getCurrentPosition(), 40);
        player.seekToAndWait(Integer.MAX_VALUE);
        assertTrue(player.getCurrentPosition() >= 8000, "past the end means the end");
        assertThrows(IllegalArgumentException.class, () -> player.seekToAndWait(-1));
    }

    @Test
    void asynchronousPrepareTellsWhenItIsDone() throws Exception {
        player.setDataSource(Media.path("video.mkv"));
        player.prepareAsync();
        recorder.await("prepared");
        assertEquals(PlayerState.PREPARED, player.getState());
        player.start();
        awaitMoving();
    }

    @Test
    void loopingBeginsAgain() throws Exception {
        assertFalse(player.isLooping());
        player.setLooping(true);
        assertTrue(player.isLooping());
        prepare("silent.mkv");
        player.start();
        Wait.until("it is near the end", () -> player.getCurrentPosition() > 1000);
        Wait.until("it is near the start", () -> player.getCurrentPosition() < 800);
        assertEquals(PlayerState.STARTED, player.getState());
        assertEquals(0, recorder.count("completion"));
        player.setLooping(false);
        assertFalse(player.isLooping());
        recorder.await("completion");
    }

    @Test
    void aDescriptorIsPlayedAndStaysTheCallers() throws Exception {
        try (FileInputStream file = new FileInputStream(Media.path("video.mp4"))) {
            player.setDataSource(file.getFD());
            assertTrue(file.getFD().valid());
        }
        player.prepareAndWait();
        assertEquals(10_000, player.getDuration(), 50);
    }

    @Test
    void aPartOfADescriptorIsPlayed(@TempDir Path folder) throws Exception {
        byte[] media = Files.readAllBytes(Path.of(Media.path("silent.mkv")));
        Path padded = folder.resolve("padded");
        try (RandomAccessFile file = new RandomAccessFile(padded.toFile(), "rw")) {
            file.seek(70_001);
            file.write(media);
            file.write(new byte[5000]);
            player.setDataSource(file.getFD(), 70_001, media.length);
        }
        player.prepareAndWait();
        assertEquals(2000, player.getDuration(), 50);
        player.start();
        awaitMoving();
    }

    @Test
    void severalPlayersPlayAtOnce() throws Exception {
        prepare("video.mp4");
        try (OrvMediaPlayer second = new OrvMediaPlayer()) {
            second.setDataSource(Media.path("video.mkv"));
            second.prepareAndWait();
            second.start();
            player.start();
            awaitMoving();
            second.pause();
            awaitMoving();
            assertEquals(PlayerState.PAUSED, second.getState());
        }
        awaitMoving();
    }
}
