// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.util.EnumSet;
import java.util.List;
import java.util.Set;
import java.util.concurrent.CopyOnWriteArrayList;
import java.util.concurrent.Executor;
import java.util.function.BooleanSupplier;
import java.util.function.Consumer;

/**
 * Everything that is told of a player passes here, whether the watcher saw it or the native half
 * sent it, and is told once. Thread-safe; no lock is held while listeners are called.
 */
final class Events {
    // The native half's event numbers.
    private static final int NATIVE_PREPARED = 1;
    private static final int NATIVE_PLAYBACK_COMPLETE = 2;
    private static final int NATIVE_BUFFERING_UPDATE = 3;
    private static final int NATIVE_SEEK_COMPLETE = 4;
    private static final int NATIVE_SET_VIDEO_SIZE = 5;
    private static final int NATIVE_TIMED_TEXT = 99;
    private static final int NATIVE_ERROR = 100;
    private static final int NATIVE_INFO = 200;

    private static final Set<PlayerState> CAN_FAIL = EnumSet.of(
            PlayerState.PREPARING, PlayerState.PREPARED, PlayerState.STARTED, PlayerState.PAUSED,
            PlayerState.COMPLETED, PlayerState.STOPPED);

    final List<PlayerListener> listeners = new CopyOnWriteArrayList<>();

    private final OrvMediaPlayer player;
    private final Watcher watcher;
    private final EventQueue queue;
    private Told told = new Told();

    Events(OrvMediaPlayer player, Watcher watcher, Executor executor) {
        this.player = player;
        this.watcher = watcher;
        queue = new EventQueue(executor, player.states::isCurrent);
    }

    void prepared(int epoch) {
        boolean news = tellIf(
                epoch, () -> move(epoch, PlayerState.PREPARING, PlayerState.PREPARED),
                listener -> listener.onPrepared(player));
        if (news) {
            watcher.wake();
        }
    }

    void completed(int epoch) {
        tellIf(epoch, () -> ends(epoch), listener -> listener.onCompletion(player));
    }

    void failed(int epoch, Exception thrown) {
        MediaException error =
                Failures.explain(player.source(), thrown, player.stream().failure());
        tellIf(epoch, () -> player.states.move(epoch, CAN_FAIL, PlayerState.ERROR),
                listener -> listener.onError(player, error));
    }

    synchronized void seekBegins(int epoch) {
        if (player.states.isCurrent(epoch)) {
            told.seeks++;
        }
    }

    void seekEnds(int epoch, boolean done) {
        tellIf(epoch, () -> told.endsSeek() && done,
                listener -> listener.onSeekComplete(player));
    }

    synchronized boolean seeking() {
        return told.seeks > 0;
    }

    void videoSize(int epoch, int width, int height) {
        tellIf(epoch, () -> width > 0 && height > 0 && told.isNewSize(width, height),
                listener -> listener.onVideoSizeChanged(player, width, height));
    }

    void buffering(int epoch, int percent) {
        int shown = Math.max(0, Math.min(percent, 100));
        tellIf(epoch, () -> told.isNewPercent(shown),
                listener -> listener.onBufferingUpdate(player, shown));
    }

    void info(int epoch, int what, int extra) {
        tellIf(epoch, () -> told.isNewInfo(what),
                listener -> listener.onInfo(player, what, extra));
    }

    /**
     * An event of the native half. The thread is the native half's and is needed for the next
     * event: nothing happens on it but the hand-over.
     */
    void fromNative(int what, int arg1, int arg2, byte[] payload) {
        int epoch = player.states.epoch();
        watcher.execute(() -> merge(epoch, what, arg1, arg2, payload));
    }

    /** Drops what was not told yet; the epoch that it belongs to has ended. */
    void forget() {
        synchronized (this) {
            told = new Told();
        }
        queue.clear();
    }

