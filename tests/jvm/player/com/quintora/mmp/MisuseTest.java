// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.util.PcmMediaInfo;
import java.io.FileDescriptor;
import java.lang.reflect.InvocationTargetException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.Map;
import java.util.Set;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.ExecutionException;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import java.util.concurrent.Future;
import java.util.concurrent.TimeUnit;
import java.util.stream.Stream;
import org.junit.jupiter.api.DynamicTest;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.TestFactory;
import org.junit.jupiter.api.function.Executable;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** Calls in the wrong state, after release, twice, and from several threads. */
class MisuseTest extends PlayerFixture {
    // The calls that stay possible after release.
    private static final Set<String> ALWAYS =
            Set.of("release", "close", "getState", "removeListener");

    @Test
    void callsBeforeTheirStateAreRefusedWithASentence() throws Exception {
        assertRefused("prepareAndWait() was called in the state IDLE", player::prepareAndWait);
        assertRefused("prepareAsync() was called in the state IDLE", player::prepareAsync);
        assertRefused("start() was called in the state IDLE", player::start);
        assertRefused("pause() was called in the state IDLE", player::pause);
        assertRefused("stop() was called in the state IDLE", player::stop);
        assertRefused("seekToAndWait(5) was called in the state IDLE",
                () -> player.seekToAndWait(5));
        assertRefused("seekTo(5) was called in the state IDLE", () -> player.seekTo(5));
        player.setDataSource(Media.path("video.mp4"));
        assertRefused("setDataSource() was called in the state INITIALIZED",
                () -> player.setDataSource("/other"));
        assertRefused("start() was called in the state INITIALIZED", player::start);
        player.prepareAndWait();
        assertRefused("prepareAndWait() was called in the state PREPARED", player::prepareAndWait);
        assertRefused("pause() was called in the state PREPARED", player::pause);
        player.stop();
        assertRefused("start() was called in the state STOPPED", player::start);
        player.prepareAndWait();
        player.start();
        awaitMoving();
    }

    @Test
    void aFailedPlayerCanBeResetAndUsed() throws Exception {
        player.setDataSource(Media.path("garbage.bin"));
        assertThrows(MediaException.class, player::prepareAndWait);
        assertEquals(PlayerState.ERROR, player.getState());
        assertRefused("start() was called in the state ERROR", player::start);
        player.resetAndWait();
        prepare("video.mp4");
        player.start();
        awaitMoving();
    }

    @Test
    void releaseIsPossibleTwiceAndInEveryState() throws Exception {
        player.close();
        player.close();
        player.close();
        assertEquals(PlayerState.RELEASED, player.getState());
        for (String media : new String[] {"video.mp4", "garbage.bin"}) {
            OrvMediaPlayer other = new OrvMediaPlayer();
            other.setDataSource(Media.path(media));
            other.prepareAsync();
            other.close();
            assertEquals(PlayerState.RELEASED, other.getState());
        }
    }

    @TestFactory
    Stream<DynamicTest> everyCallAfterReleaseIsRefused() {
        player.close();
        return Map.of(MediaPlayer.class, player, Tracks.class, player.tracks(),
                        Subtitles.class, player.subtitles(), Pictures.class, player.pictures(),
                        TrickPlay.class, player.trickPlay(), AudioOutput.class, player.audio(),
                        DivxNavigation.class, player.divx(), EngineCommands.class, player.engine())
                .entrySet().stream()
                .flatMap(side -> ownMethods(side.getKey())
                        .map(method -> DynamicTest.dynamicTest(
                                side.getKey().getSimpleName() + "." + method.getName(),
                                () -> assertRefusedAfterRelease(side.getValue(), method))));
    }

