// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;

import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** What titles are written in. */
class LettersTest {
    private static final int ALL_OF_IT = -1;

    @ParameterizedTest
    @ValueSource(strings = {"Ελληνικά Русский", "电影", "電影", "映画ひカ", "영화", "فيلم", "क्षत्रिय"})
    void everyScriptHasLetters(String title) {
        assertEquals(ALL_OF_IT, Theme.title().canDisplayUpTo(title));
        assertEquals(ALL_OF_IT, Theme.small().canDisplayUpTo(title));
    }
}
