// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.Track;
import com.quintora.mmp.TrackFlags;
import com.quintora.mmp.VideoTrack;
import java.util.ArrayList;
import java.util.EnumMap;
import java.util.List;
import java.util.Map;
import java.util.Optional;
import java.util.stream.IntStream;
import java.util.stream.Stream;

/** The tables of tracks, with what is played marked in them. Used under the guard. */
final class FakeTables {
    static final int NONE = -1;
    private static final int EXTERNAL = 1 << 2;
    private static final int SELECTED = 1 << 3;

    private final FakeSession session;
    private final Map<Track.Kind, Integer> played = new EnumMap<>(Track.Kind.class);
    private final List<SubtitleTrack> added = new ArrayList<>();

    FakeTables(FakeSession session) {
        this.session = session;
    }

    void forget() {
        played.clear();
        added.clear();
    }

    List<VideoTrack> video() {
        FakeMedia media = session.opened();
        return media == null ? List.of() : media.video().stream()
                .map(track -> new VideoTrack(
                        track.index(), track.codec(), track.width(), track.height(),
                        track.frameRate(), track.bitRate(), flags(track)))
                .toList();
    }

    List<AudioTrack> audio() {
        FakeMedia media = session.opened();
        return media == null ? List.of() : media.audio().stream()
                .map(track -> new AudioTrack(
                        track.index(), track.codec(), track.channels(), track.sampleRate(),
                        track.bitRate(), track.bitsPerSample(), track.trackId(), track.title(),
                        track.codecName(), track.channelLayout(), track.profile(), flags(track),
                        track.comment(), track.encoder(), track.handler(), track.language()))
                .toList();
    }

    List<SubtitleTrack> subtitles() {
        FakeMedia media = session.opened();
        return media == null ? List.of() : Stream.concat(media.subtitles().stream(), added.stream())
                .map(track -> new SubtitleTrack(
                        track.index(), track.trackId(), track.codec(), track.language(),
                        track.title(), flags(track)))
                .toList();
    }

    List<? extends Track> of(Track.Kind kind) {
        return switch (kind) {
            case VIDEO -> video();
            case AUDIO -> audio();
            case SUBTITLE -> subtitles();
        };
    }

    <T extends Track> Optional<T> current(List<T> table) {
        return table.stream().filter(track -> track.flags().isSelected()).findFirst();
    }

    void play(Track.Kind kind, int index) {
        played.put(kind, index);
    }

    /** Whether a kind is played and neither sound nor picture besides. */
    boolean isOnly(Track.Kind kind) {
        return kind != Track.Kind.SUBTITLE
                && current(of(kind)).isPresent()
                && Stream.of(Track.Kind.VIDEO, Track.Kind.AUDIO)
                        .noneMatch(other -> other != kind && current(of(other)).isPresent());
    }

    SubtitleTrack addSubtitles(String title, boolean shown) {
        int index = subtitles().size();
        added.add(new SubtitleTrack(index, 0, "srt ", "", title, new TrackFlags(EXTERNAL)));
        if (shown) {
            play(Track.Kind.SUBTITLE, index);
        }
        return subtitles().get(index);
    }

    private TrackFlags flags(Track track) {
        int bits = track.flags().bits() & ~SELECTED;
        boolean selected = track.index() == playedIndex(track.kind());
        return new TrackFlags(selected ? bits | SELECTED : bits);
    }

    private int playedIndex(Track.Kind kind) {
        return played.computeIfAbsent(kind, this::suggestedIndex);
    }

    /** What the media itself marks, or else the first one, but of subtitles none. */
    private int suggestedIndex(Track.Kind kind) {
        FakeMedia media = session.opened();
        List<? extends Track> table = media == null ? List.of() : switch (kind) {
            case VIDEO -> media.video();
            case AUDIO -> media.audio();
            case SUBTITLE -> media.subtitles();
        };
        int other = table.isEmpty() || kind == Track.Kind.SUBTITLE ? NONE : 0;
        return IntStream.range(0, table.size())
                .filter(index -> table.get(index).flags().isSelected())
                .findFirst()
                .orElse(other);
    }
}
