// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.internal.base.Arguments;
import com.quintora.mmp.internal.base.Uncaught;
import com.quintora.mmp.internal.failure.Failures;
import com.quintora.mmp.internal.source.CurrentSource;
import com.quintora.mmp.internal.state.StateMachine;
import java.util.EnumSet;
import java.util.Set;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.CopyOnWriteArrayList;
import java.util.concurrent.Executor;
import java.util.function.BooleanSupplier;
import java.util.function.Consumer;
import org.jetbrains.annotations.Nullable;

/**
 * Everything that is reported of a player passes here, whether a look at it found it or the native
 * half sent it, and is reported once. Thread-safe; no lock is held while listeners are called.
 */
public final class Events {
    private static final Set<PlayerState> CAN_FAIL = EnumSet.of(
            PlayerState.PREPARING, PlayerState.PREPARED, PlayerState.STARTED, PlayerState.PAUSED,
            PlayerState.COMPLETED, PlayerState.STOPPED);

    private final MediaPlayer player;
    private final StateMachine states;
    private final CurrentSource source;
    private final EventQueue queue;
    private final CopyOnWriteArrayList<PlayerListener> listeners = new CopyOnWriteArrayList<>();
    private final PendingPrepare pendingPrepare = new PendingPrepare();
    private Reported reported = new Reported();

    public Events(
            MediaPlayer player, StateMachine states, CurrentSource source, Executor executor) {
        this.player = player;
        this.states = states;
        this.source = source;
        queue = new EventQueue(executor, states::isCurrent);
    }

    public void addListener(PlayerListener listener) {
        states.requireAlive("addListener()");
        listeners.addIfAbsent(Arguments.require(listener, "the listener"));
    }

    public void removeListener(@Nullable PlayerListener listener) {
        listeners.remove(listener);
    }

    public void removeAllListeners() {
        listeners.clear();
    }

    /** A future for the end of the prepare that this epoch is in. */
    public CompletableFuture<Void> awaitPrepared(int epoch) {
        return pendingPrepare.begin(epoch, source.name());
    }

    /** Returns whether that was news. */
    public boolean prepared(int epoch) {
        boolean news = reportIf(
                epoch, () -> move(epoch, PlayerState.PREPARING, PlayerState.PREPARED),
                listener -> listener.onPrepared(player));
        pendingPrepare.succeeded(epoch);
        return news;
    }

    public void completed(int epoch) {
        reportIf(epoch, () -> ends(epoch), listener -> listener.onCompletion(player));
    }

    public void failed(int epoch, Exception thrown) {
        MediaException error =
                Failures.explain(source.name(), thrown, source.stream().failure());
        reportIf(epoch, () -> states.move(epoch, CAN_FAIL, PlayerState.ERROR),
                listener -> listener.onError(player, error));
        pendingPrepare.failed(epoch, error);
    }

    public synchronized void seekBegins(int epoch) {
        if (states.isCurrent(epoch)) {
            reported.beginSeek();
        }
    }

    public void seekEnds(int epoch, boolean done) {
        reportIf(epoch, () -> reported.endsSeek() && done,
                listener -> listener.onSeekComplete(player));
    }

    public synchronized boolean seeking() {
        return reported.isSeeking();
    }

    void videoSize(int epoch, int width, int height) {
        reportIf(epoch, () -> width > 0 && height > 0 && reported.isNewSize(width, height),
                listener -> listener.onVideoSizeChanged(player, width, height));
    }

    void buffering(int epoch, int percent) {
        int shown = Math.max(0, Math.min(percent, 100));
        reportIf(epoch, () -> reported.isNewPercent(shown),
                listener -> listener.onBufferingUpdate(player, shown));
    }

    void info(int epoch, PlaybackInfo info) {
        reportIf(epoch, () -> reported.isNewInfo(info.kind()),
                listener -> listener.onInfo(player, info));
    }

    void timedText(int epoch, byte @Nullable [] payload) {
        reportIf(epoch, () -> true, listener -> listener.onTimedText(player, payload));
    }

    /** Drops what was not reported yet; the epoch that it belongs to has ended. */
    public void forget() {
        synchronized (this) {
            reported = new Reported();
        }
        pendingPrepare.abort();
        queue.clear();
    }

    private boolean move(int epoch, PlayerState from, PlayerState to) {
        return states.move(epoch, EnumSet.of(from), to);
    }

    private boolean ends(int epoch) {
        boolean news = move(epoch, PlayerState.STARTED, PlayerState.COMPLETED);
        if (news && reported.isNewInfo(PlaybackInfo.Kind.RENDERING_STARTED)) {
            // Media so short that nobody saw them run.
            PlaybackInfo info = PlaybackInfo.of(PlaybackInfo.Kind.RENDERING_STARTED);
            queue(epoch, listener -> listener.onInfo(player, info));
        }
        return news;
    }

    /**
     * Reports what the change found to be news. Both happen under one lock: who sees the change and
     * acts on it has the report of that afterwards.
     */
    private boolean reportIf(int epoch, BooleanSupplier change, Consumer<PlayerListener> call) {
        boolean news;
        synchronized (this) {
            news = states.isCurrent(epoch) && change.getAsBoolean();
            if (news) {
                queue(epoch, call);
            }
        }
        flush();
        return news;
    }

    private void queue(int epoch, Consumer<PlayerListener> call) {
        if (listeners.isEmpty()) {
            return; // No thread starts for nobody.
        }
        queue.add(epoch, () -> listeners.forEach(listener -> callOne(epoch, listener, call)));
    }

    /** Has listeners called, unless the command lock is held: who gives that up must flush. */
    public void flush() {
        if (!states.commands.isHeldByCurrentThread()) {
            queue.flush();
        }
    }

    private void callOne(int epoch, PlayerListener listener, Consumer<PlayerListener> call) {
        // A listener before this one may have reset the player, or removed this one.
        if (!states.isCurrent(epoch) || !listeners.contains(listener)) {
            return;
        }
        try {
            call.accept(listener);
        } catch (RuntimeException | Error e) {
            Uncaught.report(e);
        }
    }
}
