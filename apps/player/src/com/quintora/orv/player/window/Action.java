// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.util.List;
import java.util.function.BooleanSupplier;
import java.util.stream.Collectors;

/**
 * Something that the window does, with the words and keys by which people find it. Runs on the
 * window's thread.
 *
 * @param keys as KeyStroke names them; empty for what only the menu offers
 * @param isOn whether it has a tick in the menu now
 */
record Action(String name, List<String> keys, BooleanSupplier isOn, Runnable run) {
    /** The keys as they are written on a keyboard. */
    String keyNames() {
        return keys.stream().map(KeyNames::of).collect(Collectors.joining(", "));
    }
}
