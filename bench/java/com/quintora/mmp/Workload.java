// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * Something that a player does, to be measured. Whoever measures makes one, calls {@link #rewind}
 * and {@link #run} as often as is needed, and closes it. A failure of any of them is thrown.
 */
abstract class Workload {
    final OrvMediaPlayer player = new OrvMediaPlayer();

    /** Does it again and again; this is what is measured. */
    abstract void run(int times) throws Exception;

    /** Takes back what a run has changed and the next would stumble over; not measured. */
    void rewind() throws Exception {}

    /** Checks that the runs had their effect, where only that shows it, and frees the player. */
    void close() throws Exception {
        player.close();
    }
}
