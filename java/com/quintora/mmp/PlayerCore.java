// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.view.Surface;
import java.io.IOException;
import java.lang.ref.WeakReference;
import java.util.EnumSet;
import java.util.Set;
import java.util.concurrent.Executor;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicReference;
import java.util.concurrent.locks.ReentrantLock;
import java.util.function.Supplier;

/** The part of {@link OrvMediaPlayer} that keeps engine, state and events in step. */
abstract sealed class PlayerCore permits DataSources {
    private static final int BINDING_WAIT_MS = 100;

    // Held over the engine calls that change whether the player runs, together with the change of
    // state that they mean. Never held while a listener is called.
    final ReentrantLock commands = new ReentrantLock();
    final StateMachine states = new StateMachine();

    // The native half counts references to the surface without a lock of its own.
    private final ReentrantLock surfaceBinding = new ReentrantLock();

    final OrvMediaPlayer peer = (OrvMediaPlayer) this;
    private final Watcher watcher = new Watcher(new WeakReference<>(peer));
    private final ExecutorService listening = PlayerThreads.forListeners();
    private final Events events;
    private final AtomicReference<StreamAdapter> stream =
            new AtomicReference<>(StreamAdapter.none());
    private volatile String source = "";

    PlayerCore(Executor executor) {
        events = new Events(peer, watcher, executor == null ? listening : executor);
    }

    final Events events() {
        return events;
    }

    final StreamAdapter stream() {
        return stream.get();
    }

    final void useStream(StreamAdapter adapter) {
        stream.set(adapter);
    }

    /** Closes a stream, and uses it no more if it is the one in use. */
    final void dropStream(StreamAdapter adapter) {
        adapter.close();
        stream.compareAndSet(adapter, StreamAdapter.none());
    }

    final String source() {
        return source;
    }

    final void nameSource(String name) {
        source = name;
    }

    final boolean hasMedia() {
        return StateMachine.WITH_MEDIA.contains(states.state());
    }

    final void stopWatching() {
        events.listeners.clear();
        stopThreads();
    }

    /** Ends the Java side's threads; for a player that nobody refers to any more. */
    final void abandon() {
        states.endEpoch(PlayerState.RELEASED);
        stopThreads();
    }

    private void stopThreads() {
        watcher.stop();
        listening.shutdown();
    }

    final void wake() {
        watcher.wake();
    }

    final void wakeToPreparing(int epoch) {
        watcher.watchPreparing(epoch);
    }

    /** Seeks by any means: the engine's call returns when it is done. */
    final void seek(String call, EngineCall command) {
        int epoch = beginSeek(call);
        boolean done = false;
        try {
            run(call, command);
            done = true;
        } finally {
            followSeek(epoch, done);
            watcher.wake();
            events.seekEnds(epoch, done);
        }
    }

    private int beginSeek(String call) {
        commands.lock();
        try {
            noticeEnd();
            int epoch = states.require(call, StateMachine.WITH_MEDIA);
            events.seekBegins(epoch);
            return epoch;
        } finally {
            commands.unlock();
            events.flush();
        }
    }

    /** After a seek: it leaves the end, of which the engine may have known before the state did. */
    private void followSeek(int epoch, boolean done) {
        commands.lock();
        try {
            boolean playing = peer.native_isPlaying();
            boolean ended = !playing && atEnd();
            if (states.isStill(epoch, PlayerState.STARTED) && !playing && !ended) {
                peer.native_start(); // Sought from the end the engine halts; others are waiting.
            } else if (done || !ended) {
                states.move(epoch, EnumSet.of(PlayerState.COMPLETED),
                        playing ? PlayerState.STARTED : PlayerState.PAUSED);
            }
        } catch (IllegalStateException e) {
            // The media failed, and the watcher tells; or the player was released.
        } finally {
            commands.unlock();
        }
    }

    /**
     * Whether the engine stands at the end of its media: there its position is the duration. It may
     * also be that where it waits for the bytes of media whose length is unknown, or known only as
     * far as they were read.
     */
    final boolean atEnd() {
        try {
            if (peer.native_isPlaying()) {
                return false;
            }
            int position = peer.native_getCurrentPosition();
            return position == peer.native_getDuration() && !awaitsBytes(position);
        } catch (IOException | SecurityException | IllegalStateException e) {
            return false; // The media failed or went just now.
        }
    }

    private boolean awaitsBytes(int position) {
        return stream().isReading() || position == 0 && Failures.isUrl(source);
    }

