// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;
import static org.junit.jupiter.api.Assertions.fail;

import com.quintora.SubtitleAttr;
import java.util.ArrayList;
import java.util.List;
import java.util.Map;
import java.util.Queue;
import java.util.Random;
import java.util.TreeMap;
import java.util.concurrent.Callable;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.ConcurrentHashMap;
import java.util.concurrent.ConcurrentLinkedQueue;
import java.util.concurrent.CyclicBarrier;
import java.util.concurrent.ExecutionException;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.TimeoutException;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** Sixteen threads that call whatever they like of one player. */
class CrowdTest extends PlayerFixture {
    private static final int THREADS = 16;
    private static final int CALLS = 150 / Wait.PATIENCE;

    private final Queue<String> unexpected = new ConcurrentLinkedQueue<>();
    private final Queue<CompletableFuture<?>> promised = new ConcurrentLinkedQueue<>();
    private final Map<String, Boolean> succeeded = new ConcurrentHashMap<>();
    private final Map<String, Callable<?>> calls = new TreeMap<>();
    private final Screen screen = new Screen();

    @ParameterizedTest
    @ValueSource(longs = {1, 2, 3})
    void calledByManyAtATimeItStaysUsable(long seed) throws Exception {
        fillCalls();
        List<Thread> crowd = crowd(seed, CALLS);
        awaitEnd(crowd);
        for (CompletableFuture<?> future : promised) {
            awaitCompletion(future);
        }
        assertEquals(List.of(), List.copyOf(unexpected));

        player.resetAndWait();
        assertEquals(PlayerState.IDLE, player.getState());
        assertEquals(0, player.getDuration());
        prepare("video.mp4");
        player.setLooping(true);
        player.start();
        awaitMoving();
        assertTrue(player.isPlaying());
    }

    @ParameterizedTest
    @ValueSource(longs = {4, 5, 6})
    void releasedAmongManyCallsItRefusesThemAll(long seed) throws Exception {
        fillCalls();
        List<Thread> crowd = crowd(seed, Integer.MAX_VALUE);
        Wait.until("most calls had succeeded", this::mostSucceeded);
        player.close();
        awaitEnd(crowd);
        for (CompletableFuture<?> future : promised) {
            awaitCompletion(future);
        }
        assertEquals(List.of(), List.copyOf(unexpected));
        assertEquals(PlayerState.RELEASED, player.getState());
        screen.close();
        Wait.until("the engine's threads have ended", () -> ProcessCounts.engineThreads() == 0);
    }

    private void fillCalls() {
        playing();
        media();
        control();
        questions();
        settings();
    }

    // Now and then somebody gets as far as playing, or all would be refused.
    private void playing() {
        for (int i = 0; i < 8; i++) {
            add("play " + i, () -> {
                player.setDataSource(Media.path("video.mp4"));
                player.prepareAndWait();
                player.setLooping(true);
                player.start();
            });
        }
    }

    private void media() {
        add("setDataSource", () -> player.setDataSource(Media.path("video.mp4")));
        add("setDataSource of a stream",
                () -> player.setDataSource(new ScriptedSource(new byte[100])));
        add("prepareAndWait", () -> player.prepareAndWait());
        calls.put("prepareAsync", () -> player.prepareAsync());
        calls.put("reset", () -> player.reset());
        add("resetAndWait", () -> player.resetAndWait());
        add("surface", () -> player.setSurface(screen.surface()));
        add("no surface", () -> player.setSurface(null));
        add("listeners", () -> {
            Recorder other = new Recorder();
            player.addListener(other);
            player.removeListener(other);
        });
    }

    private void control() {
        add("start", () -> player.start());
        add("pause", () -> player.pause());
        add("stop", () -> player.stop());
        calls.put("seekTo", () -> player.seekTo(1500));
        add("seekToAndWait", () -> player.seekToAndWait(500));
        add("setSpeed", () -> player.trickPlay().setSpeed(2));
        calls.put("step", () -> player.trickPlay().step(1));
        calls.put("seekToByte", () -> player.trickPlay().seekToByte(1000));
        calls.put("repeatFromHere", () -> player.trickPlay().repeatFromHere());
        calls.put("repeatOff", () -> player.trickPlay().repeatOff());
        calls.put("selectNone", () -> player.tracks().selectNone(Track.Kind.SUBTITLE));
    }

