// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import com.quintora.mmp.Track;
import com.quintora.mmp.internal.base.Arguments;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Commands;
import java.util.List;

/**
 * Chooses which tracks are played. The engine has a way for each kind, of which two report no
 * failure: whether the choice came about is read from the tables. Thread-safe.
 */
final class TrackSelection {
    private final NativePlayer natives;
    private final Commands commands;
    private final TrackTables tables;

    TrackSelection(NativePlayer natives, Commands commands, TrackTables tables) {
        this.natives = natives;
        this.commands = commands;
        this.tables = tables;
    }

    /** An exception for a track that the media does not have. */
    void requireKnown(String call, Track track) {
        commands.requireMedia(call);
        int count = table(Arguments.require(track, "the track").kind()).size();
        if (track.index() < 0 || track.index() >= count) {
            throw new IllegalArgumentException("there is no " + name(track.kind()) + " track "
                    + track.index() + "; the media has " + count);
        }
    }

    void select(Track track) {
        int index = track.index();
        boolean played = switch (track.kind()) {
            case AUDIO -> commands.ask("select()", () -> natives.setAudioTrack(index));
            case VIDEO -> {
                commands.run("select()", () -> natives.selectTrack(index));
                yield tables.video().get(index).flags().isSelected();
            }
            case SUBTITLE -> {
                commands.run("select()", () -> natives.onSubtitleTrack(index));
                yield tables.currentSubtitle().orElse(-1) == index;
            }
        };
        if (!played) {
            throw new IllegalStateException(
                    "the engine cannot play " + name(track.kind()) + " track " + index);
        }
    }

    void selectNone(Track.Kind kind) {
        if (kind == Track.Kind.SUBTITLE) {
            commands.run("selectNone()", natives::offSubtitleTrack);
            return;
        }
        // Counted over all kinds: pictures, then sound.
        int first = kind == Track.Kind.AUDIO ? tables.video().size() : 0;
        for (Track track : selected(kind)) {
            commands.run("selectNone()", () -> natives.deselectTrack(first + track.index()));
        }
        if (!selected(kind).isEmpty()) {
            throw new IllegalStateException("the engine cannot turn its only track off, which is a "
                    + name(kind) + " track");
        }
    }

    private List<? extends Track> selected(Track.Kind kind) {
        return table(kind).stream().filter(track -> track.flags().isSelected()).toList();
    }

    private List<? extends Track> table(Track.Kind kind) {
        return switch (kind) {
            case VIDEO -> tables.video();
            case AUDIO -> tables.audio();
            case SUBTITLE -> tables.subtitles();
        };
    }

    private static String name(Track.Kind kind) {
        return switch (kind) {
            case VIDEO -> "picture";
            case AUDIO -> "sound";
            case SUBTITLE -> "subtitle";
        };
    }
}
