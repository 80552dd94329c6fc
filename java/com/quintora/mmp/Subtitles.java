// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.SubtitleAttr;

/**
 * Subtitles on a player's picture. Thread-safe; all methods throw {@link IllegalStateException}
 * after release. The engine reports no failures here: {@link Tracks#subtitles()} and {@link
 * Tracks#currentSubtitle()} tell what came of a call.
 */
public final class Subtitles {
    private final OrvMediaPlayer player;

    Subtitles(OrvMediaPlayer player) {
        this.player = player;
    }

    /**
     * Shows a subtitle track. Unknown indices are ignored.
     *
     * @param index its number among the subtitle tracks, from 0
     */
    public void show(int index) {
        player.run("show()", () -> player.native_onSubtitleTrack(index));
    }

    /** Shows no subtitles. */
    public void hide() {
        player.run("hide()", player::native_offSubtitleTrack);
    }

    /**
     * Adds the subtitles of a file or URL, such as SRT or ASS, as a track and shows it. Blocks
     * while they are read, for a URL ten seconds at most.
     *
     * @param pathOrUrl where they are
     * @throws IllegalArgumentException when it is null
     */
    public void add(String pathOrUrl) {
        player.run("add()", () -> player.native_setSubtitleDataSource(
                Arguments.require(pathOrUrl, "the path or URL")));
    }

    /**
     * Adds subtitles that are a pair of files as a track and shows it. Blocks while they are read.
     *
     * @param pictures the path of the file with the pictures (.sub)
     * @param index the path of the file with their times (.idx)
     * @throws IllegalArgumentException when one of them is null
     */
    public void add(String pictures, String index) {
        player.run("add()", () -> player.native_setSubtitleDataSourceEx(
                Arguments.require(pictures, "the path of the pictures"),
                Arguments.require(index, "the path of the index")));
    }

    /**
     * Adds a file or URL of timed text as a track, without showing it. Blocks as {@link
     * #add(String)} does.
     *
     * @param pathOrUrl where it is
     * @throws IllegalArgumentException when it is null
     */
    public void addTimedText(String pathOrUrl) {
        player.run("addTimedText()", () -> player.native_addTimedTextSource(
                Arguments.require(pathOrUrl, "the path or URL")));
    }

    /**
     * Changes how subtitles look; what the attributes do not name stays as it is.
     *
     * @param attr such as {@code SubtitleAttr.builder().textColor(0xFFFFFF00).build()}
     * @throws IllegalArgumentException when they are null, or the mask names a group that is null
     */
    public void setStyle(SubtitleAttr attr) {
        player.states.requireAlive("setStyle()");
        Arguments.require(attr, "the attributes' object").check();
        player.run("setStyle()", () -> player.native_setSubtitleAttr(attr));
    }
}
