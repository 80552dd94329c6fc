// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import com.quintora.mmp.DivxNavigation;
import com.quintora.mmp.internal.base.Arguments;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Commands;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import java.util.List;
import java.util.Optional;
import java.util.function.Supplier;
import org.jetbrains.annotations.Nullable;

/** Titles, chapters and playlists of DivX media. */
public final class EngineDivxNavigation implements DivxNavigation {
    private final NativePlayer natives;
    private final Commands commands;
    private @Nullable Object received;

    public EngineDivxNavigation(NativePlayer natives, Commands commands) {
        this.natives = natives;
        this.commands = commands;
    }

    @Override
    public int titleCount() {
        return commands.ask("titleCount()", natives::getDivxTitleNum);
    }

    @Override
    public Optional<TitleInfo> title(int title) {
        return ask("title()", TitleInfo.class, () -> natives.getDivxTitleInfo(title));
    }

    @Override
    public Optional<ChapterInfo> chapter(int title, int playlist, int chapter) {
        return ask("chapter()", ChapterInfo.class,
                () -> natives.getDivxChapInfo(title, playlist, chapter));
    }

    @Override
    public Optional<ChapterInfo> playlist(int title, int playlist) {
        return ask("playlist()", ChapterInfo.class,
                () -> natives.getDivxPlayListInfo(title, playlist));
    }

    @Override
    public Optional<PositionInfo> position() {
        return ask("position()", PositionInfo.class, natives::getDivxPositionInfo);
    }

    @Override
    public Optional<DisplayInfo> display(
            int value1, int value2, int value3, int value4, int value5) {
        return ask("display()", DisplayInfo.class,
                () -> natives.getDivxDisplayInfo(value1, value2, value3, value4, value5));
    }

    @Override
    public Optional<DivxLastMemoryFilePosition> lastMemory() {
        return ask("lastMemory()", DivxLastMemoryFilePosition.class,
                natives::getDivxLastMemoryFilePosition);
    }

    @Override
    public int lastMemoryFileId() {
        return commands.ask("lastMemoryFileId()", natives::getDivxLastMemoryFileID);
    }

    @Override
    public boolean setTitle(int value1, int value2, int value3) {
        return commands.ask("setTitle()",
                () -> natives.setDivxTitleInfo(value1, value2, value3) > 0);
    }

    @Override
    public boolean setChapter(int value1, int value2, int value3, int value4) {
        return commands.ask("setChapter()",
                () -> natives.setDivxChapInfo(value1, value2, value3, value4) > 0);
    }

    @Override
    public boolean setPlaylist(int value1, int value2, int value3, int value4) {
        return commands.ask("setPlaylist()",
                () -> natives.setDivxPlayListInfo(value1, value2, value3, value4) > 0);
    }

    @Override
    public boolean pressButton(int value1, int value2) {
        return commands.ask("pressButton()",
                () -> natives.setDivxBtnInfo(value1, value2) > 0);
    }

    @Override
    public boolean setFilePosition(int value1, int value2) {
        return commands.ask("setFilePosition()",
                () -> natives.setDivxFilePosition(value1, value2) > 0);
    }

    @Override
    public boolean setLastMemory(DivxLastMemoryFilePosition position) {
        return commands.ask("setLastMemory()", () -> natives.setDivxLastMemoryFilePosition(
                Arguments.require(position, "the position")) > 0);
    }

    /** Takes what the native half calls back with during a call. */
    public void receive(Object record) {
        received = record;
    }

    /** The record of the words that the native half calls back with. */
    public static DivxLastMemoryFilePosition lastMemory(int[] ints, long[] longs) {
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
        commands.ask(call, getter);
        return Optional.ofNullable(type.cast(received));
    }
}