    private void questions() {
        calls.put("getState", () -> player.getState());
        calls.put("isPlaying", () -> player.isPlaying());
        calls.put("getCurrentPosition", () -> player.getCurrentPosition());
        calls.put("getDuration", () -> player.getDuration());
        calls.put("getBufferedPercent", () -> player.getBufferedPercent());
        calls.put("getVideoWidth", () -> player.getVideoWidth());
        calls.put("isLooping", () -> player.isLooping());
        calls.put("audio", () -> player.tracks().audio());
        calls.put("currentVideo", () -> player.tracks().currentVideo());
        calls.put("chapters", () -> player.tracks().chapters());
        calls.put("metadata", () -> player.tracks().metadata());
        calls.put("description", () -> player.tracks().description());
        calls.put("thumbnail", () -> player.pictures().thumbnail(64, 36, ColorMode.ABGR8888));
        calls.put("embedded", () -> player.pictures().embedded());
        calls.put("getBytePosition", () -> player.trickPlay().getBytePosition());
    }

    private void settings() {
        add("setLooping", () -> player.setLooping(true));
        add("setVolume", () -> player.audio().setVolume(0.5f, 0.5f));
        add("setMuted", () -> player.audio().setMuted(true));
        add("setStyle", () -> player.subtitles().setStyle(SubtitleAttr.builder().delay(5).build()));
    }

    private void add(String name, Action action) {
        calls.put(name, () -> {
            action.run();
            return null;
        });
    }

    /** A call without a result. */
    private interface Action {
        void run() throws Exception;
    }

    private List<Thread> crowd(long seed, int count) {
        CyclicBarrier together = new CyclicBarrier(THREADS);
        List<Thread> crowd = new ArrayList<>();
        for (int i = 0; i < THREADS; i++) {
            Random random = new Random(seed * THREADS + i);
            Thread thread = new Thread(() -> callAround(random, together, count), "crowd-" + i);
            thread.setDaemon(true);
            thread.start();
            crowd.add(thread);
        }
        return crowd;
    }

    private void callAround(Random random, CyclicBarrier together, int count) {
        List<String> names = List.copyOf(calls.keySet());
        try {
            together.await();
            for (int i = 0; i < count || !mostSucceeded(); i++) {
                if (player.getState() == PlayerState.RELEASED) {
                    return;
                }
                call(names.get(random.nextInt(names.size())));
            }
        } catch (Exception | Error e) {
            unexpected.add("a thread of the crowd: " + e);
        }
    }

    private boolean mostSucceeded() {
        return succeeded.size() > calls.size() / 2;
    }

    private void call(String name) {
        try {
            if (calls.get(name).call() instanceof CompletableFuture<?> future) {
                promised.add(future);
            }
            succeeded.put(name, true);
        } catch (Exception | Error e) {
            // Not all media that the others set play at that speed.
            boolean deniesSpeed = name.equals("setSpeed") && e instanceof IllegalArgumentException;
            if (!isAllowed(e) && !deniesSpeed) {
                unexpected.add(name + ": " + e);
            }
        }
    }

    /** A refusal in the wrong state, and media that failed, were reset or released, in words. */
    private static boolean isAllowed(Throwable thrown) {
        return (thrown instanceof IllegalStateException || thrown instanceof MediaException)
                && thrown.getMessage() != null && !thrown.getMessage().isBlank();
    }

    private static void awaitEnd(List<Thread> crowd) throws Exception {
        for (Thread thread : crowd) {
            thread.join(Wait.LIMIT.toMillis() * 3);
            if (thread.isAlive()) {
                StringBuilder stacks = new StringBuilder("the crowd is stuck:");
                Thread.getAllStackTraces().forEach((one, stack) ->
                        stacks.append("\n").append(one).append(List.of(stack)));
                fail(stacks.toString());
            }
        }
    }

    private static void awaitCompletion(CompletableFuture<?> future) throws Exception {
        try {
            future.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
        } catch (ExecutionException e) {
            assertTrue(isAllowed(e.getCause()), e.toString());
        } catch (TimeoutException e) {
            fail("a promise was never kept");
        }
    }
}
