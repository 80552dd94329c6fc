// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.Executor;
import java.util.concurrent.TimeUnit;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** Players side by side: what they share, and that they do not disturb each other. */
class ManyPlayersTest {
    private static final int WALL = 16;
    private static final String SHARED = "OrvMediaPlayers-";
    private static final String LISTENING = "OrvMediaPlayer-";

    private final List<OrvMediaPlayer> players = new ArrayList<>();

    @AfterEach
    void releaseAll() {
        players.forEach(OrvMediaPlayer::close);
    }

    @Test
    void playersWithoutMediaHaveNoThreads() throws Exception {
        Wait.until("the threads of earlier players ended",
                () -> ProcessCounts.engineThreads() == 0);
        List<Thread> before = javaThreads("OrvMediaPlayer");
        for (int i = 0; i < 200; i++) {
            OrvMediaPlayer player = make(null);
            player.addListener(new Recorder());
            player.setLooping(true);
            player.resetAndWait();
        }
        assertEquals(0, ProcessCounts.engineThreads());
        List<Thread> now = javaThreads("OrvMediaPlayer");
        now.removeAll(before);
        assertEquals(List.of(), now);
    }

    @Test
    void theThreadsOfPlayersEndWithThem() throws Exception {
        for (int i = 0; i < 3; i++) {
            play(make(null));
        }
        assertTrue(ProcessCounts.engineThreads() > 0);
        releaseAll();
        Wait.until("the engine's threads ended", () -> ProcessCounts.engineThreads() == 0);
        Wait.until("the shared threads ended", () -> javaThreads(SHARED).isEmpty());
    }

    @Test
    void everyPlayerOfAWallTellsAllInOrder() throws Exception {
        List<Recorder> recorders = new ArrayList<>();
        for (int i = 0; i < WALL; i++) {
            OrvMediaPlayer player = make(null);
            Recorder recorder = new Recorder() {
                @Override
                public void onPrepared(MediaPlayer from) {
                    super.onPrepared(from);
                    from.start();
                }
            };
            player.addListener(recorder);
            recorders.add(recorder);
            player.setDataSource(Media.path("silent.mkv"));
        }
        for (OrvMediaPlayer player : players) {
            player.prepareAsync();
        }
        for (Recorder recorder : recorders) {
            recorder.await("completion");
            assertEquals("prepared", recorder.reported.get(0));
            assertEquals(1, recorder.count("prepared"));
            assertEquals(1, recorder.count("size 320x180"));
            assertEquals(1, recorder.count("info 3 0"));
            assertEquals(1, recorder.count("completion"));
            assertTrue(recorder.reported.indexOf("info 3 0")
                    < recorder.reported.indexOf("completion"));
            assertEquals(1, recorder.threads.stream().distinct().count());
        }
    }

    @Test
    void watchingIsShared() throws Exception {
        for (int i = 0; i < WALL; i++) {
            play(make(null));
        }
        for (OrvMediaPlayer player : players) {
            int from = player.getCurrentPosition();
            Wait.until("it moved on", () -> player.getCurrentPosition() != from);
        }
        assertEquals(1, javaThreads(SHARED + "clock-").size());
        assertTrue(javaThreads(SHARED).stream().allMatch(Thread::isDaemon));
        assertEquals(List.of(), javaThreads(LISTENING), "there are no listeners");
    }

    @Test
    void aListenerThatBlocksHoldsUpItsOwnPlayerAlone() throws Exception {
        CountDownLatch goOn = new CountDownLatch(1);
        CountDownLatch blocked = new CountDownLatch(WALL);
        for (int i = 0; i < WALL; i++) {
            OrvMediaPlayer player = make(Runnable::run); // On the thread that watches.
            player.addListener(new PlayerListener() {
                @Override
                public void onPrepared(MediaPlayer from) {
                    blocked.countDown();
                    await(goOn);
                }
            });
            player.setDataSource(Media.path("silent.mkv"));
            player.prepareAsync();
        }
        await(blocked);
        OrvMediaPlayer free = make(null);
        Recorder recorder = new Recorder();
        free.addListener(recorder);
        play(free);
        free.setLooping(false);
        recorder.await("completion");
        goOn.countDown();
    }

    private OrvMediaPlayer make(Executor executor) {
        OrvMediaPlayer player = new OrvMediaPlayer(executor);
        players.add(player);
        return player;
    }

    private static void play(OrvMediaPlayer player) throws Exception {
        player.setDataSource(Media.path("silent.mkv"));
        player.prepareAndWait();
        player.setLooping(true);
        player.start();
    }

    private static void await(CountDownLatch latch) {
        try {
            assertTrue(latch.await(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
        } catch (InterruptedException e) {
            throw new AssertionError(e);
        }
    }

    private static List<Thread> javaThreads(String prefix) {
        List<Thread> threads = new ArrayList<>(Thread.getAllStackTraces().keySet());
        threads.removeIf(thread -> !thread.getName().startsWith(prefix));
        return threads;
    }
}
