// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

/** What follows the end. */
public enum Repeat {
    /** The next media, and nothing after the last. */
    OFF,
    /** The same media. */
    ONE,
    /** The next media, and the first after the last. */
    ALL
}
