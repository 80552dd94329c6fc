// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.SubtitleAttr;
import java.util.Objects;

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
        player.states.requireAlive("show()");
        player.native_onSubtitleTrack(index);
    }

    /** Shows no subtitles. */
    public void hide() {
        player.states.requireAlive("hide()");
        player.native_offSubtitleTrack();
    }

    /**
     * Adds the subtitles of a file or URL, such as SRT or ASS, as a track and shows it.
     *
     * @param pathOrUrl where they are
     */
    public void add(String pathOrUrl) {
        player.states.requireAlive("add()");
        player.native_setSubtitleDataSource(Objects.requireNonNull(pathOrUrl, "pathOrUrl"));
    }

    /**
     * Adds subtitles that are a pair of files as a track and shows it.
     *
     * @param pictures the path of the file with the pictures (.sub)
     * @param index the path of the file with their times (.idx)
     */
    public void add(String pictures, String index) {
        player.states.requireAlive("add()");
        player.native_setSubtitleDataSourceEx(
                Objects.requireNonNull(pictures, "pictures"),
                Objects.requireNonNull(index, "index"));
    }

    /**
     * Adds a file or URL of timed text as a track, without showing it.
     *
     * @param pathOrUrl where it is
     */
    public void addTimedText(String pathOrUrl) {
        player.states.requireAlive("addTimedText()");
        player.native_addTimedTextSource(Objects.requireNonNull(pathOrUrl, "pathOrUrl"));
    }

    /**
     * Changes how subtitles look; what the attributes do not name stays as it is.
     *
     * @param attr such as {@code SubtitleAttr.builder().textColor(0xFFFFFF00).build()}
     * @throws IllegalArgumentException when the mask names a group that is null
     */
    public void setStyle(SubtitleAttr attr) {
        player.states.requireAlive("setStyle()");
        attr.check();
        player.native_setSubtitleAttr(attr);
    }
}
