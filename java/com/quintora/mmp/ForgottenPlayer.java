// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.internal.PlayerUnits;
import com.quintora.mmp.internal.events.Watcher;
import com.quintora.mmp.internal.state.StateMachine;
import java.lang.ref.Cleaner;
import java.util.concurrent.ExecutorService;

/**
 * Frees what a player holds that was collected without having been released. Knows what of it must
 * be freed, but not the player, which would never be collected otherwise.
 */
final class ForgottenPlayer implements Runnable {
    private static final Cleaner CLEANER = Cleaner.create();

    private final StateMachine states;
    private final Watcher watcher;
    private final ExecutorService listening;
    private final Throwable made = new Throwable("made here");
    private volatile long context;
    private volatile long surfaceTexture;
    private Cleaner.Cleanable cleanable;

    private ForgottenPlayer(PlayerUnits units) {
        states = units.states;
        watcher = units.watcher;
        listening = units.listening;
    }

    static ForgottenPlayer watch(OrvMediaPlayer player, PlayerUnits units) {
        ForgottenPlayer forgotten = new ForgottenPlayer(units);
        forgotten.cleanable = CLEANER.register(player, forgotten);
        return forgotten;
    }

    /** What the native half holds for the player; nothing more is to be freed for a context 0. */
    void setHeld(long nativeContext, long nativeSurfaceTexture) {
        context = nativeContext;
        surfaceTexture = nativeSurfaceTexture;
        if (nativeContext == 0) {
            cleanable.clean();
        }
    }

    @Override
    public void run() {
        if (context == 0) {
            return;
        }
        System.getLogger(ForgottenPlayer.class.getName()).log(System.Logger.Level.WARNING,
                "a player was collected that nobody had released: use try-with-resources or call"
                        + " release()", made);
        states.endEpoch(PlayerState.RELEASED);
        watcher.stop();
        listening.shutdown();
        new OrvMediaPlayer(context, surfaceTexture).finalizeNatively();
    }
}
