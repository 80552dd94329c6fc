// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.MediaStreamSource;
import java.io.IOException;
import java.nio.ByteBuffer;
import java.nio.channels.ClosedChannelException;
import java.nio.channels.FileChannel;

/** Feeds a player from a pipe or socket, once. */
final class PipeSource implements MediaStreamSource {
    private final FileChannel pipe;

    PipeSource(FileChannel pipe) {
        this.pipe = pipe;
    }

    @Override
    public int read(byte[] buffer, int length) throws IOException {
        try {
            return pipe.read(ByteBuffer.wrap(buffer, 0, length));
        } catch (ClosedChannelException e) {
            return -1;
        }
    }

    @Override
    public boolean isSeekable() {
        return false;
    }

    @Override
    public void seek(long position) throws IOException {
        throw new IOException("a pipe cannot be sought");
    }

    @Override
    public long size() {
        return -1;
    }

    /** Ends the read that blocks; nothing could be read again anyway. */
    @Override
    public void cancel() {
        close();
    }

    @Override
    public void close() {
        try {
            pipe.close();
        } catch (IOException e) {
            // It was only read from.
        }
    }
}
