// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

class TrickPlayTest extends PlayerFixture {
    @Test
    void trickPlayNeedsMedia() {
        assertThrows(IllegalStateException.class, () -> player.trickPlay().setSpeed(1));
        assertThrows(IllegalStateException.class, () -> player.trickPlay().stepAndWait(1));
        assertThrows(IllegalStateException.class, () -> player.trickPlay().seekToByteAndWait(0));
        assertThrows(IllegalStateException.class, () -> player.trickPlay().repeatFromHere());
        assertThrows(IllegalStateException.class, () -> player.trickPlay().getBytePosition());
        assertEquals(1, player.trickPlay().getSpeed());
        assertEquals(0, player.getBufferedPercent());
    }

    @ParameterizedTest
    @ValueSource(doubles = {2, 4, 0.5})
    void forwardSpeedsMoveOn(double speed) throws Exception {
        prepare("light.mkv");
        assertTrue(player.trickPlay().canPlayAt(speed));
        player.trickPlay().setSpeed(speed);
        assertEquals(speed, player.trickPlay().getSpeed());
        player.start();
        awaitMoving();
        long begin = System.nanoTime();
        int from = player.getCurrentPosition();
        Wait.until("some seconds were played", () -> player.getCurrentPosition() > from + 3000);
        double played = player.getCurrentPosition() - from;
        double real = (System.nanoTime() - begin) / 1e6;
        assertTrue(played < real * speed * 1.5 + 1500, played + " ms in " + real);
        player.trickPlay().setSpeed(1);
        assertEquals(1, player.trickPlay().getSpeed());
    }

    @ParameterizedTest
    @ValueSource(doubles = {-1, -4, -16})
    void backwardSpeedsMoveBack(double speed) throws Exception {
        prepare("light.mkv");
        player.seekToAndWait(40_000);
        assertTrue(player.trickPlay().canPlayAt(speed));
        player.trickPlay().setSpeed(speed);
        player.start();
        Wait.until("it went back", () -> player.getCurrentPosition() < 39_000);
        player.trickPlay().setSpeed(1);
        awaitMoving();
        assertEquals(PlayerState.STARTED, player.getState());
    }

    @Test
    void speedsOutOfRangeAreRefused() throws Exception {
        prepare("long.mkv");
        for (double speed : new double[] {33, -33, Double.NaN, Double.POSITIVE_INFINITY}) {
            assertFalse(player.trickPlay().canSeekAt(speed));
        }
        for (double speed : new double[] {
            33, -33, Double.NaN, Double.POSITIVE_INFINITY, 0, 0.2, -0.2
        }) {
            assertFalse(player.trickPlay().canPlayAt(speed));
            assertThrows(IllegalArgumentException.class,
                    () -> player.trickPlay().setSpeed(speed));
        }
        assertEquals(1, player.trickPlay().getSpeed());
        assertTrue(player.trickPlay().canSeekAt(1));
        player.trickPlay().setSpeed(-TrickPlay.MIN_SPEED);
        assertEquals(-0.25, player.trickPlay().getSpeed());
    }

    @Test
    void aStepPastTheEndHaltsThePlayer() throws Exception {
        prepare("silent.mkv");
        player.start();
        IllegalStateException e = assertThrows(
                IllegalStateException.class, () -> player.trickPlay().stepAndWait(100_000));
        assertTrue(e.getMessage().startsWith("the engine refused step()"), e.getMessage());
        assertEquals(PlayerState.PAUSED, player.getState());
        player.pause();
        player.trickPlay().stepAndWait(-1);
        player.start();
        recorder.await("completion");
        assertThrows(IllegalStateException.class, () -> player.trickPlay().stepAndWait(1));
        assertEquals(PlayerState.COMPLETED, player.getState());
        assertThrows(IllegalStateException.class, () -> player.trickPlay().stepAndWait(-100_000));
        assertEquals(PlayerState.PAUSED, player.getState(), "it left the end");
    }

    @Test
    void aStepWithoutAPictureChangesNothing() throws Exception {
        prepare("tone.mp3");
        assertThrows(IllegalStateException.class, () -> player.trickPlay().stepAndWait(1));
        assertEquals(PlayerState.PREPARED, player.getState());
        player.start();
        awaitMoving();
        assertThrows(IllegalStateException.class, () -> player.trickPlay().stepAndWait(1));
        assertEquals(PlayerState.STARTED, player.getState());
        awaitMoving();
    }

    @Test
    void singleFramesAreShown() throws Exception {
        prepare("long.mkv");
        player.start();
        awaitMoving();
        player.trickPlay().stepAndWait(1);
        assertEquals(PlayerState.PAUSED, player.getState());
        int before = player.getCurrentPosition();
        player.trickPlay().stepAndWait(1);
        Wait.until("one frame of 33 ms passed",
                () -> Math.abs(player.getCurrentPosition() - before - 33) < 10);
        player.trickPlay().stepAndWait(3);
        Wait.until("three more passed",
                () -> Math.abs(player.getCurrentPosition() - before - 133) < 10);
        player.trickPlay().stepAndWait(-2);
        Wait.until("two went back",
                () -> Math.abs(player.getCurrentPosition() - before - 67) < 10);
    }

    @Test
    void aSectionIsRepeated() throws Exception {
        prepare("long.mkv");
        assertFalse(player.trickPlay().repeatUntilHere(), "nothing was begun");
        player.seekToAndWait(10_000);
        assertTrue(player.trickPlay().repeatFromHere());
        player.seekToAndWait(11_000);
        assertTrue(player.trickPlay().repeatUntilHere());
        player.start();
        for (int round = 0; round < 3; round++) {
            Wait.until("the section's end is near", () -> player.getCurrentPosition() > 10_700);
            Wait.until("it begins again", () -> player.getCurrentPosition() < 10_600);
            assertTrue(player.getCurrentPosition() >= 9_900);
        }
        assertTrue(player.trickPlay().repeatOff());
        Wait.until("it plays on", () -> player.getCurrentPosition() > 11_300);
        assertEquals(0, recorder.count("completion"));
    }

    @Test
    void bytePositionsMoveOnAndAreSought() throws Exception {
        prepare("long.mkv");
        long begin = player.trickPlay().getBytePosition();
        assertTrue(begin > 0);
        player.trickPlay().seekToByteAndWait(3_000_000);
        assertEquals(30_000, player.getCurrentPosition(), 10_000);
        assertTrue(player.trickPlay().getBytePosition() > begin);
        recorder.await("seek");
        assertThrows(IllegalArgumentException.class, () -> player.trickPlay().seekToByteAndWait(-1));
        assertThrows(IllegalArgumentException.class,
                () -> player.trickPlay().seekToByteAndWait(1L << 31));
        assertThrows(IllegalStateException.class,
                () -> player.trickPlay().seekToByteAndWait(Integer.MAX_VALUE));
    }

    @Test
    void theNativeHalfCutsBytePositions() throws Exception {
        prepare("long.mkv");
        player.seekToAndWait(30_000);
        player.native_seekToPosition((1L << 32) + 16);
        assertTrue(player.getCurrentPosition() < 2000, "16 bytes from the start");
        assertThrows(IllegalStateException.class, () -> player.native_seekToPosition(1L << 31));
    }

    @Test
    void whatIsBufferedIsAPercentage() throws Exception {
        prepare("long.mkv");
        int percent = player.getBufferedPercent();
        assertTrue(percent >= 0 && percent <= 100, "" + percent);
        player.seekToAndWait(59_000);
        Wait.until("nearly all is read", () -> player.getBufferedPercent() > 95);
    }
}
