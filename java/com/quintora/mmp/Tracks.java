// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.List;
import java.util.Optional;
import java.util.OptionalInt;
import java.util.concurrent.CompletableFuture;

/**
 * The tracks, chapters and metadata of a player's media, and which tracks are played. Tables are
 * read with each call and are empty before the media is prepared. Thread-safe; all methods throw
 * {@link IllegalStateException} after release. Reading a table waits for the engine, for
 * milliseconds as a rule; the first table of media from a server asks the server again for the
 * texts in it.
 */
public interface Tracks {
    /**
     * The sound tracks.
     *
     * @return in the order of their indices
     */
    List<AudioTrack> audio();

    /**
     * The picture tracks.
     *
     * @return in the order of their indices
     */
    List<VideoTrack> video();

    /**
     * The subtitle tracks, those of added files included.
     *
     * @return in the order of their indices
     */
    List<SubtitleTrack> subtitles();

    /**
     * The sound track that is played.
     *
     * @return the track; empty when there is none
     */
    Optional<AudioTrack> currentAudio();

    /**
     * The picture track that is played.
     *
     * @return the track; empty when there is none
     */
    Optional<VideoTrack> currentVideo();

    /**
     * The subtitle track that is shown.
     *
     * @return the track; empty when there is none
     */
    Optional<SubtitleTrack> currentSubtitle();

    /**
     * The number of the track of a kind that is played, without reading a table for sound and
     * subtitles.
     *
     * @param kind the kind
     * @return the track's index; empty when there is none, and before the media is prepared
     * @throws IllegalArgumentException when it is null
     */
    OptionalInt currentIndex(Track.Kind kind);

    /**
     * Plays a track in place of the one of its kind that is played. Allowed while the player has
     * media. Does not block once the track's table was read; selections are carried out in the order
     * of their calls.
     *
     * @param track of one of the tables; its kind and index count
     * @return completed when it is played; exceptionally with an {@link IllegalStateException} when
     *     the engine cannot play it, or after a reset or release
     * @throws IllegalArgumentException when it is null, or the media has no such track
     * @throws IllegalStateException when the player has no prepared media
     */
    CompletableFuture<Void> select(Track track);

    /**
     * Plays a track; as {@link #select}, but blocks until it is played: as long as the engine takes
     * to read on, for milliseconds as a rule.
     *
     * @param track of one of the tables; its kind and index count
     * @throws IllegalArgumentException when it is null, or the media has no such track
     * @throws IllegalStateException when the player has no prepared media, or the engine cannot
     *     play the track
     */
    void selectAndWait(Track track);

    /**
     * Plays no track of a kind: no subtitles, no sound or no picture. Allowed while the player has
     * media. Does not block.
     *
     * @param kind the kind
     * @return completed when it is done; exceptionally with an {@link IllegalStateException} when
     *     nothing else is played, or after a reset or release
     * @throws IllegalArgumentException when it is null
     * @throws IllegalStateException when the player has no prepared media
     */
    CompletableFuture<Void> selectNone(Track.Kind kind);

    /**
     * Plays no track of a kind; as {@link #selectNone}, but blocks until it is done, for
     * milliseconds as a rule.
     *
     * @param kind the kind
     * @throws IllegalArgumentException when it is null
     * @throws IllegalStateException when the player has no prepared media, or nothing else is
     *     played
     */
    void selectNoneAndWait(Track.Kind kind);

    /**
     * The chapter marks.
     *
     * @return in the order of time
     */
    List<Chapter> chapters();

    /**
     * What the media says of itself.
     *
     * @return the metadata; empty before the media is prepared
     */
    Optional<MediaMetadata> metadata();

    /**
     * What the media's container and streams say beyond the tables: pixel formats, colours,
     * rotation, attachments and so on.
     *
     * @return the description; empty before the media is prepared, for media that cannot be read
     *     twice (pipes, streams that do not seek), and with engines that have none
     */
    Optional<MediaDescription> description();
}
