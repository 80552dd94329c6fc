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
        if (player.states.move(epoch, EnumSet.of(PlayerState.PREPARING), PlayerState.PREPARED)) {
            tell(epoch, listener -> listener.onPrepared(player));
            watcher.wake();
        }
    }

    void completed(int epoch) {
        if (player.states.move(epoch, EnumSet.of(PlayerState.STARTED), PlayerState.COMPLETED)) {
            tell(epoch, listener -> listener.onCompletion(player));
        }
    }

    void failed(int epoch, Exception thrown) {
        MediaException error =
                Failures.explain(player.source(), thrown, player.stream().failure());
        if (player.states.move(epoch, CAN_FAIL, PlayerState.ERROR)) {
            tell(epoch, listener -> listener.onError(player, error));
        }
    }

    synchronized void seekBegins() {
        told.seeks++;
    }

    synchronized void seekFailed() {
        told.seeks = Math.max(0, told.seeks - 1);
    }

    void seekDone(int epoch) {
        if (firstTime(epoch, () -> told.seeks > 0 && told.seeks-- > 0)) {
            tell(epoch, listener -> listener.onSeekComplete(player));
        }
    }

    synchronized boolean seeking() {
        return told.seeks > 0;
    }

    void videoSize(int epoch, int width, int height) {
        if (width > 0 && height > 0 && firstTime(epoch, () -> told.isNewSize(width, height))) {
            tell(epoch, listener -> listener.onVideoSizeChanged(player, width, height));
        }
    }

    void buffering(int epoch, int percent) {
        int shown = Math.max(0, Math.min(percent, 100));
        if (firstTime(epoch, () -> told.isNewPercent(shown))) {
            tell(epoch, listener -> listener.onBufferingUpdate(player, shown));
        }
    }

    void info(int epoch, int what, int extra) {
        if (firstTime(epoch, () -> told.isNewInfo(what))) {
            tell(epoch, listener -> listener.onInfo(player, what, extra));
        }
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
            case NATIVE_SEEK_COMPLETE -> seekDone(epoch);
            case NATIVE_SET_VIDEO_SIZE -> videoSize(epoch, arg1, arg2);
            case NATIVE_TIMED_TEXT -> tell(epoch, l -> l.onTimedText(player, payload));
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

    private synchronized boolean firstTime(int epoch, BooleanSupplier isNew) {
        return player.states.isCurrent(epoch) && isNew.getAsBoolean();
    }

    /** Has listeners called for what was told under the command lock. */
    void flush() {
        queue.flush();
    }

    private void tell(int epoch, Consumer<PlayerListener> call) {
        queue.add(epoch, () -> {
            for (PlayerListener listener : listeners) {
                if (player.states.isCurrent(epoch)) {
                    tellOne(listener, call);
                }
            }
        });
        if (!player.commands.isHeldByCurrentThread()) {
            queue.flush();
        }
    }

    private static void tellOne(PlayerListener listener, Consumer<PlayerListener> call) {
        try {
            call.accept(listener);
        } catch (RuntimeException | Error e) {
            Thread thread = Thread.currentThread();
            thread.getUncaughtExceptionHandler().uncaughtException(thread, e);
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
