// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import javax.accessibility.AccessibleRole;
import javax.accessibility.AccessibleState;
import javax.accessibility.AccessibleStateSet;
import javax.accessibility.AccessibleValue;
import javax.swing.JComponent;

/** What a bar is to a screen reader: a slider, in the bar's own units. */
final class AccessibleLevel extends JComponent.AccessibleJComponent implements AccessibleValue {
    private final LevelBar bar;

    AccessibleLevel(LevelBar bar) {
        bar.super();
        this.bar = bar;
    }

    @Override
    public AccessibleRole getAccessibleRole() {
        return AccessibleRole.SLIDER;
    }

    @Override
    public AccessibleStateSet getAccessibleStateSet() {
        AccessibleStateSet states = super.getAccessibleStateSet();
        states.add(AccessibleState.HORIZONTAL);
        return states;
    }

    @Override
    public AccessibleValue getAccessibleValue() {
        return this;
    }

    @Override
    public Number getCurrentAccessibleValue() {
        return bar.value();
    }

    @Override
    public boolean setCurrentAccessibleValue(Number value) {
        if (value == null || !bar.isEnabled() || bar.maximum() == 0) {
            return false;
        }
        bar.set(value.doubleValue() / bar.maximum());
        return true;
    }

    @Override
    public Number getMinimumAccessibleValue() {
        return 0;
    }

    @Override
    public Number getMaximumAccessibleValue() {
        return bar.maximum();
    }
}
