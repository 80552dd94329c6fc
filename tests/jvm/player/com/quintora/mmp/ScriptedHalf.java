// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** The script of the engine in the native half that tests named after this class load. */
final class ScriptedHalf {
    private ScriptedHalf() {}

    /** Lets the engine of the newest player answer with that many tracks of each kind. */
    static native void script(int tracks);

    /** Lets DivX navigation succeed or be refused. */
    static native void answerDivx(boolean answer);

    /** The calls that the engine of the newest player was given since, a line each. */
    static native String takeCalls();

    /** How many engine players there are. */
    static native int livePlayers();

    /** The results of one call of each operation of a player's stream, on a native thread. */
    static native String useStream(OrvMediaPlayer player);

    /** Posts an event with that word as its payload, on a native thread. */
    static native void post(OrvMediaPlayer player, Object weakPlayer, int what, int word);
}