    private void merge(int epoch, int what, int arg1, int arg2, byte[] payload) {
        switch (what) {
            case NATIVE_PREPARED -> prepared(epoch);
            case NATIVE_PLAYBACK_COMPLETE -> completed(epoch);
            case NATIVE_BUFFERING_UPDATE -> buffering(epoch, arg1);
            case NATIVE_SEEK_COMPLETE -> seekEnds(epoch, true);
            case NATIVE_SET_VIDEO_SIZE -> videoSize(epoch, arg1, arg2);
            case NATIVE_TIMED_TEXT -> tellIf(
                    epoch, () -> true, listener -> listener.onTimedText(player, payload));
            case NATIVE_ERROR -> failed(epoch, nativeError(arg1, arg2));
            case NATIVE_INFO -> info(epoch, arg1, arg2);
            default -> System.getLogger(Events.class.getName())
                    .log(System.Logger.Level.DEBUG, "unknown native event {0}", what);
        }
    }

    private static IOException nativeError(int what, int status) {
        return new IOException(
                String.format("the engine reported error %d: status=0x%X", what, status));
    }

    private boolean move(int epoch, PlayerState from, PlayerState to) {
        return player.states.move(epoch, EnumSet.of(from), to);
    }

    private boolean ends(int epoch) {
        boolean news = move(epoch, PlayerState.STARTED, PlayerState.COMPLETED);
        if (news && told.isNewInfo(PlayerListener.INFO_RENDERING_STARTED)) {
            // Media so short that nobody saw them run.
            queue(epoch, listener ->
                    listener.onInfo(player, PlayerListener.INFO_RENDERING_STARTED, 0));
        }
        return news;
    }

    /**
     * Tells what the change found to be news. Both happen under one lock: who sees the change and
     * acts on it is told of that afterwards.
     */
    private boolean tellIf(int epoch, BooleanSupplier change, Consumer<PlayerListener> call) {
        boolean news;
        synchronized (this) {
            news = player.states.isCurrent(epoch) && change.getAsBoolean();
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
        queue.add(epoch, () -> listeners.forEach(listener -> tellOne(epoch, listener, call)));
    }

    /** Has listeners called, unless the command lock is held: who gives that up must flush. */
    void flush() {
        if (!player.commands.isHeldByCurrentThread()) {
            queue.flush();
        }
    }

    private void tellOne(int epoch, PlayerListener listener, Consumer<PlayerListener> call) {
        // A listener before this one may have reset the player, or taken this one off.
        if (!player.states.isCurrent(epoch) || !listeners.contains(listener)) {
            return;
        }
        try {
            call.accept(listener);
        } catch (RuntimeException | Error e) {
            EventQueue.uncaught(e);
        }
    }

    /** What was last told of the media, to tell nothing twice. */
    private static final class Told {
        private int width;
        private int height;
        private int percent = -1;
        private int seeks;
        private boolean rendering;
        private boolean waiting;

        boolean endsSeek() {
            boolean sought = seeks > 0;
            seeks -= sought ? 1 : 0;
            return sought;
        }

        boolean isNewSize(int newWidth, int newHeight) {
            boolean isNew = width != newWidth || height != newHeight;
            width = newWidth;
            height = newHeight;
            return isNew;
        }

        boolean isNewPercent(int newPercent) {
            boolean isNew = percent != newPercent;
            percent = newPercent;
            return isNew;
        }

        boolean isNewInfo(int what) {
            boolean isNew = switch (what) {
                case PlayerListener.INFO_RENDERING_STARTED -> !rendering;
                case PlayerListener.INFO_BUFFERING_STARTED -> !waiting;
                case PlayerListener.INFO_BUFFERING_ENDED -> waiting;
                default -> true;
            };
            rendering |= what == PlayerListener.INFO_RENDERING_STARTED;
            waiting = what == PlayerListener.INFO_BUFFERING_STARTED
                    || waiting && what != PlayerListener.INFO_BUFFERING_ENDED;
            return isNew;
        }
    }
}
