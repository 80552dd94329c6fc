// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.view.Surface;
import java.io.IOException;
import java.lang.ref.WeakReference;
import java.util.EnumSet;
import java.util.Set;
import java.util.concurrent.Executor;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.locks.ReentrantLock;

/** The part of {@link OrvMediaPlayer} that keeps engine, state and events in step. */
abstract sealed class PlayerCore permits Playback {
    private static final int BINDING_WAIT_MS = 100;

    // Held over the short engine calls that change whether the player runs, together with the
    // change of state that they mean. Never held while a listener is called.
    final ReentrantLock commands = new ReentrantLock();
    final StateMachine states = new StateMachine();

    // The native half counts references to the surface without a lock of its own.
    private final ReentrantLock surfaceBinding = new ReentrantLock();

    final OrvMediaPlayer peer = (OrvMediaPlayer) this;
    private final Watcher watcher = new Watcher(new WeakReference<>(peer));
    private final Events events;
    private volatile StreamAdapter stream = StreamAdapter.none();
    private volatile String source = "";

    PlayerCore(Executor executor) {
        events = new Events(peer, watcher, executor == null ? watcher::execute : executor);
    }

    final Events events() {
        return events;
    }

    final StreamAdapter stream() {
        return stream;
    }

    final void useStream(StreamAdapter adapter) {
        stream = adapter;
    }

    final String source() {
        return source;
    }

    final boolean hasMedia() {
        return StateMachine.WITH_MEDIA.contains(states.state());
    }

    final void stopWatching() {
        events.listeners.clear();
        watcher.stop();
    }

    /** Ends the Java side's threads; for a player that nobody refers to any more. */
    final void abandon() {
        states.endEpoch(PlayerState.RELEASED);
        watcher.stop();
    }

    final void wake() {
        watcher.wake();
    }

    final void wakeToPreparing(int epoch) {
        watcher.watchPreparing(epoch);
    }

    /** Seeks by any means: the engine's call returns when it is done. */
    final void seek(String call, EngineCall command) {
        int epoch = states.require(call, StateMachine.WITH_MEDIA);
        events.seekBegins();
        try {
            run(call, command);
        } catch (IllegalStateException e) {
            events.seekFailed();
            throw e;
        }
        leaveCompletion(epoch);
        events.seekDone(epoch);
        watcher.wake();
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

    private void leaveCompletion(int epoch) {
        commands.lock();
        try {
            PlayerState to =
                    peer.native_isPlaying() ? PlayerState.STARTED : PlayerState.PAUSED;
            states.move(epoch, EnumSet.of(PlayerState.COMPLETED), to);
        } finally {
            commands.unlock();
        }
    }

    /** Runs a command that leaves the player halted. */
    final void halt(String call, EngineCall command) {
        Set<PlayerState> media = StateMachine.WITH_MEDIA;
        command(call, media, media, PlayerState.PAUSED, command);
    }

    /** Runs an engine command whose failure can only mean a state of the engine's. */
    final void run(String call, EngineCall command) {
        try {
            command.run();
        } catch (IOException | IllegalStateException e) {
            throw Failures.refused(call, e);
        }
    }

    final void command(
            String call, Set<PlayerState> allowed, Set<PlayerState> moving, PlayerState to,
            EngineCall command) {
        commands.lock();
        try {
            int epoch = states.require(call, allowed);
            run(call, command);
            states.move(epoch, moving, to);
        } finally {
            commands.unlock();
        }
    }

    final void initialize(String name, EngineCall command) throws IOException {
        Set<PlayerState> idle = EnumSet.of(PlayerState.IDLE);
        commands.lock();
        try {
            int epoch = states.require("setDataSource()", idle);
            command.run();
            source = name;
            states.move(epoch, idle, PlayerState.INITIALIZED);
        } catch (SecurityException e) {
            throw Failures.denied(name, e);
        } catch (MediaException e) {
            throw e;
        } catch (IOException e) {
            throw Failures.explain(name, e, null);
        } finally {
            commands.unlock();
        }
    }

    final void prepareWith(int epoch, EngineCall command) throws IOException {
        try {
            command.run();
        } catch (IOException e) {
            states.move(epoch, EnumSet.of(PlayerState.PREPARING), PlayerState.ERROR);
            throw Failures.explain(source, e, stream.failure());
        } catch (SecurityException e) {
            states.move(epoch, EnumSet.of(PlayerState.PREPARING), PlayerState.ERROR);
            throw Failures.denied(source, e);
        } catch (IllegalStateException e) {
            states.move(epoch, EnumSet.of(PlayerState.PREPARING), PlayerState.ERROR);
            throw Failures.refused("to prepare", e);
        }
    }

    final void forgetMedia() {
        events.forget();
        stream.close();
        stream = StreamAdapter.none();
        peer.mStreamReadBuffer = null;
        source = "";
    }
}
