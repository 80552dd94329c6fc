// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** What a player is for on the screen, in the order of the engine's numbers. */
public enum PlayerRole {
    /** Picture and sound. */
    MAIN,
    /** Picture only, as in a window inside the picture. */
    SUB,
    /** Sound only. */
    BACKGROUND
}
