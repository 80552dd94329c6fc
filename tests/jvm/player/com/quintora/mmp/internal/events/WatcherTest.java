// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Wait;
import com.quintora.mmp.internal.PlayerUnits;
import com.quintora.mmp.internal.ScriptedNatives;
import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.CyclicBarrier;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** A player is looked at as long as it plays, whoever says when that it runs otherwise. */
class WatcherTest {
    private static final int ROUNDS = 10;
    private static final int PLAYERS = 100;
    private static final int WAKERS = 4;

    private final List<ScriptedNatives> natives = new ArrayList<>();
    private final List<PlayerUnits> players = new ArrayList<>();

    @AfterEach
    void close() {
        players.forEach(player -> player.lifetime.close());
    }

    @Test
    void wakesAtTheSameTimeLoseNoLook() throws Exception {
        for (int i = 0; i < PLAYERS; i++) {
            play();
        }
        for (int round = 0; round < ROUNDS; round++) {
            wakeAll();
            awaitLooks();
        }
    }

    private void awaitLooks() throws Exception {
        List<Long> before = natives.stream().map(WatcherTest::looks).toList();
        for (int i = 0; i < PLAYERS; i++) {
            ScriptedNatives looked = natives.get(i);
            long enough = before.get(i) + 2;
            Wait.until("it was looked at again and again", () -> looks(looked) >= enough);
        }
    }

    private static long looks(ScriptedNatives looked) {
        return looked.count("getCurrentPosition");
    }

    private void play() throws Exception {
        ScriptedNatives half = new ScriptedNatives();
        half.answer("isPlaying", () -> true);
        PlayerUnits units = half.units();
        natives.add(half);
        players.add(units);
        units.sources.set("film.mkv");
        units.preparation.prepareAndWait();
        units.playback.start();
        assertEquals(PlayerState.STARTED, units.states.state());
    }

    private void wakeAll() throws Exception {
        CyclicBarrier together = new CyclicBarrier(WAKERS);
        List<Thread> wakers = new ArrayList<>();
        for (int i = 0; i < WAKERS; i++) {
            Thread waker = new Thread(() -> {
                for (PlayerUnits player : players) {
                    await(together);
                    player.watcher.wake();
                }
            });
            waker.start();
            wakers.add(waker);
        }
        for (Thread waker : wakers) {
            waker.join();
        }
    }

    private static void await(CyclicBarrier barrier) {
        try {
            barrier.await();
        } catch (Exception e) {
            throw new AssertionError(e);
        }
    }
}
