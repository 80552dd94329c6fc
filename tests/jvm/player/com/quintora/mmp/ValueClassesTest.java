// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertAll;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.internal.media.FourCharacters;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import com.quintora.mmp.util.PcmMediaInfo.AudioPcmInfo;
import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.ThumbnailInfo;
import java.lang.reflect.Modifier;
import java.util.Arrays;
import java.util.List;
import java.util.function.Consumer;
import org.junit.jupiter.api.Test;

/** The classes whose fields the native half reads, and what is made of them. */
class ValueClassesTest {
    @Test
    void theFieldsAreThoseThatTheNativeHalfReads() {
        assertAll(
                () -> assertFields(ThumbnailInfo.class,
                        "mCanvasColormode I", "mThumbnailWidth I", "mThumbnailHeight I"),
                () -> assertFields(PcmMediaInfo.class,
                        "mediaType I", "totalDuration I", "size J", "fgSynchronized I",
                        "audioCodec I",
                        "audioPcmInfo Lcom/quintora/mmp/util/PcmMediaInfo$AudioPcmInfo;"),
                () -> assertFields(AudioPcmInfo.class,
                        "pcm_type I", "channelNumber I", "sampleRate I", "blockAlign S",
                        "bitsPerSample I", "bigEndian I"),
                () -> assertFields(DivxLastMemoryFilePosition.class,
                        "ui8_clip_id J", "ui4_title_idx I", "ui4_playlist_idx I",
                        "ui4_chap_idx I", "ui2_aud_idx I", "ui2_sub_idx I", "ui8_aud_pts_info J",
                        "ui8_aud_frame_position J", "ui8_i_pts_info J", "ui8_pts_info J",
                        "ui8_i_frame_position J", "ui8_frame_position J",
                        "i4_temporal_reference I", "ui2_decoding_order I", "ui8_stc J",
                        "ui8_frame_position_disp J", "ui4_timestap I"));
    }

    @Test
    void theSubtitleAttributesFieldsAreThoseThatTheNativeHalfReads() {
        String nested = "Lcom/quintora/mmp/util/SubtitleAttr$Subtitle_";
        Class<?> attr = com.quintora.mmp.util.SubtitleAttr.class;
        assertTrue(attr.isAssignableFrom(SubtitleAttr.class));
        assertAll(
                () -> assertFields(attr,
                        "mMask I", "mTimeOffset " + nested + "TimeOffset;",
                        "mFontInfo " + nested + "FontInfo;", "mBgColor " + nested + "Color;",
                        "mTextColor " + nested + "Color;", "mEdgColor " + nested + "Color;",
                        "mDisplayOffset " + nested + "DisplayOffset;"),
                () -> assertFields(SubtitleAttr.Subtitle_TimeOffset.class,
                        "mTimeOffsetType I", "mOffsetValue I"),
                () -> assertFields(SubtitleAttr.Subtitle_FontInfo.class,
                        "mFontSizeType I", "mCustomSize B"),
                () -> assertFields(SubtitleAttr.Subtitle_Color.class,
                        "mA B", "mR B", "mG B", "mB B"),
                () -> assertFields(SubtitleAttr.Subtitle_DisplayOffset.class, "mX I", "mY I"));
    }

    @Test
    void aBuilderSetsTheGroupsAndTheirFlags() {
        SubtitleAttr attr = SubtitleAttr.builder()
                .delay(-1500)
                .fontSize(200)
                .backgroundColor(0x80010203)
                .textColor(0xFFFEFDFC)
                .edgeColor(0x00000001)
                .displayOffset(-10, 250)
                .build();
        attr.check();
        assertAll(
                () -> assertEquals(0xBD, attr.mMask),
                () -> assertEquals(1, attr.mTimeOffset.mTimeOffsetType, "earlier"),
                () -> assertEquals(1500, attr.mTimeOffset.mOffsetValue),
                () -> assertEquals(3, attr.mFontInfo.mFontSizeType, "a size of its own"),
                () -> assertEquals((byte) 200, attr.mFontInfo.mCustomSize),
                () -> assertColor(0x80, 1, 2, 3, attr.mBgColor),
                () -> assertColor(0xFF, 0xFE, 0xFD, 0xFC, attr.mTextColor),
                () -> assertColor(0, 0, 0, 1, attr.mEdgColor),
                () -> assertEquals(-10, attr.mDisplayOffset.mX),
                () -> assertEquals(250, attr.mDisplayOffset.mY));
    }

    @Test
    void aBuilderLeavesOutWhatWasNotGiven() {
        SubtitleAttr attr = SubtitleAttr.builder().delay(20).build();
        assertEquals(0x01, attr.mMask);
        assertEquals(0, attr.mTimeOffset.mTimeOffsetType, "later");
        assertNull(attr.mTextColor);
    }

    @Test
    void aBuilderRefusesSizesThatDoNotFit() {
        SubtitleAttr.Builder builder = SubtitleAttr.builder();
        assertThrows(IllegalArgumentException.class, () -> builder.fontSize(0));
        assertThrows(IllegalArgumentException.class, () -> builder.fontSize(256));
        assertThrows(IllegalArgumentException.class, () -> builder.fontSizeType(3));
        assertThrows(IllegalArgumentException.class, () -> builder.fontSizeType(-1));
        assertThrows(IllegalArgumentException.class, () -> builder.displayOffset(1001, 0));
        assertThrows(IllegalArgumentException.class, () -> builder.displayOffset(0, -1001));
    }

