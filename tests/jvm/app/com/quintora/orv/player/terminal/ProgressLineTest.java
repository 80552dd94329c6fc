// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.terminal;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.orv.player.Snapshot;
import org.junit.jupiter.api.Test;

/** The words and the bar that tell how far a playback is. */
class ProgressLineTest {
    private static Snapshot at(int positionMs, int durationMs) {
        return new Snapshot(positionMs, durationMs, true, 1, 75, 150, 2);
    }

    @Test
    void theBarIsFilledUpToThePositionAndDottedUpToWhatIsBuffered() {
        String line = ProgressLine.bar(at(5_000, 10_000), 72);
        assertTrue(line.startsWith("▶ 0:05 ━"), line);
        assertTrue(line.endsWith(" 0:10  1x  75% buffered  150 shown, 2 dropped"), line);
        String bar = line.substring(7, line.indexOf(" 0:10"));
        long played = bar.chars().filter(c -> c == '━').count();
        long buffered = played + bar.chars().filter(c -> c == '╌').count();
        assertEquals(bar.length() / 2, played);
        assertEquals(bar.length() * 3 / 4, buffered);
    }

    @Test
    void noLineIsWiderThanItsTerminal() {
        for (int columns = 1; columns < 200; columns++) {
            String line = ProgressLine.bar(at(5_000, 10_000), columns);
            assertTrue(line.length() < columns, columns + ": " + line);
        }
    }

    @Test
    void aDurationThatIsUnknownLeavesTheBarToTheBuffer() {
        String line = ProgressLine.bar(new Snapshot(5_000, 0, false, -2.5, 0, 0, 0), 80);
        assertTrue(line.startsWith("⏸ 0:05  "), line);
        assertTrue(line.contains(" –:––  -2.50x"), line);
    }

    @Test
    void logsSayThatADurationIsUnknown() {
        String line = ProgressLine.plain(new Snapshot(5_000, 0, true, 1, 0, 0, 0));
        assertTrue(line.startsWith("5.0 s of unknown length, 1x"), line);
    }

    @Test
    void logsGetWords() {
        assertEquals(
                "5.0 s of 10.0 s, 1x  75% buffered  150 shown, 2 dropped",
                ProgressLine.plain(at(5_000, 10_000)));
    }
}
