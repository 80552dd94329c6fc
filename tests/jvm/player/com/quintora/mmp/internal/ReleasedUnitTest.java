// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import com.quintora.mmp.ColorMode;
import com.quintora.mmp.Track;
import com.quintora.mmp.Wait;
import java.util.Set;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.CompletionException;
import java.util.concurrent.CountDownLatch;
import java.util.stream.Stream;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.DynamicTest;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.TestFactory;
import org.junit.jupiter.api.function.Executable;

/** A state in which a call is not possible counts before its arguments. */
class ReleasedUnitTest {
    private static final String RELEASED = "() was called after the player was released";

    private final ScriptedNatives natives = new ScriptedNatives();
    private final PlayerUnits units = natives.units();

    @AfterEach
    void close() {
        units.lifetime.close();
    }

    @TestFactory
    Stream<DynamicTest> badArgumentsAfterRelease() {
        units.lifetime.close();
        return Stream.of(
                refused("setVolume", () -> units.audio.setVolume(-1, 2)),
                refused("setSessionId", () -> units.audio.setSessionId(-1)),
                refused("setAuxEffectSendLevel", () -> units.audio.setAuxEffectSendLevel(2)),
                refused("setStyle", () -> units.subtitles.setStyle(null)),
                refused("setTransportStream", () -> units.engine.setTransportStream(-1)),
                refused("setMetadataFilter",
                        () -> units.engine.setMetadataFilter(null, Set.of())),
                refused("thumbnail", () -> units.pictures.thumbnail(0, 0, ColorMode.ABGR8888)),
                refused("thumbnailAndWait",
                        () -> units.pictures.thumbnailAndWait(0, 0, ColorMode.ABGR8888)),
                refused("addListener", () -> units.events.addListener(null)),
                refused("setSpeed", () -> units.trickPlay.setSpeed(33)),
                refused("seekToByte", () -> units.trickPlay.seekToByte(-1)),
                refused("seekToByteAndWait", () -> units.trickPlay.seekToByteAndWait(-1)),
                refused("selectNoneAndWait",
                        () -> units.tracks.selectNoneAndWait(Track.Kind.VIDEO)),
                refused("currentIndex", () -> units.tracks.currentIndex(null)));
    }

    private static DynamicTest refused(String name, Executable call) {
        return DynamicTest.dynamicTest(name, () -> assertEquals(name + RELEASED,
                assertThrows(IllegalStateException.class, call).getMessage()));
    }

    @TestFactory
    Stream<DynamicTest> callsThatNeedMediaWithoutThem() {
        return Stream.of(
                idle("setSpeed", () -> units.trickPlay.setSpeed(33)),
                idle("stepAndWait", () -> units.trickPlay.stepAndWait(1)),
                idle("getBytePosition", units.trickPlay::getBytePosition),
                idle("seekToByte", () -> units.trickPlay.seekToByte(-1)),
                idle("seekToByteAndWait", () -> units.trickPlay.seekToByteAndWait(-1)),
                idle("repeatFromHere", units.trickPlay::repeatFromHere),
                idle("repeatUntilHere", units.trickPlay::repeatUntilHere),
                idle("repeatOff", units.trickPlay::repeatOff),
                idle("selectNoneAndWait",
                        () -> units.tracks.selectNoneAndWait(Track.Kind.VIDEO)));
    }

    private DynamicTest idle(String name, Executable call) {
        return DynamicTest.dynamicTest(name, () -> {
            String message = assertThrows(IllegalStateException.class, call).getMessage();
            String beginning = name + "() was called in the state IDLE";
            assertEquals(beginning, message.substring(0, beginning.length()), message);
            assertEquals(0, natives.calls.size(), natives.calls.toString());
        });
    }

    @Test
    void aMutedPlayerTakesNoVolumeAfterRelease() {
        units.audio.setMuted(true);
        units.lifetime.close();
        assertEquals("setVolume" + RELEASED, assertThrows(IllegalStateException.class,
                () -> units.audio.setVolume(1, 1)).getMessage());
    }

    @Test
    void aSourceThatAReleaseOvertakesIsRefusedAsReleased() {
        natives.answer("setDataSource", () -> {
            units.lifetime.close();
            return null;
        });
        assertEquals("setDataSource" + RELEASED, assertThrows(IllegalStateException.class,
                () -> units.sources.set("film.mkv")).getMessage());
    }

    @Test
    void whatWaitsInTheBackgroundEndsWithThePlayer() throws Exception {
        units.sources.set("film.mkv");
        units.preparation.prepareAndWait();
        CountDownLatch go = new CountDownLatch(1);
        natives.answer("step", () -> {
            go.await();
            return null;
        });
        units.trickPlay.step(1);
        Wait.until("the first runs", () -> natives.count("step") == 1);
        CompletableFuture<Void> waiting = units.trickPlay.step(2);
        units.lifetime.close();
        go.countDown();
        Throwable thrown = assertThrows(CompletionException.class, waiting::join).getCause();
        assertEquals("step" + RELEASED, thrown.getMessage());
    }
}
