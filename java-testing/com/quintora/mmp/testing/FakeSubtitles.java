// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static com.quintora.mmp.testing.FakeState.requireValue;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.Subtitles;
import java.nio.file.Path;
import java.util.concurrent.CompletableFuture;
import org.jetbrains.annotations.Nullable;

/** Adds a track for each file of subtitles, which is not read. */
final class FakeSubtitles implements Subtitles {
    private final FakeSession session;
    private final FakeTables tables;
    private @Nullable MediaError nextFailure;
    private @Nullable SubtitleAttr style;

    FakeSubtitles(FakeSession session, FakeTables tables) {
        this.session = session;
        this.tables = tables;
    }

    void failNext(MediaError error) {
        nextFailure = error;
    }

    @Nullable SubtitleAttr style() {
        return style;
    }

    @Override
    public CompletableFuture<SubtitleTrack> add(String pathOrUrl) {
        required(pathOrUrl);
        return future("add()", pathOrUrl, true);
    }

    @Override
    public CompletableFuture<SubtitleTrack> addPair(String pictures, String index) {
        required(pictures, index);
        return future("addPair()", index, true);
    }

    @Override
    public CompletableFuture<SubtitleTrack> addTimedText(String pathOrUrl) {
        required(pathOrUrl);
        return future("addTimedText()", pathOrUrl, false);
    }

    @Override
    public SubtitleTrack addAndWait(String pathOrUrl) throws MediaException {
        required(pathOrUrl);
        return add("addAndWait()", pathOrUrl, true);
    }

    @Override
    public SubtitleTrack addPairAndWait(String pictures, String index) throws MediaException {
        required(pictures, index);
        return add("addPairAndWait()", index, true);
    }

    @Override
    public SubtitleTrack addTimedTextAndWait(String pathOrUrl) throws MediaException {
        required(pathOrUrl);
        return add("addTimedTextAndWait()", pathOrUrl, false);
    }

    @Override
    public void setStyle(SubtitleAttr attr) {
        session.guard.run(() -> {
            session.state.requireAlive("setStyle()");
            requireValue(attr, "the attributes' object").check();
            style = attr;
        });
    }

    private CompletableFuture<SubtitleTrack> future(String call, String name, boolean shown) {
        return session.guard.ask(() -> {
            session.state.requireMedia(call);
            try {
                return CompletableFuture.completedFuture(add(call, name, shown));
            } catch (MediaException e) {
                return CompletableFuture.failedFuture(e);
            }
        });
    }

    private SubtitleTrack add(String call, String name, boolean shown) throws MediaException {
        return session.guard.ask(() -> {
            session.state.requireMedia(call);
            MediaError failure = nextFailure;
            nextFailure = null;
            if (failure != null) {
                throw FakeFailures.subtitles(name, failure);
            }
            Path file = Path.of(name).getFileName();
            return tables.addSubtitles(file == null ? name : file.toString(), shown);
        });
    }

    private static void required(@Nullable String pictures, @Nullable String index) {
        requireValue(pictures, "the path of the pictures");
        requireValue(index, "the path of the index");
    }

    private static void required(@Nullable String pathOrUrl) {
        requireValue(pathOrUrl, "the path or URL");
    }
}
