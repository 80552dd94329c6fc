// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static com.quintora.mmp.testing.FakeState.requireValue;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.Chapter;
import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaMetadata;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.Track;
import com.quintora.mmp.Tracks;
import com.quintora.mmp.VideoTrack;
import java.util.List;
import java.util.Optional;
import java.util.OptionalInt;
import java.util.concurrent.CompletableFuture;
import java.util.function.Function;
import org.jetbrains.annotations.Nullable;

/** The tracks of the media, and which of them are played. */
final class FakeTracks implements Tracks {
    private final FakeSession session;
    private final FakeTables tables;

    FakeTracks(FakeSession session, FakeTables tables) {
        this.session = session;
        this.tables = tables;
    }

    @Override
    public List<AudioTrack> audio() {
        return ask("audio()", tables::audio);
    }

    @Override
    public List<VideoTrack> video() {
        return ask("video()", tables::video);
    }

    @Override
    public List<SubtitleTrack> subtitles() {
        return ask("subtitles()", tables::subtitles);
    }

    @Override
    public Optional<AudioTrack> currentAudio() {
        return ask("currentAudio()", () -> tables.current(tables.audio()));
    }

    @Override
    public Optional<VideoTrack> currentVideo() {
        return ask("currentVideo()", () -> tables.current(tables.video()));
    }

    @Override
    public Optional<SubtitleTrack> currentSubtitle() {
        return ask("currentSubtitle()", () -> tables.current(tables.subtitles()));
    }

    @Override
    public OptionalInt currentIndex(Track.Kind kind) {
        return ask("currentIndex()", () -> tables
                .current(tables.of(requireValue(kind, "the kind of track")))
                .map(track -> OptionalInt.of(track.index()))
                .orElse(OptionalInt.empty()));
    }

    @Override
    public CompletableFuture<Void> select(Track track) {
        return session.guard.ask(() -> {
            requireKnown("select()", track);
            tables.play(track.kind(), track.index());
            return done(null);
        });
    }

    @Override
    public void selectAndWait(Track track) {
        session.guard.run(() -> {
            requireKnown("selectAndWait()", track);
            tables.play(track.kind(), track.index());
        });
    }

    @Override
    public CompletableFuture<Void> selectNone(Track.Kind kind) {
        requireValue(kind, "the kind of track");
        return session.guard.ask(() -> {
            session.state.requireMedia("selectNone()");
            return done(playNone(kind));
        });
    }

    @Override
    public void selectNoneAndWait(Track.Kind kind) {
        requireValue(kind, "the kind of track");
        session.guard.run(() -> {
            session.state.requireMedia("selectNoneAndWait()");
            IllegalStateException refusal = playNone(kind);
            if (refusal != null) {
                throw refusal;
            }
        });
    }

    @Override
    public List<Chapter> chapters() {
        return ask("chapters()", () -> ofMedia(FakeMedia::chapters).orElse(List.of()));
    }

    @Override
    public Optional<MediaMetadata> metadata() {
        return ask("metadata()", () -> ofMedia(FakeMedia::metadata));
    }

    @Override
    public Optional<MediaDescription> description() {
        return ask("description()", () -> ofMedia(FakeMedia::description));
    }

    private <T> Optional<T> ofMedia(Function<FakeMedia, @Nullable T> part) {
        return Optional.ofNullable(session.opened()).map(part);
    }

    private @Nullable IllegalStateException playNone(Track.Kind kind) {
        if (tables.isOnly(kind)) {
            return new IllegalStateException("the engine cannot turn its only track off, which is a "
                    + name(kind) + " track");
        }
        tables.play(kind, FakeTables.NONE);
        return null;
    }

    private void requireKnown(String call, @Nullable Track track) {
        session.state.requireMedia(call);
        int count = tables.of(requireValue(track, "the track").kind()).size();
        if (track.index() < 0 || track.index() >= count) {
            throw new IllegalArgumentException("there is no " + name(track.kind()) + " track "
                    + track.index() + "; the media has " + count);
        }
    }

    private CompletableFuture<Void> done(@Nullable IllegalStateException failure) {
        return failure == null
                ? CompletableFuture.completedFuture(null)
                : CompletableFuture.failedFuture(failure);
    }

    private <T> T ask(String call, Guard.Action<T, RuntimeException> question) {
        return session.guard.ask(() -> {
            session.state.requireAlive(call);
            return question.run();
        });
    }

    private static String name(Track.Kind kind) {
        return switch (kind) {
            case VIDEO -> "picture";
            case AUDIO -> "sound";
            case SUBTITLE -> "subtitle";
        };
    }
}
