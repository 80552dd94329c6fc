// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import com.quintora.mmp.MediaPlayer;
import java.io.IOException;

/** Media to open, with what is wrong with them. */
abstract class Subject implements AutoCloseable {
    final String kind;
    final String name;
    final Expectation expectation;

    Subject(String kind, String name, Expectation expectation) {
        this.kind = kind;
        this.name = name;
        this.expectation = expectation;
    }

    /** Makes them what the player plays next. */
    abstract void open(MediaPlayer player) throws IOException;

    /** The fault that comes once they play. */
    void disturb() throws IOException {}

    /** Whether a player of these media may be forgotten. */
    boolean mayBeForgotten() {
        return true;
    }

    /** Removes what was made for them, once no player plays them any more. */
    @Override
    public void close() throws IOException {}

    @Override
    public String toString() {
        return kind + " " + name;
    }
}
