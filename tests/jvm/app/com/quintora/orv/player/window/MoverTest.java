// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import com.quintora.orv.player.Failure;
import java.util.ArrayDeque;
import java.util.ArrayList;
import java.util.List;
import java.util.Queue;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** How moves add up while the player is busy, and what is said of them. */
class MoverTest {
    /** Records what it is to do; keys are pressed while it seeks. */
    private static final class Film implements Mover.Playback {
        private final List<String> calls = new ArrayList<>();
        private int position;
        private int duration = 600_000;
        private int shortOfGoal;
        private Runnable duringSeek = () -> {};

        @Override
        public int position() {
            return position;
        }

        @Override
        public int duration() {
            return duration;
        }

        @Override
        public int seekTo(int millis) throws Failure {
            calls.add("seek " + millis);
            Runnable keys = duringSeek;
            duringSeek = () -> {};
            keys.run();
            position = millis - shortOfGoal;
            return position;
        }

        @Override
        public void step(int frames) throws Failure {
            calls.add("step " + frames);
        }
    }

    private final Film film = new Film();
    private final Queue<Playing.Command> tasks = new ArrayDeque<>();
    private final List<String> notices = new ArrayList<>();
    private final Mover mover = new Mover(film, tasks::add, notices::add);

    @ParameterizedTest
    @CsvSource({
        "5000, 10000, 60000, 15000", "55000, 10000, 60000, 60000", "5000, -10000, 60000, 0",
        "5000, 10000, 0, 15000", "5000, -10000, 0, 0", "2147483000, 10000, 0, 2147483647"
    })
    void aSkipEndsWithinTheMedia(int from, int by, int duration, int goal) {
        assertEquals(goal, Move.NONE.plusSkip(by).goal(from, duration));
    }

    @Test
    void aKeyThatIsHeldDownIsOneSeekAtATime() throws Failure {
        film.duringSeek = () -> press(40, 10_000);
        mover.skip(10_000);
        runAll();
        assertEquals(List.of("seek 10000", "seek 410000"), film.calls);
    }

    @Test
    void keysPressedBeforeTheFirstSeekAreOne() throws Failure {
        press(3, 1_000);
        press(1, -60_000);
        film.position = 70_000;
        runAll();
        assertEquals(List.of("seek 13000"), film.calls);
    }

    /** Where seeks end early, as in sound with few places to seek to, keys lead on all the same. */
    @Test
    void aSkipBeginsWhereTheOneBeforeWasToLead() throws Failure {
        film.shortOfGoal = 800;
        film.duringSeek = () -> mover.skip(1_000);
        mover.skip(1_000);
        runAll();
        assertEquals(List.of("seek 1000", "seek 2000"), film.calls);
    }

    @Test
    void onlyTheLatestPlaceOfTheBarCounts() throws Failure {
        film.duringSeek = () -> {
            for (int at = 1_000; at <= 50_000; at += 1_000) {
                mover.seekTo(at);
            }
        };
        mover.skip(10_000);
        runAll();
        assertEquals(List.of("seek 10000", "seek 50000"), film.calls);
    }

    @Test
    void framesAddUpAfterTheSeek() throws Failure {
        film.position = 20_000;
        mover.step(1);
        mover.step(1);
        mover.skip(-10_000);
        mover.step(-1);
        runAll();
        assertEquals(List.of("seek 10000", "step 1"), film.calls);
        mover.step(2);
        mover.step(-2);
        runAll();
        assertEquals(2, film.calls.size(), "nothing to do");
    }

    @Test
    void aNoticeSaysHowFarItWentAndWhere() throws Failure {
        mover.skip(60_000);
        runAll();
        assertEquals(List.of("+ 60 s …", "+ 60 s  1:00"), notices);
        notices.clear();
        film.duration = 64_500;
        mover.skip(10_000);
        runAll();
        assertEquals(List.of("+ 10 s …", "+ 4.5 s  1:04"), notices);
        notices.clear();
        film.position = 12_030;
        mover.skip(-1_000);
        runAll();
        assertEquals(List.of("− 1 s …", "− 1 s  0:11"), notices);
    }

    @Test
    void whatFailsLeavesTheNextOneToBeCarriedOut() throws Failure {
        film.duringSeek = () -> {
            mover.skip(10_000);
            throw new IllegalStateException("no");
        };
        mover.skip(10_000);
        assertThrows(IllegalStateException.class, this::runAll);
        runAll();
        assertEquals(List.of("seek 10000", "seek 10000"), film.calls);
    }

    private void press(int times, int millis) {
        for (int i = 0; i < times; i++) {
            mover.skip(millis);
        }
    }

    private void runAll() throws Failure {
        while (!tasks.isEmpty()) {
            tasks.remove().run();
        }
    }
}
