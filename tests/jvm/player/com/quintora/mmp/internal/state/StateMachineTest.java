// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.state;

import static com.quintora.mmp.PlayerState.IDLE;
import static com.quintora.mmp.PlayerState.INITIALIZED;
import static com.quintora.mmp.PlayerState.PREPARING;
import static com.quintora.mmp.PlayerState.RELEASED;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.PlayerState;
import java.util.EnumSet;
import org.junit.jupiter.api.Test;

class StateMachineTest {
    private final StateMachine states = new StateMachine();

    @Test
    void aMoveNeedsItsStateAndItsEpoch() {
        int epoch = states.epoch();
        assertFalse(states.move(epoch, EnumSet.of(INITIALIZED), PREPARING));
        assertTrue(states.move(epoch, EnumSet.of(IDLE), INITIALIZED));
        states.endEpoch(IDLE);
        assertFalse(states.move(epoch, EnumSet.of(IDLE), INITIALIZED), "the epoch is over");
        assertEquals(IDLE, states.state());
    }

    @Test
    void aRefusalNamesTheCallTheStateAndTheStatesThatItIsFor() {
        IllegalStateException refusal = assertThrows(IllegalStateException.class,
                () -> states.enter("prepare()", EnumSet.of(INITIALIZED), PREPARING));
        assertEquals("prepare() was called in the state IDLE; it is for [INITIALIZED]",
                refusal.getMessage());
        assertEquals(IDLE, states.state());
    }

    @Test
    void releasedIsFinal() {
        assertEquals(IDLE, states.endEpoch(RELEASED));
        int epoch = states.epoch();
        assertEquals(RELEASED, states.endEpoch(IDLE));
        assertEquals(RELEASED, states.state());
        assertEquals(epoch, states.epoch());
        IllegalStateException refusal =
                assertThrows(IllegalStateException.class, () -> states.requireAlive("start()"));
        assertEquals("start() was called after the player was released", refusal.getMessage());
    }
}
