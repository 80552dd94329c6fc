// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.source;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaStreamSource;
import com.quintora.mmp.ScriptedSource;
import com.quintora.mmp.Wait;
import com.quintora.mmp.internal.base.SharedFields;
import java.io.IOException;
import java.util.Arrays;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;
import org.junit.jupiter.params.provider.ValueSource;

/** A source as the native half calls it. */
class StreamAdapterTest {
    private final Fields fields = new Fields();
    private final ScriptedSource source = new ScriptedSource(new byte[1000]);
    private final StreamAdapter adapter = new StreamAdapter(source, fields);

    @BeforeEach
    void describe() throws IOException {
        for (int i = 0; i < source.bytes.length; i++) {
            source.bytes[i] = (byte) i;
        }
        adapter.describe();
    }

    @Test
    void theDescriptionStandsInThePlayersFields() throws IOException {
        MediaStreamSource described = new ScriptedSource(new byte[7]) {
            @Override
            public long durationMillis() {
                return 1234;
            }

            @Override
            public boolean mayStall() {
                return true;
            }
        };
        new StreamAdapter(described, fields).describe();
        assertEquals(7, fields.size);
        assertEquals(1234, fields.durationMillis);
        assertTrue(fields.mayStall);
        assertTrue(fields.seekable);
        source.seekable = false;
        adapter.describe();
        assertFalse(fields.seekable);
        assertFalse(fields.mayStall);
    }

    @ParameterizedTest
    @CsvSource({"-1, 0", "0, 0", "4294967294, 4294967294", "4294967295, 0", "5000000000, 0"})
    void aSizeThatTheNativeHalfCannotCarryIsUnknown(long size, long field) throws IOException {
        new StreamAdapter(new ScriptedSource(new byte[0]) {
            @Override
            public long size() {
                return size;
            }
        }, fields).describe();
        assertEquals(field, fields.size);
    }

    @Test
    void readsFillThePlayersBufferAndMoveItsPosition() {
        assertEquals(300, adapter.read(300));
        assertArrayEquals(
                Arrays.copyOf(source.bytes, 300), Arrays.copyOf(fields.buffer, 300));
        assertEquals(300, fields.position);
        assertEquals(700, adapter.read(4096), "what is left");
        assertEquals(4096, fields.buffer.length, "grown to what was asked");
        assertEquals(0, adapter.read(1), "the end");
        assertEquals(1000, fields.position);
        assertNull(adapter.failure());
    }

    @ParameterizedTest
    @ValueSource(ints = {-2, -5, Integer.MIN_VALUE, 101, Integer.MAX_VALUE})
    void countsThatCannotBeAreFailures(int count) {
        source.misreading(0, (buffer, length) -> count);
        assertEquals(-1, adapter.read(100));
        assertEquals(0, fields.position);
        assertEquals("the source read " + count + " bytes of 100",
                adapter.failure().getMessage());
    }

    @ParameterizedTest
    @ValueSource(ints = {0, -1})
    void zeroAndMinusOneAreTheEnd(int count) {
        source.misreading(0, (buffer, length) -> count);
        assertEquals(0, adapter.read(100));
        assertNull(adapter.failure());
    }

    @Test
    void nothingThatASourceThrowsGetsThrough() {
        Error first = new StackOverflowError("deep");
        source.misreading(0, (buffer, length) -> {
            throw first;
        });
        assertEquals(-1, adapter.read(100));
        source.failsToSeek = true;
        assertEquals(-1, adapter.seek(0, 5));
        assertSame(first, adapter.failure(), "the first is remembered");
    }

    @Test
    void nothingThatADescriptionThrowsGetsThrough() {
        Error mute = new AssertionError("mute");
        StreamAdapter described = new StreamAdapter(new ScriptedSource(new byte[10]) {
            @Override
            public boolean isSeekable() {
                throw mute;
            }

            @Override
            public int seekType() {
                throw mute;
            }
        }, fields);
        assertEquals(0, described.seekType(), "by bytes");
        assertSame(mute, described.failure());
        assertEquals(-1, described.seek(0, 5));
    }

