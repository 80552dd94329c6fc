// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.Chapter;
import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaMetadata;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.Track;
import com.quintora.mmp.Tracks;
import com.quintora.mmp.VideoTrack;
import com.quintora.mmp.internal.base.Arguments;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Background;
import com.quintora.mmp.internal.control.Commands;
import java.util.List;
import java.util.Optional;
import java.util.OptionalInt;
import java.util.concurrent.CompletableFuture;

/** The tracks of a player's media: read from the tables, chosen by the selection. */
public final class EngineTracks implements Tracks {
    private final Commands commands;
    private final Background background;
    private final TrackTables tables;
    private final TrackSelection selection;

    public EngineTracks(
            NativePlayer natives, Commands commands, Background background, TrackTables tables) {
        this.commands = commands;
        this.background = background;
        this.tables = tables;
        selection = new TrackSelection(natives, commands, tables);
    }

    @Override
    public List<AudioTrack> audio() {
        return tables.audio();
    }

    @Override
    public List<VideoTrack> video() {
        return tables.video();
    }

    @Override
    public List<SubtitleTrack> subtitles() {
        return tables.subtitles();
    }

    @Override
    public Optional<AudioTrack> currentAudio() {
        commands.requireAlive("currentAudio()");
        return row(currentIndex(Track.Kind.AUDIO), tables.audio());
    }

    @Override
    public Optional<VideoTrack> currentVideo() {
        commands.requireAlive("currentVideo()");
        return row(currentIndex(Track.Kind.VIDEO), tables.video());
    }

    @Override
    public Optional<SubtitleTrack> currentSubtitle() {
        commands.requireAlive("currentSubtitle()");
        return row(currentIndex(Track.Kind.SUBTITLE), tables.subtitles());
    }

    @Override
    public OptionalInt currentIndex(Track.Kind kind) {
        commands.requireAlive("currentIndex()");
        return switch (Arguments.require(kind, "the kind of track")) {
            case VIDEO -> tables.currentVideo();
            case AUDIO -> tables.currentAudio();
            case SUBTITLE -> tables.currentSubtitle();
        };
    }

    @Override
    public CompletableFuture<Void> select(Track track) {
        selection.requireKnown("select()", track);
        return background.submit("select()", () -> {
            selection.select(track);
            return null;
        });
    }

    @Override
    public void selectAndWait(Track track) {
        selection.requireKnown("selectAndWait()", track);
        selection.select(track);
    }

    @Override
    public CompletableFuture<Void> selectNone(Track.Kind kind) {
        Arguments.require(kind, "the kind of track");
        return background.submit("selectNone()", () -> {
            selection.selectNone(kind);
            return null;
        });
    }

    @Override
    public void selectNoneAndWait(Track.Kind kind) {
        Arguments.require(kind, "the kind of track");
        commands.requireMedia("selectNoneAndWait()");
        selection.selectNone(kind);
    }

    @Override
    public List<Chapter> chapters() {
        return tables.chapters();
    }

    @Override
    public Optional<MediaMetadata> metadata() {
        return tables.metadata();
    }

    @Override
    public Optional<MediaDescription> description() {
        return DescriptionText.parse(tables.description());
    }

    private static <T> Optional<T> row(OptionalInt index, List<T> table) {
        return index.isPresent() && index.getAsInt() < table.size()
                ? Optional.of(table.get(index.getAsInt()))
                : Optional.empty();
    }
}
