// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.control;

import com.quintora.mmp.PlayerState;
import com.quintora.mmp.internal.base.EngineCall;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.base.PlayerThreads;
import com.quintora.mmp.internal.base.Turns;
import com.quintora.mmp.internal.events.EndOfMedia;
import java.util.EnumSet;
import java.util.concurrent.CompletableFuture;
import org.jetbrains.annotations.Nullable;

/** Seeks, and keeps the state in step with where that leads. Thread-safe. */
public final class Seeking {
    private record Request(int epoch, int millis, CompletableFuture<Boolean> future) {}

    private final NativePlayer natives;
    private final Commands commands;
    private final EndOfMedia end;
    // Of its own: a seek waits for no file of subtitles.
    private final Turns turns = new Turns(PlayerThreads::run);
    private @Nullable Request waiting;

    public Seeking(NativePlayer natives, Commands commands, EndOfMedia end) {
        this.natives = natives;
        this.commands = commands;
        this.end = end;
    }

    /** Seeks in the background; a request that waits gives way to a later one. */
    public CompletableFuture<Boolean> seekTo(int millis) {
        requirePosition(millis);
        int epoch = commands.requireMedia(name("seekTo", millis));
        Request mine = new Request(epoch, millis, new CompletableFuture<>());
        Request overtaken = exchange(mine);
        if (overtaken == null) {
            turns.execute(this::seekToWaiting);
        } else {
            PlayerThreads.run(() -> overtaken.future().complete(false));
        }
        return mine.future();
    }

    private void seekToWaiting() {
        Request next = exchange(null);
        String call = name("seekTo", next.millis());
        Background.complete(next.future(), commands, call, next.epoch(), () -> {
            seek(call, () -> natives.seekTo(next.millis()));
            return true;
        });
    }

    private synchronized @Nullable Request exchange(@Nullable Request next) {
        Request before = waiting;
        waiting = next;
        return before;
    }

    public void seekToAndWait(int millis) {
        requirePosition(millis);
        seek(name("seekToAndWait", millis), () -> natives.seekTo(millis));
    }

    /** Seeks by any means: the engine's call returns when it is done. */
    public void seek(String call, EngineCall command) {
        int epoch = begin(call);
        boolean done = false;
        try {
            commands.run(call, command);
            done = true;
        } finally {
            follow(epoch, done);
            commands.runsOtherwise();
            commands.events.seekEnds(epoch, done);
        }
    }

    private int begin(String call) {
        commands.states.commands.lock();
        try {
            commands.noticeEnd();
            int epoch = commands.requireMedia(call);
            commands.events.seekBegins(epoch);
            return epoch;
        } finally {
            commands.states.commands.unlock();
            commands.events.flush();
        }
    }

    /** After a seek: it leaves the end, of which the engine may have known before the state did. */
    private void follow(int epoch, boolean done) {
        commands.states.commands.lock();
        try {
            boolean playing = natives.isPlaying();
            boolean ended = !playing && end.isReached();
            if (commands.states.isStill(epoch, PlayerState.STARTED) && !playing && !ended) {
                natives.start(); // Sought from the end the engine halts; others are waiting.
            } else if (done || !ended) {
                commands.states.move(epoch, EnumSet.of(PlayerState.COMPLETED),
                        playing ? PlayerState.STARTED : PlayerState.PAUSED);
            }
        } catch (IllegalStateException e) {
            // The media failed, and the next look finds it; or the player was released.
        } finally {
            commands.states.commands.unlock();
        }
    }

    private static void requirePosition(int millis) {
        if (millis < 0) {
            throw new IllegalArgumentException("a position cannot be negative: " + millis);
        }
    }

    private static String name(String call, int millis) {
        return call + "(" + millis + ")";
    }
}
