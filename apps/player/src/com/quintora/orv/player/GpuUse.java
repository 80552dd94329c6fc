// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/** When the graphics processor draws the window's pictures. */
public enum GpuUse {
    NEVER,
    /** Where there is one. */
    USUAL,
    /** Also where it is only software. */
    ALWAYS
}
