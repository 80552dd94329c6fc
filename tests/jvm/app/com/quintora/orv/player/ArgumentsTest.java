// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.PcmMediaInfo.AudioPcmInfo;
import java.util.List;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;
import org.junit.jupiter.params.provider.ValueSource;
import picocli.CommandLine.TypeConversionException;

/** What people write for times, sizes, sections and PCM formats. */
class ArgumentsTest {
    @ParameterizedTest
    @CsvSource({
        "0, 0", "7, 7000", "75.5, 75500", "1:15.5, 75500", "0:01:15.5, 75500", "2:00:00, 7200000",
        "90:00, 5400000", "0.0004, 0", "0.0006, 1", "2147483, 2147483000"
    })
    void timesAreSecondsOrAClock(String text, int millis) {
        assertEquals(millis, Times.parseMillis(text));
    }

    @ParameterizedTest
    @ValueSource(
            strings = {"", "x", "-1", "1:", ":1", "1:2:3:4", "1e3", "1.", "2147484", "999:9999:9"})
    void whatIsNoTimeIsNamed(String text) {
        var e = assertThrows(TypeConversionException.class, () -> Times.parseMillis(text));
        assertTrue(e.getMessage().contains("'" + text + "'"), e.getMessage());
    }

    @ParameterizedTest
    @CsvSource({
        "-5, 0:00", "0, 0:00", "999, 0:00", "59999, 0:59", "60000, 1:00", "3599999, 59:59",
        "3600000, 1:00:00", "36061000, 10:01:01"
    })
    void clocksShowHoursFromAnHourOn(long millis, String clock) {
        assertEquals(clock, Times.clock(millis));
    }

    @Test
    void mediaAreNamedBetweenOptions() {
        PlayOptions options =
                PlayOptions.of("a.mkv", "b.mkv", "--loop", "c.mkv", "--volume", "7", "d.mkv");
        assertEquals(List.of("a.mkv", "b.mkv", "c.mkv", "d.mkv"), options.sources());
        assertEquals("a.mkv", options.source);
        assertEquals(List.of(), PlayOptions.of("--loop").sources());
    }

    @Test
    void sizes() {
        assertEquals(new Size(320, 180), Size.parse("320x180"));
        assertEquals(new Size(1, 255), Size.parse("1X255"));
        for (String text : new String[] {"", "320", "320x", "0x5", "5x0", "-1x5", "5*5"}) {
            assertThrows(TypeConversionException.class, () -> Size.parse(text), text);
        }
    }

    @ParameterizedTest
    @CsvSource({
        "10:20, 10000, 20000", "1.5:2.5, 1500, 2500", "0:10-0:20, 10000, 20000", "0-5, 0, 5000"
    })
    void sections(String text, int from, int to) {
        assertEquals(new Section(from, to), Section.parse(text));
    }

    @ParameterizedTest
    @ValueSource(
            strings = {"", "5", ":5", "5:", "5:5", "6:5", "a:b", "-5:5", "1:10:20", "1:10:1:20"})
    void whatIsNoSectionIsRefused(String text) {
        assertThrows(TypeConversionException.class, () -> Section.parse(text));
    }

    @ParameterizedTest
    @CsvSource({
        "44100:2:s16le, 0, 16, 0, 4", "48000:1:s24be, 0, 24, 1, 3", "8000:1:u8, 1, 8, 0, 1",
        "48000:6:f32le, 2, 32, 0, 24", "8000:1:alaw, 3, 8, 0, 1", "8000:2:mulaw, 4, 8, 0, 2"
    })
    void pcmFormats(String text, int type, int bits, int bigEndian, int blockAlign) {
        PcmMediaInfo info = PcmFormat.parse(text);
        AudioPcmInfo pcm = info.audioPcmInfo;
        assertEquals(type, pcm.pcm_type);
        assertEquals(bits, pcm.bitsPerSample);
        assertEquals(bigEndian, pcm.bigEndian);
        assertEquals(blockAlign, pcm.blockAlign);
        String format = text.substring(text.lastIndexOf(':'));
        assertEquals(text, pcm.sampleRate + ":" + pcm.channelNumber + format);
    }

    @ParameterizedTest
    @ValueSource(
            strings = {
                "", "44100", "44100:2", "44100:2:", "44100:2:s12le", "44100:9:s16le",
                "44100:0:s16le", "10:2:s16le", "44100:2:f16le", "44100:2:u16le", "x:2:s16le"
            })
    void whatIsNoPcmFormatIsRefused(String text) {
        assertThrows(TypeConversionException.class, () -> PcmFormat.parse(text));
    }
}
