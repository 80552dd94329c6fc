// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.internal.source.StreamAdapter;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.security.MessageDigest;
import java.util.EnumSet;
import java.util.Set;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;
import org.junit.jupiter.params.provider.ValueSource;

/** Media that the engine pulls from a Java object. */
class StreamSourceTest extends PlayerFixture {
    private static final Set<PlayerState> ENDED =
            EnumSet.of(PlayerState.COMPLETED, PlayerState.ERROR);

    @Test
    void aStreamPlaysToItsEnd() throws Exception {
        ScriptedSource source = source("silent.mkv");
        prepare(source);
        assertEquals(2000, player.getDuration(), 50);
        player.start();
        awaitState(PlayerState.COMPLETED);
        player.close();
        assertEquals(1, source.closes.get());
    }

    @Test
    void theEngineReadsWhatTheFileHolds() throws Exception {
        byte[] file = Files.readAllBytes(Path.of(Media.path("short.ts")));
        MessageDigest digest = MessageDigest.getInstance("SHA-256");
        prepare(new DigestingSource(file, digest));
        player.start();
        awaitState(PlayerState.COMPLETED);
        player.close();
        assertArrayEquals(MessageDigest.getInstance("SHA-256").digest(file), digest.digest());
    }

    @Test
    void aDescriptionFillsEveryFieldThatTheNativeHalfReads() {
        player.mStreamCurPos = 9;
        player.mDataSourceType = 9;
        NativeCalls natives = new NativeCalls(player);
        natives.describeStream(7, true, false, 1234);
        assertFields(7, true, false, 1234);
        natives.describeStream(0, false, true, 0);
        assertFields(0, false, true, 0);
    }

    private void assertFields(long size, boolean seekable, boolean mayStall, long millis) {
        assertEquals(size, player.mStreamSize);
        assertEquals(seekable, player.mStreamSeekable);
        assertEquals(mayStall, player.mStallingSupport);
        assertEquals(millis, player.mStreamDuration);
        assertEquals(0, player.mStreamCurPos, "at its start");
        assertEquals(0, player.mDataSourceType);
    }

    @Test
    void aStreamIsSought() throws Exception {
        prepare(source("video.mp4"));
        player.seekToAndWait(6000);
        assertEquals(6000, player.getCurrentPosition(), 40);
        player.start();
        awaitMoving();
        player.seekToAndWait(2000);
        awaitMoving();
    }

    @ParameterizedTest
    @CsvSource({"true, false", "false, true", "false, false"})
    void streamsOfUnknownSizeOrWithoutSeekingPlay(boolean sizeKnown, boolean seekable)
            throws Exception {
        ScriptedSource source = source("video.ts");
        source.sizeKnown = sizeKnown;
        source.seekable = seekable;
        prepare(source);
        player.start();
        awaitMoving();
    }

    @Test
    void singleBytesPlayToo() throws Exception {
        byte[] file = Files.readAllBytes(Path.of(Media.path("tone.mp3")));
        prepare(new ScriptedSource(file) {
            @Override
            public int read(byte[] buffer, int length) throws IOException {
                return super.read(buffer, reads.get() < 5000 ? 1 : length);
            }
        });
        player.start();
        awaitMoving();
    }

    @Test
    void aFilesChannelPlays() throws Exception {
        player.setDataSource(ChannelStreamSource.open(Path.of(Media.path("silent.mkv"))));
        player.prepareAndWait();
        player.start();
        awaitState(PlayerState.COMPLETED);
    }

    @Test
    void aStoppedStreamIsPreparedAgain() throws Exception {
        ScriptedSource source = source("video.mp4");
        prepare(source);
        player.start();
        player.stop();
        assertEquals(0, source.closes.get());
        player.prepareAndWait();
        player.start();
        awaitMoving();
    }

    @ParameterizedTest
    @ValueSource(ints = {0, -1})
    void aStreamThatEndsEarlyEnds(int count) throws Exception {
        prepare(source("video.ts").misreading(300_000, (buffer, length) -> count));
        player.start();
        awaitEnd();
        assertEquals(PlayerState.COMPLETED, player.getState());
    }

    @ParameterizedTest
    @ValueSource(ints = {-5, Integer.MAX_VALUE})
    void aStreamThatMiscountsFailsWithACause(int count) throws Exception {
        prepare(source("video.ts").misreading(300_000, (buffer, length) -> count));
        player.start();
        recorder.await("error");
        assertEquals(PlayerState.ERROR, player.getState());
        assertEquals(MediaError.IO, recorder.error.error());
        assertTrue(recorder.error.getCause().getMessage().startsWith("the source read " + count),
                recorder.error.toString());
        assertEquals(1, recorder.count("error"));
        assertEquals(0, recorder.count("completion"));
    }

    @Test
    void aStreamThatThrowsInTheMiddleFailsWithItsException() throws Exception {
        IOException torn = new IOException("the tape tore");
        prepare(source("video.ts").misreading(300_000, (buffer, length) -> {
            throw torn;
        }));
        player.start();
        recorder.await("error");
        assertSame(torn, recorder.error.getCause());
        assertEquals("the stream source: the source failed: java.io.IOException: the tape tore",
                recorder.error.getMessage());
    }

