// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.internal.source.StreamAdapter;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;
import org.junit.jupiter.params.provider.ValueSource;

/** Streams that stall, break off or come at the wrong time. */
class StreamTroubleTest extends PlayerFixture {
    private static final String WAITS = "info 701 0";
    private static final String GOES_ON = "info 702 0";

    @ParameterizedTest
    @CsvSource({"long.mkv, true, 500000", "video.ts, false, 500000", "tone.mp3, false, 30000"})
    void aStreamMayStallAndGoOn(String media, boolean sizeKnown, int stallsAt) throws Exception {
        ScriptedSource source = new ScriptedSource(Files.readAllBytes(Path.of(Media.path(media)))) {
            @Override
            public boolean mayStall() {
                return true;
            }
        };
        source.sizeKnown = sizeKnown;
        source.seekable = sizeKnown;
        source.misreading(stallsAt, (buffer, length) -> {
            source.blockedReads.acquireUninterruptibly();
            source.misreadFrom = Integer.MAX_VALUE;
            return source.read(buffer, length);
        });
        prepare(source);
        player.start();
        recorder.await(WAITS);
        assertEquals(PlayerState.STARTED, player.getState());
        source.blockedReads.release();
        recorder.await(GOES_ON);
        awaitMoving();
        assertEquals(PlayerState.STARTED, player.getState());
        assertEquals(0, recorder.count("completion"));
    }

    @Test
    void aStreamOfUnknownLengthEnds() throws Exception {
        ScriptedSource source = source("short.ts");
        source.sizeKnown = false;
        source.seekable = false;
        prepare(source);
        player.start();
        recorder.await("completion");
        assertEquals(player.getDuration(), player.getCurrentPosition());
    }

    @ParameterizedTest
    @ValueSource(booleans = {false, true})
    void aStillPictureWithoutALengthEnds(boolean stream) throws Exception {
        if (stream) {
            ScriptedSource source = source("still.png");
            source.sizeKnown = false;
            prepare(source);
        } else {
            prepare("still.png");
        }
        assertEquals(0, player.getDuration());
        player.start();
        recorder.await("completion");
    }

    @Test
    void aStreamThatIsReadHasNotEnded() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[10]);
        source.misreading(0, source::block);
        StreamAdapter adapter = new StreamAdapter(source, new NativeCalls(player));
        adapter.describe();
        assertFalse(adapter.isReading());
        Thread reader = new Thread(() -> adapter.read(1));
        reader.start();
        Wait.until("the read blocks", source.blockedReads::hasQueuedThreads);
        assertTrue(adapter.isReading());
        adapter.cancel();
        reader.join(Wait.LIMIT.toMillis());
        assertFalse(adapter.isReading());
    }

    @Test
    void aRefusedStreamLeavesTheOneThatPlays() throws Exception {
        ScriptedSource playing = source("long.mkv");
        prepare(playing);
        player.start();
        ScriptedSource refused = new ScriptedSource(new byte[100]);
        assertThrows(IllegalStateException.class, () -> player.setDataSource(refused));
        assertEquals(1, refused.closes.get());
        int reads = playing.reads.get();
        player.seekToAndWait(50_000);
        awaitMoving();
        assertTrue(playing.reads.get() > reads, "it is read on");
        assertEquals(0, playing.closes.get());
        player.close();
        assertEquals(1, playing.closes.get());
    }

    @Test
    void aFailureOfHaltedMediaIsTold() throws Exception {
        ScriptedSource source = source("long.mkv");
        prepare(source);
        player.start();
        awaitMoving();
        player.pause();
        IOException torn = new IOException("the tape tore");
        source.misreading(0, (buffer, length) -> {
            throw torn;
        });
        try {
            player.seekToAndWait(55_000);
        } catch (IllegalStateException e) {
            assertTrue(e.getMessage().contains("seekToAndWait(55000)"), e.getMessage());
        }
        recorder.await("error");
        assertEquals(PlayerState.ERROR, player.getState());
        assertSame(torn, recorder.error.getCause());
    }

    @Test
    void aResetWhileTheSourceDescribesItselfWins() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[100]) {
            @Override
            public boolean mayStall() {
                reset();
                return false;
            }
        };
        IllegalStateException e = assertThrows(
                IllegalStateException.class, () -> player.setDataSource(source));
        assertEquals("setDataSource() was ended by a reset", e.getMessage());
        assertEquals(PlayerState.IDLE, player.getState());
        assertEquals(1, source.closes.get());
        prepare("silent.mkv");
    }

    @Test
    void aReleaseWhileTheSourceDescribesItselfWins() {
        ScriptedSource source = new ScriptedSource(new byte[100]) {
            @Override
            public boolean mayStall() {
                player.close();
                return false;
            }
        };
        IllegalStateException e = assertThrows(
                IllegalStateException.class, () -> player.setDataSource(source));
        assertEquals("setDataSource() was called after the player was released", e.getMessage());
        assertEquals(1, source.closes.get());
    }

    private void reset() {
        try {
            player.resetAndWait();
        } catch (IOException e) {
            throw new AssertionError(e);
        }
    }

    private ScriptedSource source(String media) throws Exception {
        return new ScriptedSource(Files.readAllBytes(Path.of(Media.path(media))));
    }

    private void prepare(MediaStreamSource source) throws IOException {
        player.setDataSource(source);
        player.prepareAndWait();
    }
}
