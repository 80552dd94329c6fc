// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import java.util.List;
import java.util.Optional;
import java.util.function.Supplier;

/**
 * Titles, chapters and playlists of DivX media, on engines that know them: elsewhere nothing is
 * found and nothing can be set. The numbers are the engine's own. Thread-safe; all methods throw
 * {@link IllegalStateException} after release.
 */
public final class DivxNavigation {
    /**
     * A title.
     *
     * @param title its number
     * @param playlistCount how many playlists it has
     * @param chapterCount how many chapters it has
     */
    public record TitleInfo(int title, int playlistCount, int chapterCount) {}

    /**
     * What is being played.
     *
     * @param title the title's number
     * @param playlist the playlist's number
     * @param chapter the chapter's number
     */
    public record PositionInfo(int title, int playlist, int chapter) {}

    /**
     * A chapter or a playlist.
     *
     * @param title the title's number
     * @param playlist the playlist's number
     * @param chapter the chapter's number
     * @param start where it begins
     */
    public record ChapterInfo(int title, int playlist, int chapter, int start) {}

    /**
     * What is shown to the viewer.
     *
     * @param values seven numbers
     * @param text1 the first text
     * @param text2 the second text
     */
    public record DisplayInfo(List<Integer> values, String text1, String text2) {}

    private final OrvMediaPlayer player;
    private Object received;

    DivxNavigation(OrvMediaPlayer player) {
        this.player = player;
    }

    /**
     * How many titles there are.
     *
     * @return 0 for none
     */
    public int titleCount() {
        return player.ask("titleCount()", player::native_getDivxTitleNum);
    }

    /**
     * A title.
     *
     * @param title its number
     * @return the title; empty when unknown
     */
    public Optional<TitleInfo> title(int title) {
        return ask("title()", TitleInfo.class, () -> player.native_getDivxTitleInfo(title));
    }

    /**
     * A chapter.
     *
     * @param title the title's number
     * @param playlist the playlist's number
     * @param chapter the chapter's number
     * @return the chapter; empty when unknown
     */
    public Optional<ChapterInfo> chapter(int title, int playlist, int chapter) {
        return ask("chapter()", ChapterInfo.class,
                () -> player.native_getDivxChapInfo(title, playlist, chapter));
    }

    /**
     * A playlist.
     *
     * @param title the title's number
     * @param playlist the playlist's number
     * @return the playlist; empty when unknown
     */
    public Optional<ChapterInfo> playlist(int title, int playlist) {
        return ask("playlist()", ChapterInfo.class,
                () -> player.native_getDivxPlayListInfo(title, playlist));
    }

    /**
     * What is being played.
     *
     * @return the position; empty when unknown
     */
    public Optional<PositionInfo> position() {
        return ask("position()", PositionInfo.class, player::native_getDivxPositionInfo);
    }

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
    public Optional<DisplayInfo> display(
            int value1, int value2, int value3, int value4, int value5) {
        return ask("display()", DisplayInfo.class,
                () -> player.native_getDivxDisplayInfo(value1, value2, value3, value4, value5));
    }

    /**
     * Where the viewer left the media.
     *
     * @return the position; empty when unknown
     */
    public Optional<DivxLastMemoryFilePosition> lastMemory() {
        return ask("lastMemory()", DivxLastMemoryFilePosition.class,
                player::native_getDivxLastMemoryFilePosition);
    }

    /**
     * The file that the viewer left.
     *
     * @return its number, 0 for none
     */
    public int lastMemoryFileId() {
        return player.ask("lastMemoryFileId()", player::native_getDivxLastMemoryFileID);
    }

    /**
     * Goes to a title.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @param value3 its third
     * @return false when the engine cannot
     */
    public boolean setTitle(int value1, int value2, int value3) {
        return player.ask("setTitle()",
                () -> player.native_setDivxTitleInfo(value1, value2, value3) > 0);
    }

    /**
     * Goes to a chapter.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @param value3 its third
     * @param value4 its fourth
     * @return false when the engine cannot
     */
    public boolean setChapter(int value1, int value2, int value3, int value4) {
        return player.ask("setChapter()",
                () -> player.native_setDivxChapInfo(value1, value2, value3, value4) > 0);
    }

    /**
     * Goes to a playlist.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @param value3 its third
     * @param value4 its fourth
     * @return false when the engine cannot
     */
    public boolean setPlaylist(int value1, int value2, int value3, int value4) {
        return player.ask("setPlaylist()",
                () -> player.native_setDivxPlayListInfo(value1, value2, value3, value4) > 0);
    }

    /**
     * Presses a menu's button.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @return false when the engine cannot
     */
    public boolean pressButton(int value1, int value2) {
        return player.ask("pressButton()",
                () -> player.native_setDivxBtnInfo(value1, value2) > 0);
    }

    /**
     * Goes to a position in the file.
     *
     * @param value1 the engine's first number
     * @param value2 its second
     * @return false when the engine cannot
     */
    public boolean setFilePosition(int value1, int value2) {
        return player.ask("setFilePosition()",
                () -> player.native_setDivxFilePosition(value1, value2) > 0);
    }

    /**
     * Goes to where the viewer left the media.
     *
     * @param position the position
     * @return false when the engine cannot
     * @throws IllegalArgumentException when the position is null
     */
    public boolean setLastMemory(DivxLastMemoryFilePosition position) {
        return player.ask("setLastMemory()", () -> player.native_setDivxLastMemoryFilePosition(
                Arguments.require(position, "the position")) > 0);
    }

    /** Takes what the native half calls back with during a call. */
    void receive(Object record) {
        received = record;
    }

    /** The record of the words that the native half calls back with. */
    static DivxLastMemoryFilePosition lastMemory(int[] ints, long[] longs) {
        DivxLastMemoryFilePosition record = new DivxLastMemoryFilePosition();
        record.ui4_title_idx = ints[0];
        record.ui4_playlist_idx = ints[1];
        record.ui4_chap_idx = ints[2];
        record.ui2_aud_idx = ints[3];
        record.ui2_sub_idx = ints[4];
        record.i4_temporal_reference = ints[5];
        record.ui2_decoding_order = ints[6];
        record.ui4_timestap = ints[7];
        record.ui8_clip_id = longs[0];
        record.ui8_aud_pts_info = longs[1];
        record.ui8_aud_frame_position = longs[2];
        record.ui8_i_pts_info = longs[3];
        record.ui8_pts_info = longs[4];
        record.ui8_i_frame_position = longs[5];
        record.ui8_frame_position = longs[6];
        record.ui8_stc = longs[7];
        record.ui8_frame_position_disp = longs[8];
        return record;
    }

    private synchronized <T> Optional<T> ask(String call, Class<T> type, Supplier<Boolean> getter) {
        received = null;
        player.ask(call, getter);
        return Optional.ofNullable(type.cast(received));
    }
}