    @ParameterizedTest
    @CsvSource({
        "0, 0, 0", "0, 999, 999", "0, 1000, 1000", "0, -1, -1",
        "1, 0, 100", "1, 5, 105", "1, -100, 0", "1, -101, -1",
        "2, 0, 1000", "2, -1000, 0", "2, -1001, -1",
        "3, 0, -1", "-1, 0, -1"
    })
    void offsetsCountFromTheStartThePositionOrTheEnd(int type, long offset, long target) {
        assertEquals(100, adapter.read(100));
        assertEquals(target, adapter.seek(type, offset));
        assertEquals(target < 0 ? 100 : target, fields.position);
        int next = adapter.read(1);
        assertEquals(target == 1000 ? 0 : 1, next);
    }

    @Test
    void theEndOfASourceOfUnknownSizeCannotBeSought() throws IOException {
        source.sizeKnown = false;
        adapter.describe();
        assertEquals(-1, adapter.seek(2, 0));
    }

    @Test
    void aSourceThatCannotSeekStaysWhereItIs() {
        source.seekable = false;
        assertEquals(10, adapter.read(10));
        assertEquals(10, adapter.seek(1, 0), "asking where it is moves nothing");
        assertEquals(-1, adapter.seek(0, 0));
        assertEquals(10, fields.position);
    }

    @Test
    void aFailedSeekLeavesThePosition() {
        assertEquals(10, adapter.read(10));
        source.failsToSeek = true;
        assertEquals(-1, adapter.seek(0, 500));
        assertEquals(10, fields.position);
        assertEquals("the reel is stuck", adapter.failure().getMessage());
    }

    @Test
    void whatACancelledReadThrowsIsNoFailure() throws Exception {
        source.misreading(0, source::block);
        Thread reader = new Thread(() -> adapter.read(10));
        reader.start();
        Wait.until("the read began", () -> source.reads.get() == 1);
        adapter.cancel();
        reader.join(Wait.LIMIT.toMillis());
        assertFalse(reader.isAlive());
        assertNull(adapter.failure());
        source.misread = (buffer, length) -> {
            throw new IOException("a real one");
        };
        assertEquals(-1, adapter.read(10));
        assertEquals("a real one", adapter.failure().getMessage());
    }

    @Test
    void closingHappensOnceAndEndsTheMedia() {
        adapter.close();
        adapter.close();
        assertEquals(1, source.closes.get());
        assertEquals(0, adapter.read(10));
        assertEquals(-1, adapter.seek(0, 5));
        assertEquals(-1, adapter.seekTime(1, 2));
    }

    @Test
    void timeSeeksArePassedOn() throws IOException {
        assertEquals(-1, adapter.seekTime(1, 2), "sources cannot by default");
        StreamAdapter timed = new StreamAdapter(new ScriptedSource(new byte[0]) {
            @Override
            public long seekTime(long first, long second) {
                return first * 10 + second;
            }

            @Override
            public int seekType() {
                return 42;
            }
        }, fields);
        timed.describe();
        assertEquals(12, timed.seekTime(1, 2));
        assertEquals(12, fields.position);
        assertEquals(42, timed.seekType());
    }

    @Test
    void aSourceThatCannotDescribeItselfIsRefused() {
        StreamAdapter mute = new StreamAdapter(new ScriptedSource(new byte[0]) {
            @Override
            public long size() {
                throw new IllegalStateException("mute");
            }
        }, fields);
        MediaException e = assertThrows(MediaException.class, mute::describe);
        assertEquals("the stream source cannot describe itself:"
                + " java.lang.IllegalStateException: mute", e.getMessage());
    }

    /** What the native half would read. */
    private static final class Fields implements SharedFields {
        private long size;
        private boolean seekable;
        private boolean mayStall;
        private long durationMillis;
        private long position;
        private byte[] buffer = {};

        @Override
        public void describeStream(
                long newSize, boolean isSeekable, boolean stalls, long newDurationMillis) {
            size = newSize;
            seekable = isSeekable;
            mayStall = stalls;
            durationMillis = newDurationMillis;
            position = 0;
        }

        @Override
        public byte[] streamBuffer(int length) {
            buffer = buffer.length < length ? new byte[length] : buffer;
            return buffer;
        }

        @Override
        public void dropStreamBuffer() {
            buffer = new byte[0];
        }

        @Override
        public void setStreamPosition(long newPosition) {
            position = newPosition;
        }

        @Override
        public void forgetSurface() {
            throw new AssertionError("a stream has no surface");
        }
    }
}