    @Test
    void aMaskWithoutItsGroupIsFound() {
        SubtitleAttr attr = new SubtitleAttr();
        attr.mMask = 0x42;
        attr.check();
        attr.mMask = 0x20;
        IllegalArgumentException found =
                assertThrows(IllegalArgumentException.class, attr::check);
        assertEquals("the mask names mEdgColor, which is null", found.getMessage());
    }

    @Test
    void goodPcmDescriptionsPass() {
        PcmMediaInfo.of(48_000, 2, 16).withBigEndian().withLength(1000, 192_000).check();
        PcmMediaInfo.of(8000, 1, 8).check();
        PcmMediaInfo.of(8000, 1, 8).withType(AudioPcmInfo.A_LAW).check();
        PcmMediaInfo.of(384_000, 8, 32).withType(AudioPcmInfo.FLOAT).check();
        assertEquals(AudioPcmInfo.UNSIGNED, PcmMediaInfo.of(8000, 1, 8).audioPcmInfo.pcm_type);
        assertEquals(6, PcmMediaInfo.of(44_100, 2, 24).audioPcmInfo.blockAlign);
    }

    @Test
    void badPcmDescriptionsAreNamed() {
        assertAll(
                () -> assertBadPcm("audioPcmInfo is null", info -> info.audioPcmInfo = null),
                () -> assertBadPcm("the media type 0; only 1, audio, is possible",
                        info -> info.mediaType = 0),
                () -> assertBadPcm("the codec 2; only 1, PCM, is possible",
                        info -> info.audioCodec = 2),
                () -> assertBadPcm("a duration of -1 ms; 0, for unknown, or more is possible",
                        info -> info.totalDuration = -1),
                () -> assertBadPcm(
                        "a size of -1 bytes; 0, for unknown, to 2147483647 are possible",
                        info -> info.size = -1),
                () -> assertBadPcm(
                        "a size of 2147483648 bytes; 0, for unknown, to 2147483647 are possible",
                        info -> info.withLength(0, 1L << 31)));
        PcmMediaInfo.of(48_000, 2, 16).withLength(0, Integer.MAX_VALUE).check();
    }

    @Test
    void badSamplesAreNamed() {
        assertAll(
                () -> assertBadPcm("samples of type 5; 0 to 4 are possible",
                        info -> info.audioPcmInfo.pcm_type = 5),
                () -> assertBadPcm("0 channels; 1 to 8 are possible",
                        info -> info.audioPcmInfo.channelNumber = 0),
                () -> assertBadPcm("9 channels; 1 to 8 are possible",
                        info -> info.audioPcmInfo.channelNumber = 9),
                () -> assertBadPcm("999 samples per second; 1000 to 384000 are possible",
                        info -> info.audioPcmInfo.sampleRate = 999),
                () -> assertBadPcm("12 bits; signed samples have 8, 16, 24 or 32",
                        info -> info.audioPcmInfo.bitsPerSample = 12),
                () -> assertBadPcm("16 bits; unsigned samples have 8",
                        info -> info.audioPcmInfo.pcm_type = 1),
                () -> assertBadPcm("16 bits; floating-point samples have 32",
                        info -> info.audioPcmInfo.pcm_type = 2),
                () -> assertBadPcm("16 bits; A-law and mu-law samples have 8",
                        info -> info.audioPcmInfo.pcm_type = 4),
                () -> assertBadPcm("a block of 3 bytes; one sample of all channels has 4",
                        info -> info.audioPcmInfo.blockAlign = 3));
    }

    @Test
    void codecsAreFourCharacters() {
        assertEquals("h264", FourCharacters.text('h' | '2' << 8 | '6' << 16 | '4' << 24));
        assertEquals("", FourCharacters.text(0));
        assertEquals("a?? ", FourCharacters.text('a' | 0x80 << 8 | 0x01 << 16 | ' ' << 24));
    }

    @Test
    void trackFlagsAreBits() {
        assertTrue(new TrackFlags(1).isDefault());
        assertTrue(new TrackFlags(2).isForced());
        assertTrue(new TrackFlags(4).isExternal());
        assertTrue(new TrackFlags(8).isSelected());
        TrackFlags none = new TrackFlags(~15);
        assertFalse(none.isDefault() || none.isForced() || none.isExternal() || none.isSelected());
    }

    private static void assertBadPcm(String reason, Consumer<PcmMediaInfo> spoil) {
        PcmMediaInfo info = PcmMediaInfo.of(48_000, 2, 16);
        spoil.accept(info);
        IllegalArgumentException found =
                assertThrows(IllegalArgumentException.class, info::check);
        assertEquals("PCM description: " + reason, found.getMessage());
    }

    private static void assertColor(
            int a, int r, int g, int b, SubtitleAttr.Subtitle_Color color) {
        assertEquals(
                List.of((byte) a, (byte) r, (byte) g, (byte) b),
                List.of(color.mA, color.mR, color.mG, color.mB));
    }

    private static void assertFields(Class<?> type, String... expected) {
        List<String> declared = Arrays.stream(type.getDeclaredFields())
                .filter(field -> !Modifier.isStatic(field.getModifiers()))
                .map(field -> field.getName() + " " + field.getType().descriptorString())
                .toList();
        assertEquals(List.of(expected), declared);
    }
}
