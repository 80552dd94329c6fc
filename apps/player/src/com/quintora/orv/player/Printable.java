// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/** Texts of others, such as media's metadata and names of files, on their way to a terminal. */
final class Printable {
    private Printable() {}

    /** The text on one line, without anything that a terminal would take for a command. */
    static String of(String text) {
        return text.replaceAll("[\\p{Cc}\\p{Zl}\\p{Zp}]+", " ").strip();
    }
}
