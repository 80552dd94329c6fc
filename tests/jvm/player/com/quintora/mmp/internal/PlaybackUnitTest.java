// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.PlayerState;
import com.quintora.mmp.ScriptedSource;
import com.quintora.mmp.Wait;
import com.quintora.mmp.internal.events.EndOfMedia;
import java.io.IOException;
import java.util.List;
import java.util.concurrent.CompletionException;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** How a player follows what its engine answers. */
class PlaybackUnitTest {
    private final ScriptedNatives natives = new ScriptedNatives();
    private final PlayerUnits units = natives.units();
    private final EndOfMedia end = new EndOfMedia(natives.natives(), units.source);

    @AfterEach
    void close() {
        units.lifetime.close();
    }

    @Test
    void itPlaysWhileItIsStartedAndTheEngineRuns() throws Exception {
        assertFalse(units.playback.isPlaying());
        natives.answer("isPlaying", () -> true);
        assertFalse(units.playback.isPlaying(), "not without media, whatever the engine says");
        prepare("film.mkv");
        assertFalse(units.playback.isPlaying(), "not before it is started");
        units.playback.start();
        assertTrue(units.playback.isPlaying());
        natives.answer("isPlaying", () -> false);
        natives.answer("getDuration", () -> 1);
        assertFalse(units.playback.isPlaying(), "not while it waits for data");
    }

    @Test
    void positionAndDurationAreZeroWithoutMediaAndOfMediaThatFailed() throws Exception {
        natives.answer("getCurrentPosition", () -> 5);
        natives.answer("getDuration", () -> 9);
        assertEquals(0, units.playback.position());
        assertEquals(0, units.playback.duration());
        prepare("film.mkv");
        assertEquals(5, units.playback.position());
        assertEquals(9, units.playback.duration());
        natives.answer("getCurrentPosition", () -> {
            throw new IOException("gone");
        });
        assertEquals(0, units.playback.position());
    }

    @ParameterizedTest
    @CsvSource({
        "film.mkv, false, 10, 10, true", "film.mkv, true, 10, 10, false",
        "film.mkv, false, 9, 10, false", "film.mkv, false, 0, 0, true",
        "http://h/film, false, 0, 0, false", "http://h/film, false, 10, 10, true"
    })
    void theEndIsWhereTheEngineHaltsAtTheDuration(
            String source, boolean playing, int position, int duration, boolean isEnd) {
        units.source.setName(source);
        natives.answer("isPlaying", () -> playing);
        natives.answer("getCurrentPosition", () -> position);
        natives.answer("getDuration", () -> duration);
        assertEquals(isEnd, end.isReached());
    }

    @Test
    void mediaThatFailIsNotAtItsEnd() {
        natives.answer("getCurrentPosition", () -> {
            throw new IOException("gone");
        });
        assertFalse(end.isReached());
    }

    @Test
    void aStreamThatIsBeingReadIsNotAtItsEnd() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[10]);
        source.misreading(0, source::block);
        units.sources.set(source);
        assertTrue(end.isReached());
        Thread reader = new Thread(() -> units.source.stream().read(1));
        natives.answer("streamBuffer", () -> new byte[1]);
        reader.start();
        Wait.until("the read blocks", source.blockedReads::hasQueuedThreads);
        assertFalse(end.isReached());
        units.source.stream().cancel();
        reader.join();
        assertTrue(end.isReached());
    }

    @Test
    void anEngineThatRefusesAResetIsQuoted() {
        natives.answer("reset", () -> {
            throw new IllegalStateException("busy");
        });
        IllegalStateException thrown =
                assertThrows(IllegalStateException.class, units.lifetime::resetAndWait);
        assertEquals("the engine refused resetAndWait(): busy", thrown.getMessage());
        assertEquals(PlayerState.ERROR, units.states.state());
        Throwable later =
                assertThrows(CompletionException.class, units.lifetime.reset()::join).getCause();
        assertEquals("the engine refused reset(): busy", later.getMessage());
    }

    @ParameterizedTest
    @CsvSource({
        "0.25, 250", "32, 32000", "-32, -32000", "1.0004, 1000", "1.0006, 1001"
    })
    void speedsAreAskedForInThousandths(double speed, int asked) {
        natives.answer("canDoTrick", () -> true);
        natives.answer("canDoSeek", () -> true);
        assertTrue(units.trickPlay.canPlayAt(speed));
        assertTrue(units.trickPlay.canSeekAt(speed));
        assertTrue(natives.lines.contains("canDoTrick[" + asked + "]"), natives.lines.toString());
        assertTrue(natives.lines.contains("canDoSeek[" + asked + "]"), natives.lines.toString());
    }

    @ParameterizedTest
    @CsvSource({"32.01", "-32.01", "NaN", "Infinity"})
    void speedsOutOfRangeAreNotAskedFor(double speed) {
        natives.answer("canDoTrick", () -> true);
        assertFalse(units.trickPlay.canPlayAt(speed));
        assertFalse(natives.calls.contains("canDoTrick"));
    }

    @Test
    void aRepeatedSectionHasThreeCommands() throws Exception {
        prepare("film.mkv");
        natives.answer("setABRepeat", () -> 1);
        assertTrue(units.trickPlay.repeatFromHere());
        assertTrue(units.trickPlay.repeatUntilHere());
        assertTrue(units.trickPlay.repeatOff());
        natives.answer("setABRepeat", () -> 0);
        assertFalse(units.trickPlay.repeatOff());
        assertEquals(4, natives.count("setABRepeat"));
        assertTrue(natives.lines.containsAll(List.of(
                "setABRepeat[1]", "setABRepeat[2]", "setABRepeat[0]")));
    }

    private void prepare(String name) throws IOException {
        units.sources.set(name);
        units.preparation.prepareAndWait();
    }
}
