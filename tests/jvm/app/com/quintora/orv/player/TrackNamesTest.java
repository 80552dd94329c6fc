// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.TrackFlags;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** What people call tracks and languages. */
class TrackNamesTest {
    @ParameterizedTest
    @CsvSource({
        "de, German", "deu, German", "ger, German", "eng, English", "wel, Welsh", "zho, Chinese",
        "chi, Chinese", "pt-BR, Portuguese", "xyz, xyz"
    })
    void languages(String code, String name) {
        assertEquals(name, TrackNames.language(code));
    }

    @Test
    void aTrackIsCalledByWhatItHas() {
        assertEquals("Full  (Japanese)", name("Full", "jpn"));
        assertEquals("Full", name("Full", "und"));
        assertEquals("Japanese", name("", "jpn"));
        assertEquals("Track 3", name("", ""));
    }

    private static String name(String title, String language) {
        return TrackNames.of(new SubtitleTrack(2, 0, "srt ", language, title, new TrackFlags(0)));
    }
}
