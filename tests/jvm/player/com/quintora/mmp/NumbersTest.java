// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.PcmMediaInfo.AudioPcmInfo;
import com.quintora.mmp.util.SubtitleAttr;
import com.quintora.mmp.util.SubtitleAttr.Subtitle_FontInfo;
import com.quintora.mmp.util.SubtitleAttr.Subtitle_TimeOffset;
import java.util.List;
import org.junit.jupiter.api.Test;

/** Numbers that the native half and the engine know, too. */
class NumbersTest extends PlayerFixture {
    @Test
    void subtitleAttributes() {
        assertEquals(List.of(0x01, 0x04, 0x08, 0x10, 0x20, 0x80), List.of(
                SubtitleAttr.FLAG_SUBTITLE_TIME_OFFSET, SubtitleAttr.FLAG_SUBTITLE_FONT_INFO,
                SubtitleAttr.FLAG_SUBTITLE_BG_COLOR, SubtitleAttr.FLAG_SUBTITLE_TEXT_COLOR,
                SubtitleAttr.FLAG_SUBTITLE_EDGE_COLOR,
                SubtitleAttr.FLAG_SUBTITLE_DISPLAY_OFFSET));
        assertEquals(List.of(0, 1), List.of(
                Subtitle_TimeOffset.DELAY, Subtitle_TimeOffset.ADVANCE));
        assertEquals(List.of(0, 1, 2, 3), List.of(
                Subtitle_FontInfo.SMALL, Subtitle_FontInfo.MEDIUM, Subtitle_FontInfo.LARGE,
                Subtitle_FontInfo.CUSTOM));
    }

    @Test
    void pcmFormats() {
        assertEquals(List.of(1, 1), List.of(
                PcmMediaInfo.MEDIA_TYPE_AUDIO, PcmMediaInfo.AUDIO_CODEC_PCM));
        assertEquals(List.of(0, 1, 2, 3, 4), List.of(
                AudioPcmInfo.SIGNED, AudioPcmInfo.UNSIGNED, AudioPcmInfo.FLOAT,
                AudioPcmInfo.A_LAW, AudioPcmInfo.MU_LAW));
    }

    @Test
    void flagsOfTracks() {
        for (int bits = 0; bits < 16; bits++) {
            TrackFlags flags = new TrackFlags(bits);
            assertEquals(List.of((bits & 1) != 0, (bits & 2) != 0, (bits & 4) != 0,
                    (bits & 8) != 0), List.of(flags.isDefault(), flags.isForced(),
                    flags.isExternal(), flags.isSelected()));
        }
    }

    @Test
    void events() throws Exception {
        prepare("video.mp4");
        player.units.nativeEvents.receive(5, 321, 181, null);
        recorder.await("size 321x181");
        player.units.nativeEvents.receive(99, 0, 0, "line".getBytes());
        recorder.await("text line");
        player.units.nativeEvents.receive(200, 3, 0, null);
        recorder.await("info 3 0");
        player.units.nativeEvents.receive(100, 1, -5, null);
        recorder.await("error");
    }
}
