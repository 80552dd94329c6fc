// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** The script of the engine in the native half that tests named after this class load. */
public final class ScriptedHalf {
    private ScriptedHalf() {}

    /** Lets the engine of the newest player answer with that many tracks of each kind. */
    static native void script(int tracks);

    /** Lets DivX navigation succeed or be refused. */
    static native void answerDivx(boolean answer);

    /** The calls that the engine of the newest player was given since, a line each. */
    public static native String takeCalls();

    /** Lets an operation of the newest player's engine have that result from now on. */
    public static native void answer(String operation, int result);

    /** The same of each engine that is made from now on; without an operation none. */
    public static native void answerWhenMade(String operation, int result);

    /** How many engine players there are. */
    static native int livePlayers();

    /** The results of one call of each operation of a player's stream, on a native thread. */
    static native String useStream(OrvMediaPlayer player);

    /** Posts an event with that word as its payload, on a native thread. */
    static native void post(OrvMediaPlayer player, Object weakPlayer, int what, int word);
}