    @Test
    void aStreamThatThrowsAtTheStartFailsToPrepare() throws Exception {
        Error broken = new AssertionError("not even a byte");
        player.setDataSource(new ScriptedSource(new byte[100]).misreading(0, (buffer, length) -> {
            throw broken;
        }));
        MediaException e = assertThrows(MediaException.class, player::prepareAndWait);
        assertSame(broken, e.getCause());
        player.resetAndWait();
        prepare("silent.mkv");
    }

    @Test
    void aStreamThatIsNeverPreparedIsClosed() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[100]);
        player.setDataSource(source);
        player.resetAndWait();
        assertEquals(1, source.closes.get());
        ScriptedSource another = new ScriptedSource(new byte[100]);
        player.setDataSource(another);
        player.close();
        assertEquals(1, another.closes.get());
    }

    @Test
    void aStreamThatTheEngineLeavesOpenIsClosed() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[100]);
        // The engine does not know of it.
        player.units.source.use(new StreamAdapter(source, new NativeCalls(player)));
        player.resetAndWait();
        assertEquals(1, source.closes.get());
    }

    @Test
    void aStreamThatIsRefusedIsClosed() throws Exception {
        prepare("silent.mkv");
        ScriptedSource source = new ScriptedSource(new byte[100]);
        assertThrows(IllegalStateException.class, () -> player.setDataSource(source));
        assertEquals(1, source.closes.get());
        assertEquals(0, source.reads.get());
    }

    @Test
    void anEmptyStreamIsNoMedia() throws Exception {
        player.setDataSource(new ScriptedSource(new byte[0]));
        assertThrows(MediaException.class, player::prepareAndWait);
    }

    @Test
    void aStreamThatCannotTellItsSizeIsRefusedAndClosed() throws Exception {
        IOException mute = new IOException("mute");
        ScriptedSource[] source = new ScriptedSource[1];
        MediaException e = assertThrows(MediaException.class,
                () -> player.setDataSource(new MediaStreamSource() {
                    @Override
                    public int read(byte[] buffer, int length) {
                        return -1;
                    }

                    @Override
                    public void seek(long position) {}

                    @Override
                    public long size() throws IOException {
                        throw mute;
                    }

                    @Override
                    public void close() {
                        source[0] = new ScriptedSource(new byte[0]);
                    }
                }));
        assertSame(mute, e.getCause());
        assertTrue(source[0] != null, "the source was not closed");
        assertEquals(PlayerState.IDLE, player.getState());
        prepare("silent.mkv");
    }

    @Test
    void aSeekThatFailsLeavesThePlayerUsable() throws Exception {
        ScriptedSource source = source("video.mp4");
        prepare(source);
        source.failsToSeek = true;
        try {
            player.seekToAndWait(8000);
        } catch (IllegalStateException e) {
            assertTrue(e.getMessage().contains("seekTo(8000)"), e.getMessage());
        }
        player.resetAndWait();
        prepare("silent.mkv");
        player.start();
        awaitMoving();
    }

    @Test
    void aReadThatBlocksIsCancelledByReset() throws Exception {
        ScriptedSource source = source("long.mkv");
        prepare(source);
        source.misreading(0, source::block);
        player.start();
        Wait.until("a read blocks", source.blockedReads::hasQueuedThreads);
        player.resetAndWait();
        assertTrue(source.cancels.get() > 0);
        assertEquals(1, source.closes.get());
        assertEquals(0, recorder.count("error"), "what a cancelled read throws is no failure");
        prepare("silent.mkv");
    }

    @Test
    void aReadThatBlocksIsCancelledByRelease() throws Exception {
        ScriptedSource source = source("long.mkv");
        prepare(source);
        source.misreading(0, source::block);
        player.start();
        Wait.until("a read blocks", source.blockedReads::hasQueuedThreads);
        player.close();
        assertTrue(source.cancels.get() > 0);
        assertEquals(1, source.closes.get());
    }

    private ScriptedSource source(String media) throws Exception {
        return new ScriptedSource(Files.readAllBytes(Path.of(Media.path(media))));
    }

    private void prepare(MediaStreamSource source) throws IOException {
        player.setDataSource(source);
        player.prepareAndWait();
    }

    private void awaitEnd() throws Exception {
        Wait.until("it ended; it was " + player.getState(),
                () -> ENDED.contains(player.getState()));
    }

    /** A source that cannot seek and digests what is read. */
    private static final class DigestingSource extends ScriptedSource {
        private final MessageDigest digest;

        DigestingSource(byte[] bytes, MessageDigest digest) {
            super(bytes);
            this.digest = digest;
            seekable = false;
        }

        @Override
        public synchronized int read(byte[] buffer, int length) throws IOException {
            int count = super.read(buffer, length);
            if (count > 0) {
                digest.update(buffer, 0, count);
            }
            return count;
        }
    }
}
