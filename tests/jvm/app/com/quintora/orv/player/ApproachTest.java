// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.Arrays;
import java.util.Random;
import java.util.stream.IntStream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;
import org.junit.jupiter.params.provider.EnumSource;
import org.junit.jupiter.params.provider.ValueSource;

/** The way to a frame's time, for steady and variable rates. */
class ApproachTest {
    /**
     * How a step of many frames is made: by counting them, or by the time that so many take, to the
     * frame that is shown then or to the next.
     */
    private enum Steps {
        COUNTED,
        TIMED,
        TIMED_TO_NEXT
    }

    /** Frames at given times, with a key frame every so many. */
    private static final class Frames implements Approach.Film {
        private final int[] times;
        private final double rate;
        private final int keyFrames;
        private final Steps steps;
        private int at;
        private int calls;
        private int seeks;
        private boolean isAtFrame = true;

        Frames(int[] times, double rate, int keyFrames, Steps steps) {
            this.times = times;
            this.rate = rate;
            this.keyFrames = keyFrames;
            this.steps = steps;
        }

        @Override
        public void seekTo(int millis) {
            seeks++;
            at = shownAt(millis);
            at -= at % keyFrames;
        }

        @Override
        public boolean step(int frames) {
            calls++;
            long goal = at + frames;
            if (steps != Steps.COUNTED && Math.abs(frames) > 3) {
                int time = (int) Math.round(times[at] + frames * 1000 / rate);
                boolean next = steps == Steps.TIMED_TO_NEXT;
                goal = next ? shownAt(time - 2) + 1 : shownAt(time + 1);
            }
            at = (int) Math.max(0, Math.min(goal, times.length - 1));
            return at == goal;
        }

        @Override
        public int position() {
            return times[at];
        }

        @Override
        public boolean isAtFrame() {
            return isAtFrame;
        }

        int shownAt(int millis) {
            int found = Arrays.binarySearch(times, millis);
            return Math.max(0, found >= 0 ? found : -found - 2);
        }
    }

    private static int[] steady(double rate, int count) {
        return IntStream.range(0, count)
                .map(i -> (int) Math.round(i * 1000 / rate))
                .toArray();
    }

    /** As a telephone writes them: some are late, and now and then there is a burst or a gap. */
    private static int[] variable(int count) {
        Random random = new Random(7);
        int[] times = new int[count];
        for (int i = 1; i < count; i++) {
            int usual = 25 + random.nextInt(17);
            int length = random.nextInt(40) == 0 ? 900 : random.nextInt(20) == 0 ? 8 : usual;
            times[i] = times[i - 1] + length;
        }
        return times;
    }

    @ParameterizedTest
    @CsvSource({
        "30, COUNTED", "30, TIMED", "25, COUNTED", "29.97, TIMED",
        "29.97, TIMED_TO_NEXT", "23.976, TIMED", "59.94, TIMED",
        "1, COUNTED", "1, TIMED"
    })
    void steadyMediaTakesAStepAfterTheFirstSeek(double rate, Steps steps) {
        var frames = new Frames(steady(rate, 4_000), rate, 300, steps);
        Approach approach = new Approach(frames, rate);
        approach.to(10_000);
        for (int millis = 0; millis < 60_000; millis += 777) {
            frames.calls = 0;
            approach.to(millis);
            // The rounding may have put a frame a millisecond later.
            assertTrue(
                    frames.at == frames.shownAt(millis) || frames.at == frames.shownAt(millis + 1),
                    millis + " led to " + frames.position());
            assertTrue(frames.calls <= 2, frames.calls + " steps to " + millis);
        }
    }

    @ParameterizedTest
    @ValueSource(ints = {10_000, 9_999, 9_960, 13_777, 24_900, 25_100, 5, 40_000})
    void whatIsNearIsOneStepWithoutASeek(int millis) {
        var frames = new Frames(steady(25, 2_000), 25, 250, Steps.COUNTED);
        Approach approach = new Approach(frames, 25);
        approach.to(10_000);
        frames.calls = 0;
        frames.seeks = 0;
        approach.to(millis);
        assertEquals(frames.shownAt(millis + 1), frames.at);
        boolean isNear = Math.abs(millis - 10_000) < 15_000;
        assertEquals(isNear ? 0 : 1, frames.seeks);
        assertTrue(frames.calls <= 1, frames.calls + " steps");
    }

