// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.PlayerListener;
import java.util.ArrayDeque;
import java.util.Queue;
import java.util.concurrent.CopyOnWriteArrayList;
import java.util.concurrent.Executor;
import java.util.concurrent.RejectedExecutionException;
import java.util.function.Consumer;
import org.jetbrains.annotations.Nullable;

/** Hands events to the listeners, in order and one at a time. Thread-safe. */
final class FakeEvents {
    private record Event(int epoch, Consumer<PlayerListener> call) {}

    private final MediaPlayer player;
    private final Executor executor;
    private final CopyOnWriteArrayList<PlayerListener> listeners = new CopyOnWriteArrayList<>();
    private final Queue<Event> queue = new ArrayDeque<>();
    private boolean handedOver;
    private volatile int epoch;

    // What was reported last, to report nothing twice.
    private int width;
    private int height;
    private int percent = -1;
    private boolean rendering;

    FakeEvents(MediaPlayer player, Executor executor) {
        this.player = player;
        this.executor = executor;
    }

    void addListener(PlayerListener listener) {
        listeners.addIfAbsent(listener);
    }

    void removeListener(@Nullable PlayerListener listener) {
        listeners.remove(listener);
    }

    void removeAllListeners() {
        listeners.clear();
    }

    synchronized void report(Consumer<PlayerListener> call) {
        if (!listeners.isEmpty()) {
            queue.add(new Event(epoch, call));
        }
    }

    synchronized void videoSize(int newWidth, int newHeight) {
        if (newWidth == 0 || width == newWidth && height == newHeight) {
            return;
        }
        width = newWidth;
        height = newHeight;
        report(listener -> listener.onVideoSizeChanged(player, newWidth, newHeight));
    }

    synchronized void buffering(int newPercent) {
        if (percent != newPercent) {
            percent = newPercent;
            report(listener -> listener.onBufferingUpdate(player, newPercent));
        }
    }

    synchronized void rendering() {
        if (!rendering) {
            rendering = true;
            info(PlaybackInfo.Kind.RENDERING_STARTED);
        }
    }

    void info(PlaybackInfo.Kind kind) {
        PlaybackInfo info = PlaybackInfo.of(kind);
        report(listener -> listener.onInfo(player, info));
    }

    /** Drops what was not delivered yet: the media is gone. */
    synchronized void forget() {
        epoch++;
        queue.clear();
        width = 0;
        height = 0;
        percent = -1;
        rendering = false;
    }

    /** Has the executor call the listeners, unless it is about to. Hold no lock. */
    void flush() {
        synchronized (this) {
            if (handedOver || queue.isEmpty()) {
                return;
            }
            handedOver = true;
        }
        try {
            executor.execute(this::deliverAll);
        } catch (RejectedExecutionException e) {
            notHandedOver(); // Tried again with the next event.
        }
    }

    private void deliverAll() {
        for (Event event = next(); event != null; event = next()) {
            for (PlayerListener listener : listeners) {
                deliver(event, listener);
            }
        }
    }

    private void deliver(Event event, PlayerListener listener) {
        // A listener before this one may have reset the player, or removed this one.
        if (event.epoch() != epoch || !listeners.contains(listener)) {
            return;
        }
        try {
            event.call().accept(listener);
        } catch (RuntimeException | Error e) {
            Thread thread = Thread.currentThread();
            thread.getUncaughtExceptionHandler().uncaughtException(thread, e);
        }
    }

    private synchronized @Nullable Event next() {
        Event event = queue.poll();
        handedOver = event != null;
        return event;
    }

    private synchronized void notHandedOver() {
        handedOver = false;
    }
}
