// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Failure;
import com.quintora.orv.player.Times;
import java.text.DecimalFormat;
import java.text.DecimalFormatSymbols;
import java.util.Locale;
import java.util.OptionalInt;
import java.util.concurrent.atomic.AtomicReference;
import java.util.function.Consumer;
import java.util.function.UnaryOperator;

/**
 * Carries out moves one after the other. Those that are asked for meanwhile, as by a key that is
 * held down, become one: however many there are, only one waits. Thread-safe.
 */
final class Mover {
    /** What is moved. Times are in milliseconds. */
    interface Playback {
        int position();

        int duration();

        /** Blocks; gives where it ended. */
        int seekTo(int millis) throws Failure;

        /** Blocks. */
        void step(int frames) throws Failure;
    }

    private final Playback playback;
    private final Consumer<Playing.Command> later;
    private final Consumer<String> notice;
    private final AtomicReference<Move> waiting = new AtomicReference<>();

    /** Moves run where later puts them, one at a time; notices come from any thread. */
    Mover(Playback playback, Consumer<Playing.Command> later, Consumer<String> notice) {
        this.playback = playback;
        this.later = later;
        this.notice = notice;
    }

    void seekTo(int millis) {
        add(move -> Move.to(millis));
    }

    void skip(int millis) {
        Move move = add(before -> before.plusSkip(millis));
        if (move.place().isEmpty()) {
            notice.accept(distance(move.skip()) + " …");
        }
    }

    void step(int frames) {
        add(before -> before.plusFrames(frames));
    }

    private Move add(UnaryOperator<Move> addition) {
        Move before = waiting.getAndUpdate(move -> addition.apply(orNone(move)));
        if (before == null) {
            later.accept(this::run);
        }
        return addition.apply(orNone(before));
    }

    private static Move orNone(Move move) {
        return move == null ? Move.NONE : move;
    }

    // What is added while a move runs begins where that was to lead, exactly.
    private void run() throws Failure {
        OptionalInt reached = OptionalInt.empty();
        for (Move move; (move = waiting.getAndSet(null)) != null; ) {
            reached = carryOut(move, reached);
        }
    }

    private OptionalInt carryOut(Move move, OptionalInt reached) throws Failure {
        OptionalInt goal = move.seeks() ? seek(move, reached) : reached;
        if (move.frames() == 0) {
            return goal;
        }
        playback.step(move.frames());
        return OptionalInt.empty();
    }

    private OptionalInt seek(Move move, OptionalInt reached) throws Failure {
        int from = playback.position();
        int goal = move.goal(reached.orElse(from), playback.duration());
        int end = playback.seekTo(goal);
        if (move.place().isEmpty()) {
            notice.accept(distance(end - from) + "  " + Times.clock(end));
        }
        return OptionalInt.of(goal);
    }

    /** As in "+ 10 s"; a frame more or less does not show. */
    static String distance(int millis) {
        String seconds =
                new DecimalFormat("0.#", DecimalFormatSymbols.getInstance(Locale.ROOT))
                        .format(Math.abs(millis) / 1000.0);
        return (millis < 0 ? "− " : "+ ") + seconds + " s";
    }
}
