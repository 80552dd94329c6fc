// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.PlayerState;
import com.quintora.mmp.TrickPlay;
import java.io.IOException;
import java.util.concurrent.CompletableFuture;
import java.util.function.BooleanSupplier;
import org.jetbrains.annotations.Nullable;

/** Speeds, steps, repeated sections and byte positions of fake media. */
final class FakeTrickPlay implements TrickPlay {
    private static final double MILLIS_PER_SECOND = 1000;

    private final FakeSession session;

    FakeTrickPlay(FakeSession session) {
        this.session = session;
    }

    @Override
    public void setSpeed(double speed) {
        session.guard.run(() -> {
            session.state.requireMedia("setSpeed()");
            if (!Playhead.inRange(speed)) {
                throw new IllegalArgumentException("this media cannot be played at speed " + speed);
            }
            session.head.setSpeed(speed);
        });
    }

    @Override
    public double getSpeed() {
        return session.guard.ask(() -> {
            session.state.requireAlive("getSpeed()");
            return session.head.speed();
        });
    }

    @Override
    public boolean canSeekAt(double speed) {
        return can("canSeekAt()", () -> speed == 0 || Playhead.inRange(speed));
    }

    @Override
    public boolean canPlayAt(double speed) {
        return can("canPlayAt()", () -> Playhead.inRange(speed));
    }

    @Override
    public CompletableFuture<Void> step(int frames) {
        return session.guard.ask(() -> {
            session.state.requireMedia("step()");
            IllegalStateException failure = move(frames);
            return failure == null
                    ? CompletableFuture.completedFuture(null)
                    : CompletableFuture.failedFuture(failure);
        });
    }

    @Override
    public void stepAndWait(int frames) {
        session.guard.run(() -> {
            session.state.requireMedia("stepAndWait()");
            IllegalStateException failure = move(frames);
            if (failure != null) {
                throw failure;
            }
        });
    }

    @Override
    public boolean repeatFromHere() {
        return repeat("repeatFromHere()", () -> {
            session.head.repeatFromHere();
            return true;
        });
    }

    @Override
    public boolean repeatUntilHere() {
        return repeat("repeatUntilHere()", session.head::repeatUntilHere);
    }

    @Override
    public boolean repeatOff() {
        return repeat("repeatOff()", () -> {
            session.head.repeatOff();
            return true;
        });
    }

    @Override
    public long getBytePosition() throws IOException {
        return session.guard.ask(() -> {
            session.state.requireMedia("getBytePosition()");
            double bytesPerMilli = bytesPerMilli();
            if (bytesPerMilli == 0) {
                throw new IOException("the media's size or duration is unknown");
            }
            return (long) (session.head.position() * bytesPerMilli);
        });
    }

    @Override
    public CompletableFuture<Void> seekToByte(long position) {
        return session.guard.ask(() -> {
            IllegalStateException failure = moveToByte("seekToByte", position);
            return failure == null
                    ? CompletableFuture.completedFuture(null)
                    : CompletableFuture.failedFuture(failure);
        });
    }

    @Override
    public void seekToByteAndWait(long position) {
        session.guard.run(() -> {
            IllegalStateException failure = moveToByte("seekToByteAndWait", position);
            if (failure != null) {
                throw failure;
            }
        });
    }

    private @Nullable IllegalStateException moveToByte(String call, long position) {
        session.state.requireMedia(call + "()");
        if (position < 0 || position > Integer.MAX_VALUE) {
            throw new IllegalArgumentException("the byte position is out of range: " + position);
        }
        if (bytesPerMilli() == 0) {
            return new IllegalStateException("the engine refused " + call + "(" + position + ")");
        }
        session.seekTo(position / bytesPerMilli());
        return null;
    }

    /** 0 when the size or the duration is unknown. */
    private double bytesPerMilli() {
        FakeMedia media = session.opened();
        return media.duration().isZero() ? 0 : media.size() / (double) media.duration().toMillis();
    }

    /** Goes as far as there are frames; a failure says that there were fewer, or none at all. */
    private @Nullable IllegalStateException move(int frames) {
        double rate = session.opened().picture().map(track -> track.frameRate()).orElse(0.0);
        if (rate == 0) {
            return new IllegalStateException("the engine refused step()");
        }
        double target = session.head.position() + frames * MILLIS_PER_SECOND / rate;
        double before = session.head.position();
        boolean there = session.head.goTo(target);
        if (there || session.head.position() != before) {
            session.state.set(PlayerState.PAUSED);
        }
        return there ? null : new IllegalStateException("the engine refused step()");
    }

    private boolean can(String call, BooleanSupplier answer) {
        return session.guard.ask(() -> {
            session.state.requireAlive(call);
            return session.state.hasMedia() && answer.getAsBoolean();
        });
    }

    private boolean repeat(String call, BooleanSupplier change) {
        return session.guard.ask(() -> {
            session.state.requireMedia(call);
            return change.getAsBoolean();
        });
    }
}