    @ParameterizedTest
    @CsvSource({"true, RELEASED", "false, IDLE"})
    void releaseAndResetEndAPrepareThatBlocks(boolean release, PlayerState state)
            throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[10_000]);
        source.misreading(0, source::block);
        player.setDataSource(source);
        ExecutorService other = Executors.newSingleThreadExecutor();
        Future<?> preparing = other.submit(() -> {
            player.prepareAndWait();
            return null;
        });
        Wait.until("the engine reads", () -> source.reads.get() > 0);
        if (release) {
            player.close();
        } else {
            player.resetAndWait();
        }
        Throwable thrown = causeOf(preparing);
        assertEquals(MediaException.class, thrown.getClass(), thrown.toString());
        assertEquals("the stream source: reset or released while it was being opened",
                thrown.getMessage());
        assertEquals(state, player.getState());
        assertEquals(1, source.closes.get());
        other.shutdown();
    }

    @Test
    void resetEndsAnAsynchronousPrepare() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[10_000]);
        source.misreading(0, source::block);
        player.setDataSource(source);
        player.prepareAsync();
        Wait.until("the engine reads", () -> source.reads.get() > 0);
        player.resetAndWait();
        assertEquals(PlayerState.IDLE, player.getState());
        prepare("video.mp4");
        assertEquals(0, recorder.count("error"));
    }

    @Test
    void threadsThatCallAtTheSameTimeDoNotDisturbEachOther() throws Exception {
        prepare("video.mp4");
        player.setLooping(true);
        ExecutorService callers = Executors.newFixedThreadPool(4);
        Future<?>[] calls = Stream.<Runnable>of(
                        player::start, player::getCurrentPosition,
                        () -> player.seekToAndWait(2000), () -> player.tracks().audio())
                .map(call -> callers.submit(() -> repeat(25, call)))
                .toArray(Future<?>[]::new);
        for (Future<?> call : calls) {
            call.get();
        }
        callers.shutdown();
        assertEquals(PlayerState.STARTED, player.getState());
        awaitMoving();
    }

    @Test
    void releaseDuringCallsOfOtherThreadsEndsThem() throws Exception {
        prepare("video.mp4");
        player.start();
        List<Runnable> calls = List.of(player::getCurrentPosition, player::getDuration,
                player::getVideoWidth, player::isPlaying, player::start,
                () -> player.seekToAndWait(2000), () -> player.setLooping(true),
                () -> player.tracks().audio(), () -> player.trickPlay().getSpeed());
        ExecutorService callers = Executors.newFixedThreadPool(calls.size());
        CountDownLatch called = new CountDownLatch(calls.size());
        List<Future<?>> running = new ArrayList<>();
        for (Runnable call : calls) {
            running.add(callers.submit(() -> {
                call.run();
                called.countDown();
                repeat(Integer.MAX_VALUE, call);
            }));
        }
        assertTrue(called.await(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
        player.close();
        for (Future<?> one : running) {
            Throwable thrown = causeOf(one);
            assertEquals(IllegalStateException.class, thrown.getClass(), thrown.toString());
            assertTrue(thrown.getMessage() != null
                    && thrown.getMessage().endsWith(" was called after the player was released"),
                    thrown.toString());
        }
        callers.shutdown();
    }

    @Test
    void callsThatAReleaseOvertakesHaveASentence() {
        player.native_release(); // As by another thread, between a call's look and the engine's.
        assertRefused("the engine refused getVideoWidth()", player::getVideoWidth);
        assertRefused("the engine refused isLooping()", player::isLooping);
        assertRefused("the engine refused setLooping()", () -> player.setLooping(true));
        assertRefused("the engine refused setSurface()", () -> player.setSurface(null));
    }

    private static Throwable causeOf(Future<?> call) {
        return assertThrows(ExecutionException.class,
                () -> call.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS)).getCause();
    }

    private static void repeat(int times, Runnable call) {
        for (int i = 0; i < times; i++) {
            call.run();
        }
    }

    // Methods with a default call others, which refuse by themselves.
    private static Stream<Method> ownMethods(Class<?> type) {
        return Arrays.stream(type.getMethods())
                .filter(method -> Modifier.isAbstract(method.getModifiers()))
                .filter(method -> !ALWAYS.contains(method.getName()))
                .filter(method -> !isAccessor(method));
    }

    // tracks(), subtitles() and the like hand out objects, which refuse by themselves.
    private static boolean isAccessor(Method method) {
        return method.getDeclaringClass() == MediaPlayer.class
                && method.getReturnType().getPackage() == OrvMediaPlayer.class.getPackage()
                && method.getParameterCount() == 0;
    }

    private static void assertRefusedAfterRelease(Object object, Method method) throws Exception {
        Object[] arguments = Arrays.stream(method.getParameterTypes())
                .map(MisuseTest::argument)
                .toArray();
        InvocationTargetException thrown = assertThrows(
                InvocationTargetException.class, () -> method.invoke(object, arguments));
        assertEquals(IllegalStateException.class, thrown.getCause().getClass(),
                thrown.getCause().toString());
        String message = thrown.getCause().getMessage();
        assertTrue(message.endsWith(" was called after the player was released"), message);
        assertTrue(message.startsWith(method.getName() + "("), message);
    }

    private static Object argument(Class<?> type) {
        Map<Class<?>, Object> values = Map.of(
                int.class, 1, long.class, 1L, float.class, 1f, double.class, 1.0,
                boolean.class, true,
                String.class, "x",
                Map.class, Map.of(),
                Set.class, Set.of(),
                FileDescriptor.class, FileDescriptor.in);
        if (values.containsKey(type)) {
            return values.get(type);
        }
        return type.isEnum() ? type.getEnumConstants()[0] : Values.of(type);
    }

    /** Objects that the calls take. */
    private static final class Values {
        static Object of(Class<?> type) {
            if (type == MediaStreamSource.class) {
                return new ScriptedSource(new byte[0]);
            }
            if (type == PlayerListener.class) {
                return new Recorder();
            }
            if (type == PcmMediaInfo.class) {
                return PcmMediaInfo.of(48_000, 2, 16);
            }
            if (type == SubtitleAttr.class) {
                return SubtitleAttr.builder().build();
            }
            return null;
        }
    }

    private void assertRefused(String beginning, Executable call) {
        PlayerState before = player.getState();
        String message = assertThrows(IllegalStateException.class, call).getMessage();
        assertTrue(message.startsWith(beginning), message);
        assertEquals(before, player.getState());
        assertFalse(message.isBlank());
        assertNotEquals(PlayerState.RELEASED, player.getState());
    }
}
