// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.subtitles;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.util.SubtitleAttr.Subtitle_TimeOffset;
import java.util.HashMap;
import java.util.Map;
import org.junit.jupiter.api.Test;

class SubtitleLookTest {
    private static final SubtitleLook OWN =
            SubtitleLook.USUAL
                    .withSize(LetterSize.HUGE)
                    .withTextColor(0xFF123456)
                    .withEdgeColor(0xFF00FF00)
                    .withGroundColor(0x80000000)
                    .withSide(Side.RIGHT)
                    .withLift(35);

    @Test
    void aLookIsFoundAgain() {
        Map<String, String> values = new HashMap<>();
        OWN.withDelay(700).remember(values);
        assertEquals(OWN, SubtitleLook.in(values), "all but the delay");
    }

    @Test
    void nonsenseIsTheUsualLook() {
        assertEquals(SubtitleLook.USUAL, SubtitleLook.in(Map.of()));
        assertEquals(
                SubtitleLook.USUAL,
                SubtitleLook.in(
                        Map.of(
                                "subtitles.size", "enormous",
                                "subtitles.color", "#12345",
                                "subtitles.edge", "red",
                                "subtitles.side", "",
                                "subtitles.lift", "-5")));
        assertEquals(90, SubtitleLook.in(Map.of("subtitles.lift", "999")).lift());
    }

    @Test
    void onlyChangesAreGivenToThePlayer() {
        assertTrue(OWN.changesFrom(OWN).isEmpty());
        SubtitleAttr attr = OWN.withDelay(-300).changesFrom(OWN).orElseThrow();
        assertEquals(SubtitleAttr.FLAG_SUBTITLE_TIME_OFFSET, attr.mMask);
        assertEquals(Subtitle_TimeOffset.ADVANCE, attr.mTimeOffset.mTimeOffsetType);
        assertEquals(300, attr.mTimeOffset.mOffsetValue);
        SubtitleAttr place = OWN.changesFrom(OWN.withSide(Side.LEFT)).orElseThrow();
        assertEquals(SubtitleAttr.FLAG_SUBTITLE_DISPLAY_OFFSET, place.mMask);
        assertTrue(place.mDisplayOffset.mX < 0, "from the right edge");
        assertEquals(-350, place.mDisplayOffset.mY);
    }

    @Test
    void sizesAndLiftsEndWhereTheyEnd() {
        assertEquals(LetterSize.TINY, LetterSize.SMALL.plus(-5));
        assertEquals(LetterSize.GIANT, LetterSize.HUGE.plus(5));
        assertEquals(0, OWN.withLift(-10).lift());
        assertEquals(-3_600_000, OWN.withDelay(Integer.MIN_VALUE).delayMs());
    }
}