    /** As at the end of the media, where the position is the duration. */
    @Test
    void noStepBeginsWhereNoFrameIs() {
        var frames = new Frames(steady(25, 2_000), 25, 250, Steps.COUNTED);
        frames.isAtFrame = false;
        Approach approach = new Approach(frames, 25);
        approach.to(10_000);
        approach.to(11_000);
        assertEquals(11_000, frames.position());
        assertEquals(2, frames.seeks);
    }

    @ParameterizedTest
    @EnumSource
    void variableMediaEndsAtTheFrameThatIsShown(Steps steps) {
        var frames = new Frames(variable(2_000), 20, 250, steps);
        Approach approach = new Approach(frames, 20);
        int end = frames.times[1_999];
        // The first way is made without having seen how variable they are.
        approach.to(end / 2);
        for (int millis = 0; millis < end; millis += 997) {
            approach.to(millis);
            assertEquals(frames.shownAt(millis + 1), frames.at, "at " + millis);
        }
    }

    /** Thirty a second are promised, and after the first second there is one a second. */
    @ParameterizedTest
    @EnumSource
    void fewerFramesThanTheRateSays(Steps steps) {
        int[] times = IntStream.concat(
                        IntStream.range(0, 30).map(i -> Math.round(i * 100 / 3f)),
                        IntStream.range(1, 9).map(second -> second * 1000))
                .toArray();
        var frames = new Frames(times, 30, 60, steps);
        new Approach(frames, 30).to(4_500);
        assertEquals(4_000, frames.position());
        new Approach(frames, 30).to(60_000);
        assertEquals(8_000, frames.position());
    }

    /** As in containers whose seeks are a guess. */
    @ParameterizedTest
    @ValueSource(ints = {0, 500, 7_330, 39_990})
    void aSeekThatEndsLateIsMadeUpFor(int millis) {
        var frames = new Frames(steady(25, 1_000), 25, 50, Steps.COUNTED);
        Approach.Film late = new Approach.Film() {
            @Override
            public void seekTo(int goal) {
                frames.seekTo(Math.min(goal + 3_000, 39_000));
            }

            @Override
            public boolean step(int count) {
                return frames.step(count);
            }

            @Override
            public int position() {
                return frames.position();
            }

            @Override
            public boolean isAtFrame() {
                return false;
            }
        };
        new Approach(late, 25).to(millis);
        assertEquals(frames.shownAt(millis + 1), frames.at);
    }

    @ParameterizedTest
    @ValueSource(ints = {0, 500, 999})
    void allFramesMayBeLater(int millis) {
        var frames = new Frames(new int[] {1_000, 1_040, 1_080}, 25, 3, Steps.COUNTED);
        new Approach(frames, 25).to(millis);
        assertEquals(1_000, frames.position());
    }

    /** As a thumbnail of a photograph, of which a step takes its time. */
    @Test
    void aSeekThatIsExactNeedsNoStep() {
        var frames = new Frames(steady(25, 100), 25, 50, Steps.COUNTED);
        frames.isAtFrame = false;
        Approach approach = new Approach(frames, 25);
        approach.to(0);
        approach.to(2_000);
        assertEquals(2_000, frames.position());
        assertEquals(0, frames.calls);
    }

    @ParameterizedTest
    @ValueSource(ints = {0, 5_000})
    void oneFrameIsAllThereIs(int millis) {
        var frames = new Frames(new int[] {0}, 25, 1, Steps.COUNTED);
        new Approach(frames, 25).to(millis);
        assertEquals(0, frames.position());
        assertTrue(frames.calls <= 2, frames.calls + " steps");
    }
}
