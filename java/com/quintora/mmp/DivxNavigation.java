// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import java.util.List;
import java.util.Optional;

/**
 * Titles, chapters and playlists of DivX media, on engines that know them: elsewhere nothing is
 * found and nothing can be set. The numbers are the engine's own. Thread-safe; all methods throw
 * {@link IllegalStateException} after release.
 */
public interface DivxNavigation {
    /**
     * A title.
     *
     * @param title its number
     * @param playlistCount how many playlists it has
     * @param chapterCount how many chapters it has
     */
    record TitleInfo(int title, int playlistCount, int chapterCount) {}

    /**
     * What is being played.
     *
     * @param title the title's number
     * @param playlist the playlist's number
     * @param chapter the chapter's number
     */
    record PositionInfo(int title, int playlist, int chapter) {}

    /**
     * A chapter or a playlist.
     *
     * @param title the title's number
     * @param playlist the playlist's number
     * @param chapter the chapter's number
     * @param start where it begins
     */
    record ChapterInfo(int title, int playlist, int chapter, int start) {}

    /**
     * What is shown to the viewer.
     *
     * @param values seven numbers
     * @param text1 the first text
     * @param text2 the second text
     */
    record DisplayInfo(List<Integer> values, String text1, String text2) {
        /** Copies the list. */
        public DisplayInfo {
            values = List.copyOf(values);
        }
    }

    /**
     * How many titles there are.
     *
     * @return 0 for none
     */
    int titleCount();

    /**
     * A title.
     *
     * @param title its number
     * @return the title; empty when unknown
     */
    Optional<TitleInfo> title(int title);

    /**
     * A chapter.
     *
     * @param title the title's number
     * @param playlist the playlist's number
     * @param chapter the chapter's number
     * @return the chapter; empty when unknown
     */
    Optional<ChapterInfo> chapter(int title, int playlist, int chapter);

    /**
     * A playlist.
     *
     * @param title the title's number
     * @param playlist the playlist's number
     * @return the playlist; empty when unknown
     */
    Optional<ChapterInfo> playlist(int title, int playlist);

    /**
     * What is being played.
     *
     * @return the position; empty when unknown
     */
    Optional<PositionInfo> position();

    /**
     * What is shown to the viewer.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @param value3 its third
     * @param value4 its fourth
     * @param value5 its fifth
     * @return the display; empty when unknown
     */
    Optional<DisplayInfo> display(
            int value1, int value2, int value3, int value4, int value5);

    /**
     * Where the viewer left the media.
     *
     * @return the position; empty when unknown
     */
    Optional<DivxLastMemoryFilePosition> lastMemory();

    /**
     * The file that the viewer left.
     *
     * @return its number, 0 for none
     */
    int lastMemoryFileId();

    /**
     * Goes to a title.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @param value3 its third
     * @return false when the engine cannot
     */
    boolean setTitle(int value1, int value2, int value3);

    /**
     * Goes to a chapter.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @param value3 its third
     * @param value4 its fourth
     * @return false when the engine cannot
     */
    boolean setChapter(int value1, int value2, int value3, int value4);

    /**
     * Goes to a playlist.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @param value3 its third
     * @param value4 its fourth
     * @return false when the engine cannot
     */
    boolean setPlaylist(int value1, int value2, int value3, int value4);

    /**
     * Presses a menu's button.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @return false when the engine cannot
     */
    boolean pressButton(int value1, int value2);

    /**
     * Goes to a position in the file.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @return false when the engine cannot
     */
    boolean setFilePosition(int value1, int value2);

    /**
     * Goes to where the viewer left the media.
     *
     * @param position the position
     * @return false when the engine cannot
     * @throws IllegalArgumentException when the position is null
     */
    boolean setLastMemory(DivxLastMemoryFilePosition position);
}
