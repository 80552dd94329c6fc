// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static com.quintora.mmp.testing.FakeState.requireValue;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaStreamSource;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.util.PcmMediaInfo;
import java.io.FileDescriptor;
import java.io.IOException;
import java.util.EnumSet;
import java.util.Map;
import java.util.Set;
import org.jetbrains.annotations.Nullable;

/** Remembers what is played. Any source will do, as the media is the test's. Thread-safe. */
final class FakeSources {
    private static final Set<PlayerState> IDLE = EnumSet.of(PlayerState.IDLE);
    private static final String CALL = "setDataSource()";

    private final FakeSession session;
    private String name = "";
    private Map<String, String> headers = Map.of();
    private @Nullable MediaStreamSource stream;
    private @Nullable MediaError nextFailure;

    FakeSources(FakeSession session) {
        this.session = session;
    }

    String name() {
        return name;
    }

    Map<String, String> headers() {
        return headers;
    }

    void failNext(MediaError error) {
        nextFailure = error;
    }

    void set(@Nullable String pathOrUrl) throws MediaException {
        set(pathOrUrl, Map.of(), "the path or URL");
    }

    void set(@Nullable String url, @Nullable Map<String, String> given) throws MediaException {
        requireValue(given, "the headers' map").forEach((key, value) -> {
            requireValue(key, "a header's name");
            requireValue(value, "the value of the header " + key);
        });
        set(url, Map.copyOf(given), "the path or URL");
    }

    void set(@Nullable FileDescriptor descriptor, long offset, long length)
            throws MediaException {
        requireValue(descriptor, "the descriptor");
        session.guard.run(() -> {
            session.state.require(CALL, IDLE);
            if (!descriptor.valid() || offset < 0 || length < 0) {
                throw FakeFailures.media("the descriptor", MediaError.BAD_VALUE);
            }
            accept("the descriptor", Map.of());
        });
    }

    void set(@Nullable MediaStreamSource source) throws IOException {
        requireValue(source, "the stream source");
        try {
            session.guard.run(() -> {
                session.state.require(CALL, IDLE);
                describe(source);
                accept("the stream source", Map.of());
                stream = source;
            });
        } catch (IOException | RuntimeException e) {
            close(source);
            throw e;
        }
    }

    void setPcmFormat(@Nullable PcmMediaInfo format) {
        requireValue(format, "the PCM description").check();
        session.guard.run(() -> session.state.require("setPcmFormat()", IDLE));
    }

    /** Under the guard; the source is closed when that is given up. */
    void forget() {
        MediaStreamSource old = stream;
        stream = null;
        name = "";
        headers = Map.of();
        if (old != null) {
            session.guard.later(() -> close(old));
        }
    }

    private void set(@Nullable String source, Map<String, String> given, String what)
            throws MediaException {
        session.guard.run(() -> {
            session.state.require(CALL, IDLE);
            accept(requireValue(source, what), given);
        });
    }

    private void accept(String source, Map<String, String> given) throws MediaException {
        MediaError failure = nextFailure;
        nextFailure = null;
        if (failure != null) {
            throw FakeFailures.media(source, failure);
        }
        name = source;
        headers = given;
        session.state.set(PlayerState.INITIALIZED);
    }

    private static void describe(MediaStreamSource source) throws MediaException {
        try {
            source.size();
            source.isSeekable();
        } catch (IOException | RuntimeException e) {
            throw new MediaException(
                    "the stream source cannot describe itself: " + e, MediaError.IO, e);
        }
    }

    private static void close(MediaStreamSource source) {
        try {
            source.close();
        } catch (IOException | RuntimeException e) {
            // The player goes on regardless.
        }
    }
}
