// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.lang.ref.WeakReference;
import java.lang.reflect.Method;
import java.nio.charset.StandardCharsets;
import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicBoolean;
import java.util.concurrent.atomic.AtomicInteger;
import java.util.concurrent.atomic.AtomicReference;
import org.junit.jupiter.api.Test;

/** What is reported to listeners, in which order, on which thread, and when no more. */
class ListenerTest extends PlayerFixture {
    @Test
    void aMediumsLifeIsToldOnceAndInOrder() throws Exception {
        prepare("silent.mkv");
        recorder.await("size 320x180");
        player.start();
        recorder.await("completion");
        assertEquals(
                List.of("prepared", "size 320x180", "info 3 0", "completion"),
                recorder.withoutBuffering());
        assertTrue(recorder.reported.stream().anyMatch(what -> what.startsWith("buffering")));
    }

    @Test
    void seeksAreToldOnceEach() throws Exception {
        prepare("video.mp4");
        player.seekToAndWait(4000);
        player.seekToAndWait(2000);
        Wait.until("both were reported", () -> recorder.count("seek") == 2);
        player.start();
        player.seekToAndWait(6000);
        Wait.until("the third was reported", () -> recorder.count("seek") == 3);
    }

    @Test
    void theSameMediaTellsAgainAfterReset() throws Exception {
        prepare("silent.mkv");
        recorder.await("size 320x180");
        player.resetAndWait();
        recorder.reported.clear();
        prepare("silent.mkv");
        recorder.await("size 320x180");
        assertEquals(List.of("prepared", "size 320x180"), recorder.withoutBuffering());
    }

    @Test
    void everythingIsToldOnOneDaemonThreadByDefault() throws Exception {
        prepare("silent.mkv");
        player.start();
        player.seekToAndWait(0);
        recorder.await("completion");
        assertEquals(1, recorder.threads.stream().distinct().count());
        assertTrue(recorder.threads.get(0).isDaemon());
        assertFalse(recorder.threads.contains(Thread.currentThread()));
    }

    @Test
    void everythingIsToldByTheExecutorThatWasGiven() throws Exception {
        Thread[] made = new Thread[1];
        ExecutorService executor = Executors.newSingleThreadExecutor(
                work -> made[0] = new Thread(work, "listeners"));
        try (OrvMediaPlayer other = new OrvMediaPlayer(executor)) {
            Recorder second = new Recorder();
            other.addListener(second);
            other.setDataSource(Media.path("silent.mkv"));
            other.prepareAsync();
            second.await("prepared");
            other.start();
            second.await("completion");
            assertEquals(List.of(made[0]), second.threads.stream().distinct().toList());
        }
        executor.shutdown();
    }

    @Test
    void aDirectExecutorMayCallThePlayerFromInside() throws Exception {
        try (OrvMediaPlayer other = new OrvMediaPlayer(Runnable::run)) {
            AtomicBoolean completed = new AtomicBoolean();
            other.addListener(new PlayerListener() {
                @Override
                public void onPrepared(MediaPlayer from) {
                    from.start();
                }

                @Override
                public void onCompletion(MediaPlayer from) {
                    completed.set(true);
                }
            });
            other.setDataSource(Media.path("silent.mkv"));
            other.prepareAsync();
            Wait.until("it played to the end", completed::get);
        }
    }

