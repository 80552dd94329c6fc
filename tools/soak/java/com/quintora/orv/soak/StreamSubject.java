// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.MediaStreamSource;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.EnumSet;

/** Media that this program feeds, up to a byte at which it may fail or block. */
final class StreamSubject extends Subject {
    /** What happens at the byte. */
    enum Trouble { NONE, FAILS, BLOCKS }

    private final byte[] bytes;
    private final Trouble trouble;
    private final int troubleAt;

    private StreamSubject(Path media, byte[] bytes, Trouble trouble, int troubleAt,
            Expectation expectation) {
        super("stream that " + (trouble == Trouble.NONE ? "works" : trouble.name().toLowerCase()),
                media.getFileName() + " at " + troubleAt, expectation);
        this.bytes = bytes;
        this.trouble = trouble;
        this.troubleAt = troubleAt;
    }

    static StreamSubject of(Path media) throws IOException {
        return new StreamSubject(
                media, Files.readAllBytes(media), Trouble.NONE, 0, Expectation.WELL);
    }

    /** The failure ends what is played, at once or when it comes to that byte. */
    static StreamSubject failing(Path media, double part) throws IOException {
        byte[] bytes = Files.readAllBytes(media);
        return new StreamSubject(media, bytes, Trouble.FAILS, (int) (bytes.length * part),
                Expectation.playing(EnumSet.of(MediaError.IO, MediaError.UNKNOWN,
                        MediaError.MALFORMED, MediaError.NOTHING_INSIDE, MediaError.CUT_SHORT)));
    }

    /** Reads block until the player cancels them, which its release must. */
    static StreamSubject blocking(Path media, double part) throws IOException {
        byte[] bytes = Files.readAllBytes(media);
        return new StreamSubject(media, bytes, Trouble.BLOCKS, (int) (bytes.length * part),
                Expectation.perhaps(EnumSet.of(MediaError.IO, MediaError.TIMED_OUT,
                        MediaError.CUT_SHORT, MediaError.MALFORMED, MediaError.NOTHING_INSIDE)));
    }

    @Override
    void open(MediaPlayer player) throws IOException {
        player.setDataSource(new Source());
    }

    @Override
    boolean mayBeForgotten() {
        return false;
    }

    boolean blocks() {
        return trouble == Trouble.BLOCKS;
    }

    private final class Source implements MediaStreamSource {
        private int position;
        private boolean cancelled;

        @Override
        public synchronized int read(byte[] buffer, int length) throws IOException {
            if (trouble != Trouble.NONE && position + length > troubleAt) {
                fail();
            }
            int count = Math.min(length, bytes.length - position);
            if (count <= 0) {
                return -1;
            }
            System.arraycopy(bytes, position, buffer, 0, count);
            position += count;
            return count;
        }

        private void fail() throws IOException {
            if (trouble == Trouble.FAILS) {
                throw new IOException("the stream fails at " + troubleAt);
            }
            try {
                while (!cancelled) {
                    wait();
                }
            } catch (InterruptedException e) {
                Thread.currentThread().interrupt();
            }
            cancelled = false;
            throw new IOException("the read was cancelled");
        }

        @Override
        public synchronized void seek(long to) {
            position = (int) to;
        }

        @Override
        public long size() {
            return bytes.length;
        }

        @Override
        public synchronized void cancel() {
            cancelled = true;
            notifyAll();
        }
    }
}
