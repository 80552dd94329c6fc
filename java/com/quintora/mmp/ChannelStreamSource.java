// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.internal.base.Arguments;
import java.io.IOException;
import java.nio.ByteBuffer;
import java.nio.channels.FileChannel;
import java.nio.channels.SeekableByteChannel;
import java.nio.file.Path;
import java.nio.file.StandardOpenOption;

/** Feeds a player from a channel, such as that of a file. Closes the channel when it is closed. */
public final class ChannelStreamSource implements MediaStreamSource {
    private final SeekableByteChannel channel;

    /**
     * A source that begins at the channel's start.
     *
     * @param channel an open channel that nothing else moves
     * @throws IllegalArgumentException when it is null
     */
    public ChannelStreamSource(SeekableByteChannel channel) {
        this.channel = Arguments.require(channel, "the channel");
    }

    /**
     * A source that reads a file.
     *
     * @param file a readable file
     * @return the source
     * @throws IOException when the file cannot be opened
     */
    public static ChannelStreamSource open(Path file) throws IOException {
        return new ChannelStreamSource(FileChannel.open(file, StandardOpenOption.READ));
    }

    @Override
    public int read(byte[] buffer, int length) throws IOException {
        return channel.read(ByteBuffer.wrap(buffer, 0, length));
    }

    @Override
    public void seek(long position) throws IOException {
        channel.position(position);
    }

    @Override
    public long size() throws IOException {
        return channel.size();
    }

    @Override
    public void close() throws IOException {
        channel.close();
    }
}