    @Test
    void listenersMayCallThePlayerAndReleaseIt() throws Exception {
        CountDownLatch released = new CountDownLatch(1);
        Recorder second = new Recorder();
        player.addListener(new PlayerListener() {
            @Override
            public void onPrepared(MediaPlayer from) {
                from.start();
                from.seekToAndWait(0);
                from.setLooping(false);
                from.getCurrentPosition();
            }

            @Override
            public void onCompletion(MediaPlayer from) {
                from.close();
                released.countDown();
            }
        });
        player.addListener(second);
        player.setDataSource(Media.path("silent.mkv"));
        player.prepareAsync();
        assertTrue(released.await(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
        assertEquals(PlayerState.RELEASED, player.getState());
        assertEquals(0, second.count("completion"), "reported after a release that another did");
    }

    @Test
    void nothingIsToldAfterRelease() throws Exception {
        for (int i = 0; i < 20; i++) {
            ExecutorService executor = Executors.newSingleThreadExecutor();
            OrvMediaPlayer other = new OrvMediaPlayer(executor);
            AtomicBoolean released = new AtomicBoolean();
            AtomicInteger late = new AtomicInteger();
            other.addListener(new Recorder() {
                @Override
                public void onBufferingUpdate(MediaPlayer from, int percent) {
                    count();
                }

                @Override
                public void onSeekComplete(MediaPlayer from) {
                    count();
                }

                private void count() {
                    if (released.get()) {
                        late.incrementAndGet();
                    }
                }
            });
            other.setDataSource(Media.path("video.mp4"));
            other.prepareAndWait();
            other.start();
            other.seekToAndWait(2000);
            other.close();
            released.set(true);
            executor.submit(() -> null).get();
            executor.shutdown();
            assertEquals(0, late.get());
        }
    }

    @Test
    void nothingIsToldOfTheOldMediaAfterReset() throws Exception {
        CountDownLatch goOn = new CountDownLatch(1);
        ExecutorService slow = Executors.newSingleThreadExecutor();
        try (OrvMediaPlayer other = new OrvMediaPlayer(slow)) {
            Recorder second = new Recorder();
            slow.submit(() -> goOn.await(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
            other.addListener(second);
            other.setDataSource(Media.path("video.mp4"));
            other.prepareAndWait();
            other.seekToAndWait(4000);
            other.resetAndWait();
            goOn.countDown();
            slow.submit(() -> null).get();
            assertEquals(List.of(), second.reported);
        }
        slow.shutdown();
    }

    @Test
    void aListenerThatThrowsDisturbsNobody() throws Exception {
        AtomicReference<Throwable> caught = new AtomicReference<>();
        ExecutorService executor = Executors.newSingleThreadExecutor(work -> {
            Thread thread = new Thread(work);
            thread.setUncaughtExceptionHandler((t, e) -> caught.set(e));
            return thread;
        });
        try (OrvMediaPlayer other = new OrvMediaPlayer(executor)) {
            Recorder second = new Recorder();
            other.addListener(new PlayerListener() {
                @Override
                public void onPrepared(MediaPlayer from) {
                    throw new IllegalStateException("a listener's own fault");
                }
            });
            other.addListener(second);
            other.setDataSource(Media.path("silent.mkv"));
            other.prepareAndWait();
            second.await("prepared");
            second.await("size 320x180");
            assertEquals("a listener's own fault", caught.get().getMessage());
        }
        executor.shutdown();
    }

    @Test
    void aListenerThatWasTakenOffIsToldNothing() throws Exception {
        Recorder second = new Recorder();
        player.addListener(second);
        player.removeListener(recorder);
        prepare("silent.mkv");
        second.await("prepared");
        assertEquals(List.of(), recorder.reported);
    }

    @Test
    void aListenerThatAnEarlierOneTakesOffIsNotToldOfTheSame() throws Exception {
        Recorder second = new Recorder();
        Recorder third = new Recorder();
        player.addListener(new PlayerListener() {
            @Override
            public void onPrepared(MediaPlayer from) {
                from.removeListener(second);
            }
        });
        player.addListener(second);
        player.addListener(third);
        prepare("silent.mkv");
        third.await("prepared");
        assertEquals(0, second.count("prepared"));
    }

    @Test
    void eventsOfTheNativeHalfAreMergedAndToldOnce() throws Exception {
        prepare("silent.mkv");
        recorder.await("size 320x180");
        post(1, 0, 0, null);
        post(5, 320, 180, null);
        post(4, 0, 0, null);
        post(5, 640, 360, null);
        post(3, 140, 0, null);
        post(200, 3, 7, null);
        post(200, 3, 7, null);
        post(200, 901, 2, null);
        post(99, 0, 0, "Hallo".getBytes(StandardCharsets.UTF_8));
        post(99, 0, 0, null);
        post(4711, 0, 0, null);
        recorder.await("text null");
        assertEquals(
                List.of("prepared", "size 320x180", "size 640x360", "info 3 7", "info 901 2",
                        "text Hallo", "text null"),
                recorder.withoutBuffering());
        assertTrue(recorder.reported.contains("buffering 100"), "140 is shown as 100");
        player.start();
        post(2, 0, 0, null);
        recorder.await("completion");
        assertEquals(PlayerState.COMPLETED, player.getState());
    }

    @Test
    void theNativeHalfsThreadCallsNoListener() throws Exception {
        try (OrvMediaPlayer other = new OrvMediaPlayer(Runnable::run)) {
            other.addListener(recorder);
            post(new WeakReference<>(other), 200, 960, 0, null);
            recorder.await("info 960 0");
            assertFalse(recorder.threads.contains(Thread.currentThread()));
        }
    }

    @Test
    void anErrorOfTheNativeHalfIsToldOnce() throws Exception {
        prepare("silent.mkv");
        post(100, 1, -1004, null);
        post(100, 1, -1004, null);
        recorder.await("error");
        assertEquals(PlayerState.ERROR, player.getState());
        assertEquals(-1004, recorder.error.status());
        post(200, 950, 0, null);
        recorder.await("info 950 0");
        assertEquals(1, recorder.count("error"));
    }

    @Test
    void eventsForAPlayerThatIsGoneAreDropped() throws Exception {
        post(new WeakReference<>(null), 1, 0, 0, null);
        post(null, 1, 0, 0, null);
        post("no reference", 1, 0, 0, null);
        OrvMediaPlayer gone = new OrvMediaPlayer();
        gone.addListener(recorder);
        gone.close();
        post(new WeakReference<>(gone), 200, 951, 0, null);
        post(200, 952, 0, null);
        recorder.await("info 952 0");
        assertEquals(0, recorder.count("info 951 0"));
    }

    @Test
    void aPlayerThatIsDroppedIsCollectedWithItsThread() throws Exception {
        List<String> before = watchingThreads();
        WeakReference<OrvMediaPlayer> dropped = playAndDrop();
        Wait.until("the player was collected", () -> {
            System.gc();
            return dropped.get() == null;
        });
        Wait.until("its thread ended", () -> {
            System.gc();
            List<String> left = watchingThreads();
            left.removeAll(before);
            return left.isEmpty();
        });
    }

    private static WeakReference<OrvMediaPlayer> playAndDrop() throws Exception {
        OrvMediaPlayer player = new OrvMediaPlayer();
        Recorder recorder = new Recorder() {
            @Override
            public void onCompletion(MediaPlayer from) {
                player.getState(); // A listener that holds the player must not keep it.
            }
        };
        player.addListener(recorder);
        player.setDataSource(Media.path("silent.mkv"));
        player.prepareAndWait();
        player.start();
        recorder.await("size 320x180");
        return new WeakReference<>(player);
    }

    private static List<String> watchingThreads() {
        List<String> names = new ArrayList<>();
        for (Thread thread : Thread.getAllStackTraces().keySet()) {
            if (thread.getName().startsWith("OrvMediaPlayer-")) {
                names.add(thread.getName());
            }
        }
        return names;
    }

    private void post(int what, int arg1, int arg2, byte[] payload) throws Exception {
        post(new WeakReference<>(player), what, arg1, arg2, payload);
    }

    /** Calls back as the native half does. */
    private static void post(Object weakPlayer, int what, int arg1, int arg2, byte[] payload)
            throws Exception {
        Method method = OrvMediaPlayer.class.getDeclaredMethod(
                "postEventFromNative", Object.class, int.class, int.class, int.class,
                Object.class);
        method.setAccessible(true);
        method.invoke(null, weakPlayer, what, arg1, arg2, payload);
    }
}
