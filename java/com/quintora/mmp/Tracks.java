// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.ArrayList;
import java.util.List;
import java.util.Optional;
import java.util.OptionalInt;

/**
 * The tracks, chapters and metadata of a player's media. Tables are read anew with each call and
 * are empty before the media is prepared; all methods throw {@link IllegalStateException} after
 * release. Thread-safe; reading a table waits for the engine, for milliseconds as a rule.
 */
public final class Tracks {
    // Where the engine's indices of chapters begin, among those of subtitle tracks.
    private static final int CHAPTER_INDEX_BASE = 0x10000;
    // Where the pieces of the description begin, among the same.
    private static final int DESCRIPTION_INDEX_BASE = 0x20000;
    private static final double FRAME_RATE_UNIT = 1000;

    private final OrvMediaPlayer player;

    // What the native half calls back with during a call, under this object's lock.
    private final List<AudioTrack> audio = new ArrayList<>();
    private final List<VideoTrack> video = new ArrayList<>();
    private final List<SubtitleTrack> subtitles = new ArrayList<>();
    private Chapter chapter;
    private String descriptionPiece;
    private MediaMetadata metadata;

    Tracks(OrvMediaPlayer player) {
        this.player = player;
    }

    /**
     * The sound tracks.
     *
     * @return in the order of their indices
     */
    public synchronized List<AudioTrack> audio() {
        audio.clear();
        player.ask("audio()", () -> player.native_getAllAudioTrackInfo(true));
        return List.copyOf(audio);
    }

    /**
     * The picture tracks.
     *
     * @return in the order of their indices
     */
    public synchronized List<VideoTrack> video() {
        video.clear();
        player.ask("video()", player::native_getAllVideoTrackInfo);
        return List.copyOf(video);
    }

    /**
     * The picture track that is being played.
     *
     * @return the track, its index always 0; empty when there is none
     */
    public synchronized Optional<VideoTrack> currentVideo() {
        video.clear();
        player.ask("currentVideo()", player::native_getVideoCodecInfo);
        return video.stream().findFirst();
    }

    /**
     * The subtitle tracks, those from files beside the media included.
     *
     * @return in the order of their indices
     */
    public synchronized List<SubtitleTrack> subtitles() {
        subtitles.clear();
        player.ask("subtitles()", player::native_getAllSubtitleTrackInfo);
        return List.copyOf(subtitles);
    }

    /**
     * One subtitle track.
     *
     * @param index its number among the subtitle tracks, from 0
     * @return the track; empty when there is no such
     */
    public synchronized Optional<SubtitleTrack> subtitle(int index) {
        player.states.requireAlive("subtitle()");
        if (index < 0 || index >= CHAPTER_INDEX_BASE) {
            return Optional.empty();
        }
        subtitles.clear();
        player.ask("subtitle()", () -> player.native_getSubtitleTrackInfo(index));
        return subtitles.stream().findFirst().map(track -> track.withIndex(index));
    }

    /**
     * The chapter marks.
     *
     * @return in the order of time
     */
    public synchronized List<Chapter> chapters() {
        List<Chapter> chapters = new ArrayList<>();
        while (player.ask("chapters()", () ->
                player.native_getSubtitleTrackInfo(CHAPTER_INDEX_BASE + chapters.size()))) {
            chapters.add(new Chapter(
                    chapters.size(), chapter.startMillis(), chapter.endMillis(), chapter.title()));
        }
        return List.copyOf(chapters);
    }

    /**
     * What the media says of itself.
     *
     * @return the metadata; empty before the media is prepared
     */
    public synchronized Optional<MediaMetadata> metadata() {
        metadata = null;
        player.ask("metadata()", player::native_getMetaDataInfo);
        return Optional.ofNullable(metadata);
    }

    /**
     * What the media's container and streams say beyond the tables: pixel formats, colours,
     * turning, attachments and so on.
     *
     * @return the description; empty before the media is prepared, for media that cannot be read
     *     twice (pipes, streams that do not seek), and with engines that have none
     */
    public synchronized Optional<MediaDescription> description() {
        StringBuilder text = new StringBuilder();
        int[] piece = {DESCRIPTION_INDEX_BASE};
        do {
            descriptionPiece = null;
            player.ask("description()", () -> player.native_getSubtitleTrackInfo(piece[0]));
            piece[0]++;
            text.append(descriptionPiece == null ? "" : descriptionPiece);
        } while (descriptionPiece != null);
        return DescriptionText.parse(text.toString());
    }

    /**
     * Plays another sound track.
     *
     * @param index its number among the sound tracks, from 0
     * @return false when there is no such track or it cannot be played
     */
    public boolean selectAudio(int index) {
        return player.ask("selectAudio()", () -> player.native_setAudioTrack(index));
    }

    /**
     * The sound track that is being played.
     *
     * @return its number among the sound tracks; empty for none or before the media is prepared
     */
    public OptionalInt currentAudio() {
        return current(player.ask("currentAudio()", player::native_getCurrentAudioIndex));
    }

    /**
     * The subtitle track that is being shown.
     *
     * @return its number among the subtitle tracks; empty for none or before the media is prepared
     */
    public OptionalInt currentSubtitle() {
        return current(player.ask("currentSubtitle()", player::native_getCurrentSubtitleIndex));
    }

    /**
     * Plays a track of any kind. Unknown numbers are ignored.
     *
     * @param number counted over all kinds: picture, then sound, then subtitle tracks, from 0
     */
    public void select(int number) {
        player.run("select()", () -> player.native_selectTrack(number));
    }

    /**
     * Stops playing a track of any kind. Unknown numbers are ignored.
     *
     * @param number counted as for {@link #select}
     */
    public void deselect(int number) {
        player.run("deselect()", () -> player.native_deselectTrack(number));
    }

    void addAudio(AudioTrack track) {
        audio.add(track);
    }

    void addVideo(
            int index, int codec, int width, int height, int frameRate, int bitRate, int flags) {
        video.add(new VideoTrack(
                index, FourCharacters.text(codec), width, height, frameRate / FRAME_RATE_UNIT,
                bitRate, new TrackFlags(flags)));
    }

    /** Chapters and the description come as subtitle tracks of codecs of their own. */
    void addSubtitle(int index, int trackId, int codec, String text, int flags) {
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

    void setMetadata(MediaMetadata read) {
        metadata = read;
    }

    // The native half answers 0 both for the first track and where there is no media.
    private OptionalInt current(int index) {
        boolean hasMedia = StateMachine.WITH_MEDIA.contains(player.states.state());
        return index > 0 || index == 0 && hasMedia
                ? OptionalInt.of(index)
                : OptionalInt.empty();
    }
}
