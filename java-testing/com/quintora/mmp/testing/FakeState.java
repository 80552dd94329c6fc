// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.PlayerState;
import java.util.EnumSet;
import java.util.Set;
import org.jetbrains.annotations.Nullable;

/** A fake player's state, and the sentences with which it refuses calls. Used under the guard. */
final class FakeState {
    static final Set<PlayerState> WITH_MEDIA = EnumSet.of(
            PlayerState.PREPARED, PlayerState.STARTED, PlayerState.PAUSED, PlayerState.COMPLETED);

    private PlayerState state = PlayerState.IDLE;

    PlayerState get() {
        return state;
    }

    boolean is(PlayerState wanted) {
        return state == wanted;
    }

    void set(PlayerState newState) {
        state = newState;
    }

    boolean hasMedia() {
        return WITH_MEDIA.contains(state);
    }

    void require(String call, Set<PlayerState> allowed) {
        requireAlive(call);
        if (!allowed.contains(state)) {
            throw new IllegalStateException(
                    call + " was called in the state " + state + "; it is for " + allowed);
        }
    }

    void requireMedia(String call) {
        require(call, WITH_MEDIA);
    }

    void requireAlive(String call) {
        if (state == PlayerState.RELEASED) {
            throw new IllegalStateException(call + " was called after the player was released");
        }
    }

    static <T> T requireValue(@Nullable T value, String name) {
        if (value == null) {
            throw new IllegalArgumentException(name + " is null");
        }
        return value;
    }
}
