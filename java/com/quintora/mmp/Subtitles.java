// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.internal.base.SourceNames;
import java.io.IOException;
import java.net.URI;
import java.nio.file.Path;
import java.util.concurrent.CompletableFuture;

/**
 * Files of subtitles for a player's media, and how subtitles look. Which track is shown is chosen
 * by {@link Tracks#select}. Thread-safe; all methods throw {@link IllegalStateException} after
 * release.
 */
public interface Subtitles {
    /**
     * Adds the subtitles of a file or URL, such as SRT or ASS, as a track and shows it. Allowed
     * while the player has media. Does not block.
     *
     * @param pathOrUrl a file's path, or a URL
     * @return completed with the new track; exceptionally with a {@link MediaException} when there
     *     are no subtitles that can be read, with an {@link IllegalStateException} after a reset or
     *     release
     * @throws IllegalArgumentException when it is null
     * @throws IllegalStateException when the player has no prepared media
     */
    CompletableFuture<SubtitleTrack> add(String pathOrUrl);

    /**
     * Adds the subtitles of a file; as {@link #add(String)}.
     *
     * @param file the file, of the default file system
     * @return as {@link #add(String)}
     * @throws IllegalArgumentException when it is null, or of another file system
     * @throws IllegalStateException when the player has no prepared media
     */
    default CompletableFuture<SubtitleTrack> add(Path file) {
        return add(SourceNames.of(file));
    }

    /**
     * Adds the subtitles that a URI names; as {@link #add(String)}.
     *
     * @param uri an absolute URI, {@code file:} included
     * @return as {@link #add(String)}
     * @throws IllegalArgumentException when it is null or relative
     * @throws IllegalStateException when the player has no prepared media
     */
    default CompletableFuture<SubtitleTrack> add(URI uri) {
        return add(SourceNames.of(uri));
    }

    /**
     * Adds the subtitles of a file or URL and shows them; as {@link #add(String)}, but blocks while
     * they are read, for a URL ten seconds at most.
     *
     * @param pathOrUrl a file's path, or a URL
     * @return the new track
     * @throws IllegalArgumentException when it is null
     * @throws MediaException when there are no subtitles that can be read
     * @throws IllegalStateException when the player has no prepared media
     */
    SubtitleTrack addAndWait(String pathOrUrl) throws IOException;

    /**
     * Adds subtitles that are a pair of files, and shows them; otherwise as {@link #add(String)}.
     *
     * @param pictures the path of the file with the pictures (.sub)
     * @param index the path of the file with their times (.idx)
     * @return as {@link #add(String)}
     * @throws IllegalArgumentException when one of them is null
     * @throws IllegalStateException when the player has no prepared media
     */
    CompletableFuture<SubtitleTrack> addPair(String pictures, String index);

    /**
     * Adds subtitles that are a pair of files, and shows them; otherwise as {@link
     * #addAndWait(String)}.
     *
     * @param pictures the path of the file with the pictures (.sub)
     * @param index the path of the file with their times (.idx)
     * @return the new track
     * @throws IllegalArgumentException when one of them is null
     * @throws MediaException when there are no subtitles that can be read
     * @throws IllegalStateException when the player has no prepared media
     */
    SubtitleTrack addPairAndWait(String pictures, String index) throws IOException;

    /**
     * Adds the timed text of a file or URL as a track, without showing it; otherwise as {@link
     * #add(String)}.
     *
     * @param pathOrUrl a file's path, or a URL
     * @return as {@link #add(String)}
     * @throws IllegalArgumentException when it is null
     * @throws IllegalStateException when the player has no prepared media
     */
    CompletableFuture<SubtitleTrack> addTimedText(String pathOrUrl);

    /**
     * Adds the timed text of a file or URL as a track, without showing it; otherwise as {@link
     * #addAndWait(String)}.
     *
     * @param pathOrUrl a file's path, or a URL
     * @return the new track
     * @throws IllegalArgumentException when it is null
     * @throws MediaException when there is no text that can be read
     * @throws IllegalStateException when the player has no prepared media
     */
    SubtitleTrack addTimedTextAndWait(String pathOrUrl) throws IOException;

    /**
     * Changes how subtitles look; what the attributes do not name stays as it is. Every state, from
     * the next picture on.
     *
     * @param attr such as {@code SubtitleAttr.builder().textColor(0xFFFFFF00).build()}
     * @throws IllegalArgumentException when it is null, or its mask names a group that is null
     */
    void setStyle(SubtitleAttr attr);
}
