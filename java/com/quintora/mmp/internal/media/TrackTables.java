// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.Chapter;
import com.quintora.mmp.MediaMetadata;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.TrackFlags;
import com.quintora.mmp.VideoTrack;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Commands;
import java.util.ArrayList;
import java.util.List;
import java.util.Optional;
import java.util.OptionalInt;
import org.jetbrains.annotations.Nullable;

/**
 * The engine's tables of tracks, chapters and metadata. The native half answers a question for a
 * table by calling back with its rows, on the same thread. Thread-safe.
 */
public final class TrackTables {
    // Where the engine's indices of chapters begin, among those of subtitle tracks.
    private static final int CHAPTER_INDEX_BASE = 0x10000;
    // Where the pieces of the description begin, among the same.
    private static final int DESCRIPTION_INDEX_BASE = 0x20000;
    private static final double FRAME_RATE_UNIT = 1000;

    private final NativePlayer natives;
    private final Commands commands;

    // What the native half calls back with during a call, under this object's lock.
    private final List<AudioTrack> audio = new ArrayList<>();
    private final List<VideoTrack> video = new ArrayList<>();
    private final List<SubtitleTrack> subtitles = new ArrayList<>();
    private @Nullable Chapter chapter;
    private @Nullable String descriptionPiece;
    private @Nullable MediaMetadata metadata;

    public TrackTables(NativePlayer natives, Commands commands) {
        this.natives = natives;
        this.commands = commands;
    }

    synchronized List<AudioTrack> audio() {
        audio.clear();
        commands.ask("audio()", () -> natives.getAllAudioTrackInfo(true));
        return List.copyOf(audio);
    }

    synchronized List<VideoTrack> video() {
        video.clear();
        commands.ask("video()", natives::getAllVideoTrackInfo);
        return List.copyOf(video);
    }

    /** The engine has no number for it; the table marks it. */
    OptionalInt currentVideo() {
        return video().stream()
                .filter(track -> track.flags().isSelected())
                .mapToInt(VideoTrack::index)
                .findFirst();
    }

    synchronized List<SubtitleTrack> subtitles() {
        subtitles.clear();
        commands.ask("subtitles()", natives::getAllSubtitleTrackInfo);
        return List.copyOf(subtitles);
    }

    OptionalInt currentAudio() {
        return current(commands.ask("currentAudio()", natives::getCurrentAudioIndex));
    }

    OptionalInt currentSubtitle() {
        return current(commands.ask("currentSubtitle()", natives::getCurrentSubtitleIndex));
    }

    synchronized List<Chapter> chapters() {
        List<Chapter> chapters = new ArrayList<>();
        while (commands.ask("chapters()", () ->
                natives.getSubtitleTrackInfo(CHAPTER_INDEX_BASE + chapters.size()))) {
            chapters.add(new Chapter(
                    chapters.size(), chapter.startMillis(), chapter.endMillis(), chapter.title()));
        }
        return List.copyOf(chapters);
    }

    synchronized Optional<MediaMetadata> metadata() {
        metadata = null;
        commands.ask("metadata()", natives::getMetaDataInfo);
        return Optional.ofNullable(metadata);
    }

    /** The text of the engine's description; empty when it has none. */
    synchronized String description() {
        int[] piece = {DESCRIPTION_INDEX_BASE};
        StringBuilder text = new StringBuilder();
        do {
            descriptionPiece = null;
            commands.ask("description()", () -> natives.getSubtitleTrackInfo(piece[0]));
            piece[0]++;
            text.append(descriptionPiece == null ? "" : descriptionPiece);
        } while (descriptionPiece != null);
        return text.toString();
    }

    // What the native half calls back with.

    public void addAudio(AudioTrack track) {
        audio.add(track);
    }

    public void addVideo(
            int index, int codec, int width, int height, int frameRate, int bitRate, int flags) {
        video.add(new VideoTrack(
                index, FourCharacters.text(codec), width, height, frameRate / FRAME_RATE_UNIT,
                bitRate, new TrackFlags(flags)));
    }

    /** Chapters and the description come as subtitle tracks of codecs of their own. */
    public void addSubtitle(int index, int trackId, int codec, String text, int flags) {
        if (codec == FourCharacters.CHAPTER) {
            chapter = new Chapter(0, trackId, flags, text);
            return;
        }
        if (codec == FourCharacters.DESCRIPTION) {
            descriptionPiece = text;
            return;
        }
        int separator = text.indexOf(';');
        subtitles.add(new SubtitleTrack(
                index, trackId, FourCharacters.text(codec),
                separator < 0 ? "" : text.substring(0, separator), text.substring(separator + 1),
                new TrackFlags(flags)));
    }

    public void setMetadata(MediaMetadata read) {
        metadata = read;
    }

    // The native half answers 0 both for the first track and where there is no media.
    private OptionalInt current(int index) {
        return index > 0 || index == 0 && commands.hasMedia()
                ? OptionalInt.of(index)
                : OptionalInt.empty();
    }
}
