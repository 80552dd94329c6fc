// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.util.PcmMediaInfo;
import java.io.FileDescriptor;
import java.io.IOException;
import java.util.EnumSet;
import java.util.Map;
import java.util.Set;
import java.util.concurrent.Executor;

/** The part of {@link OrvMediaPlayer} that is told what to play. */
abstract sealed class DataSources extends PlayerCore permits Playback {
    private static final Set<PlayerState> IDLE = EnumSet.of(PlayerState.IDLE);
    private static final String CALL = "setDataSource()";

    DataSources(Executor executor) {
        super(executor);
    }

    /**
     * Plays a file or a URL next. State: IDLE; then INITIALIZED.
     *
     * @param pathOrUrl a file's path, or a URL such as {@code http://host/film.mp4}
     * @throws IllegalArgumentException when it is null
     * @throws MediaException when it is a file that is not there, a directory, or a URL of a
     *     scheme that is not opened
     * @throws SecurityException when the file must not be read
     * @throws IllegalStateException in another state
     */
    public void setDataSource(String pathOrUrl) throws IOException {
        initialize(pathOrUrl, () -> peer.native_setDataSource(required(pathOrUrl)));
    }

    /**
     * Plays a URL next, with headers in every request for it. State: IDLE; then INITIALIZED.
     *
     * @param url the URL
     * @param headers names and values
     * @throws IllegalArgumentException when the URL, the headers, a name or a value is null
     * @throws IOException as {@link #setDataSource(String)}
     * @throws IllegalStateException in another state
     */
    public void setDataSource(String url, Map<String, String> headers) throws IOException {
        Arguments.require(headers, "the headers' map").forEach((name, value) -> {
            Arguments.require(name, "a header's name");
            Arguments.require(value, "the value of the header " + name);
        });
        String[] names = headers.keySet().toArray(String[]::new);
        String[] values = headers.values().toArray(String[]::new);
        initialize(url, () -> peer.native_setDataSource(required(url), names, values));
    }

    /**
     * Plays an open file next. State: IDLE; then INITIALIZED.
     *
     * @param fd an open descriptor; the player keeps one of its own
     * @throws IllegalArgumentException when it is null
     * @throws MediaException when it is not open
     * @throws IllegalStateException in another state
     */
    public void setDataSource(FileDescriptor fd) throws IOException {
        setDataSource(fd, 0, Long.MAX_VALUE);
    }

    /**
     * Plays a part of an open file next. State: IDLE; then INITIALIZED.
     *
     * @param fd an open descriptor; the player keeps one of its own
     * @param offset where the media begins, in bytes
     * @param length how long it is, in bytes; more than there is means up to the end
     * @throws IllegalArgumentException when the descriptor is null
     * @throws MediaException when it is not open, or the offset or length is negative
     * @throws IllegalStateException in another state
     */
    public void setDataSource(FileDescriptor fd, long offset, long length) throws IOException {
        Arguments.require(fd, "the descriptor");
        initialize("the descriptor", () -> peer.native_setDataSource(fd, offset, length));
    }

    /**
     * Plays bytes that the program produces next. State: IDLE; then INITIALIZED. The source is
     * closed at the next reset or release, or by this call when it throws. Blocks while the source
     * describes itself.
     *
     * @param media where the bytes come from
     * @throws IllegalArgumentException when it is null
     * @throws IOException when the source cannot tell its size or its other properties
     * @throws IllegalStateException in another state
     */
    public void setDataSource(MediaStreamSource media) throws IOException {
        StreamAdapter adapter = new StreamAdapter(Arguments.require(media, "the stream source"));
        try {
            initialize("the stream source", () -> {
                adapter.describeTo(peer);
                useStream(adapter);
                peer.native_setDataSourceByInputStream();
            });
        } catch (IOException | RuntimeException | Error e) {
            dropStream(adapter);
            throw e;
        }
    }

    /**
     * Says that the next data source is raw PCM. State: IDLE, before the data source.
     *
     * @param format what the bytes mean
     * @throws IllegalArgumentException when it is null, and naming the value that is out of range
     * @throws IllegalStateException in another state
     */
    public void setPcmFormat(PcmMediaInfo format) {
        Arguments.require(format, "the PCM description").check();
        states.require("setPcmFormat()", IDLE);
        run("setPcmFormat()", () -> {
            peer.native_setPcmMediaInfo(format);
            peer.native_setPcmFlag();
        });
    }

    private void initialize(String name, EngineCall command) throws IOException {
        commands.lock();
        try {
            int epoch = states.require(CALL, IDLE);
            set(name, command);
            nameSource(name);
            if (!states.move(epoch, IDLE, PlayerState.INITIALIZED)) {
                takeBack();
            }
        } finally {
            commands.unlock();
        }
    }

    private void set(String name, EngineCall command) throws IOException {
        try {
            command.run();
        } catch (SecurityException e) {
            throw Failures.denied(name, e);
        } catch (MediaException e) {
            throw e;
        } catch (IOException e) {
            throw Failures.explain(name, e, null);
        } catch (IllegalStateException e) {
            throw refusal(CALL, e);
        }
    }

    /** A reset or release came between: the engine must not keep what the player forgot. */
    private void takeBack() {
        nameSource("");
        try {
            peer.native_reset();
        } catch (IOException | IllegalStateException e) {
            // Released: nothing is kept.
        }
        states.requireAlive(CALL);
        throw new IllegalStateException(CALL + " was ended by a reset");
    }

    private static String required(String pathOrUrl) {
        return Arguments.require(pathOrUrl, "the path or URL");
    }
}
