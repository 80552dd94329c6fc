// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.internal.source.StreamAdapter;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import java.lang.reflect.Field;
import java.lang.reflect.Method;
import java.util.Arrays;
import java.util.List;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** What the native half calls back with arrives, each value in its place. */
class CallbacksTest {
    private final OrvMediaPlayer player = new OrvMediaPlayer();

    @AfterEach
    void release() {
        player.close();
    }

    @Test
    void divxRecords() throws Exception {
        call("setDivxTitleInfoPrm", 1, 2, 3);
        assertEquals(new DivxNavigation.TitleInfo(1, 2, 3), received());
        call("setDivxChapInfoPrm", 4, 5, 6, 7);
        assertEquals(new DivxNavigation.ChapterInfo(4, 5, 6, 7), received());
        call("setDivxPlayListInfoPrm", 8, 9, 10, 11);
        assertEquals(new DivxNavigation.ChapterInfo(8, 9, 10, 11), received());
        call("setDivxPositionInfoPrm", 12, 13, 14);
        assertEquals(new DivxNavigation.PositionInfo(12, 13, 14), received());
        call("setDivxDisplayInfoPrm", 1, 2, 3, 4, 5, "one", 6, "two", 7);
        assertEquals(
                new DivxNavigation.DisplayInfo(List.of(1, 2, 3, 4, 5, 6, 7), "one", "two"),
                received());
    }

    @Test
    void theDivxPositionThatWasLeft() throws Exception {
        call("setDivxLastMemoryFilePositionPrm",
                101L, 2, 3, 4, 5, 6, 107L, 108L, 109L, 110L, 111L, 112L, 13, 14, 115L, 116L, 17);
        DivxLastMemoryFilePosition left = (DivxLastMemoryFilePosition) received();
        assertEquals(
                List.of(101L, 107L, 108L, 109L, 110L, 111L, 112L, 115L, 116L),
                List.of(left.ui8_clip_id, left.ui8_aud_pts_info, left.ui8_aud_frame_position,
                        left.ui8_i_pts_info, left.ui8_pts_info, left.ui8_i_frame_position,
                        left.ui8_frame_position, left.ui8_stc, left.ui8_frame_position_disp));
        assertEquals(
                List.of(2, 3, 4, 5, 6, 13, 14, 17),
                List.of(left.ui4_title_idx, left.ui4_playlist_idx, left.ui4_chap_idx,
                        left.ui2_aud_idx, left.ui2_sub_idx, left.i4_temporal_reference,
                        left.ui2_decoding_order, left.ui4_timestap));
    }

    @Test
    void streamsAreReadSoughtCancelledAndClosed() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[100]) {
            @Override
            public int seekType() {
                return 42;
            }

            @Override
            public long seekTime(long first, long second) {
                return first * 10 + second;
            }
        };
        StreamAdapter adapter = new StreamAdapter(source, new NativeCalls(player));
        adapter.describe();
        player.units.source.use(adapter);
        assertEquals(10, call("readStream", 10));
        assertEquals(30L, call("seekStream", 0, 30L));
        assertEquals(35L, call("seekStreamEx", 1, 5L));
        assertEquals(42, call("getSeekType"));
        assertEquals(56L, call("timeSeekStream", 5L, 6L));
        call("cancelRead");
        assertEquals(1, source.cancels.get());
        call("closeStream");
        assertEquals(1, source.closes.get());
        assertEquals(0, call("readStream", 10), "the end, once it is closed");
    }

    private Object call(String name, Object... arguments) throws Exception {
        Method method = Arrays.stream(OrvMediaPlayer.class.getDeclaredMethods())
                .filter(declared -> declared.getName().equals(name))
                .findFirst()
                .orElseThrow();
        method.setAccessible(true);
        return method.invoke(player, arguments);
    }

    private Object received() throws Exception {
        Field field = player.divx().getClass().getDeclaredField("received");
        field.setAccessible(true);
        return field.get(player.divx());
    }
}
