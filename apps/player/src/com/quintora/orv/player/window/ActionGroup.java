// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.util.ArrayList;
import java.util.Collections;
import java.util.List;
import java.util.function.BooleanSupplier;

/** Actions that belong together: one menu, and one heading in the list of keys. */
final class ActionGroup {
    private final String name;
    private final List<Action> actions = new ArrayList<>();

    ActionGroup(String name) {
        this.name = name;
    }

    String name() {
        return name;
    }

    List<Action> actions() {
        return Collections.unmodifiableList(actions);
    }

    ActionGroup add(String action, Runnable run, String... keys) {
        return addSwitch(action, () -> false, run, keys);
    }

    /** With a tick in the menu while it is on. */
    ActionGroup addSwitch(String action, BooleanSupplier isOn, Runnable run, String... keys) {
        actions.add(new Action(action, List.of(keys), isOn, run));
        return this;
    }
}