    /** Tells of an end that the engine has reached and the watcher has not seen yet. */
    private void noticeEnd() {
        int epoch = states.epoch();
        if (states.isStill(epoch, PlayerState.STARTED) && atEnd()) {
            events.completed(epoch);
        }
    }

    final void bindSurface(Surface surface) {
        surfaceBinding.lock();
        try {
            peer.native_setVideoSurface(surface);
        } catch (IllegalArgumentException e) {
            // The native half gave up the old surface's reference but kept its address, and would
            // give the reference up again next time. The engine holds one of its own.
            peer.mNativeSurfaceTexture = 0;
            throw e;
        } finally {
            surfaceBinding.unlock();
        }
    }

    final void prepareWithSurface() throws IOException {
        surfaceBinding.lock();
        try {
            peer.native_prepare();
        } finally {
            surfaceBinding.unlock();
        }
    }

    /** Waits while a surface is bound, but not for a prepare that only the release can end. */
    final void releaseWithSurface() {
        boolean locked = false;
        try {
            locked = surfaceBinding.tryLock(BINDING_WAIT_MS, TimeUnit.MILLISECONDS);
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
        try {
            peer.native_release();
        } finally {
            if (locked) {
                surfaceBinding.unlock();
            }
        }
    }

    /** Runs a command that leaves the player halted, in part also when it fails. */
    final void halt(String call, EngineCall command) {
        Set<PlayerState> media = StateMachine.WITH_MEDIA;
        commands.lock();
        try {
            command(call, media, media, PlayerState.PAUSED, command);
        } catch (IllegalStateException e) {
            followHalt();
            throw e;
        } finally {
            commands.unlock();
            events.flush();
        }
    }

    private void followHalt() {
        int epoch = states.epoch();
        boolean completed = states.isStill(epoch, PlayerState.COMPLETED);
        if (!hasMedia() || completed && atEnd()) {
            return;
        }
        try {
            if (!peer.native_isPlaying()) {
                peer.native_pause();
                states.move(epoch, StateMachine.WITH_MEDIA, PlayerState.PAUSED);
            }
        } catch (IOException | IllegalStateException e) {
            // The engine was not halted: it stands where it did.
        }
    }

    final void command(
            String call, Set<PlayerState> allowed, Set<PlayerState> moving, PlayerState to,
            EngineCall command) {
        commands.lock();
        try {
            noticeEnd();
            int epoch = states.require(call, allowed);
            run(call, command);
            states.move(epoch, moving, to);
        } finally {
            commands.unlock();
            events.flush();
        }
    }

    /** Runs an engine command whose failure can only mean a state of the engine's. */
    final void run(String call, EngineCall command) {
        states.requireAlive(call);
        try {
            command.run();
        } catch (IOException | IllegalStateException e) {
            throw refusal(call, e);
        }
    }

    /** Asks the engine something that it can answer in every state. */
    final <T> T ask(String call, Supplier<T> question) {
        states.requireAlive(call);
        try {
            return question.get();
        } catch (IllegalStateException e) {
            throw refusal(call, e);
        }
    }

    /** Why the engine did not do something. */
    final IllegalStateException refusal(String call, Exception thrown) {
        states.requireAlive(call);
        watcher.wake(); // The media may have failed, which the watcher finds out.
        return Failures.refused(call, thrown);
    }

    final void prepareWith(int epoch, EngineCall command) throws IOException {
        String name = source;
        StreamAdapter bytes = stream();
        try {
            command.run();
        } catch (IOException e) {
            failToPrepare(epoch, name, e);
            throw Failures.explain(name, e, bytes.failure());
        } catch (SecurityException e) {
            failToPrepare(epoch, name, e);
            throw Failures.denied(name, e);
        } catch (IllegalStateException e) {
            failToPrepare(epoch, name, e);
            throw Failures.refused("to prepare", e);
        }
        requireStill(epoch, name, null);
    }

    private void failToPrepare(int epoch, String name, Exception thrown) throws MediaException {
        requireStill(epoch, name, thrown);
        states.move(epoch, EnumSet.of(PlayerState.PREPARING), PlayerState.ERROR);
    }

    private void requireStill(int epoch, String name, Exception thrown) throws MediaException {
        if (!states.isCurrent(epoch)) {
            throw new MediaException(name + ": reset or released while it was being opened",
                    MediaException.STATUS_UNKNOWN, thrown);
        }
    }

    final void forgetMedia() {
        events.forget();
        stream.getAndSet(StreamAdapter.none()).close();
        peer.mStreamReadBuffer = null;
        source = "";
    }
}
