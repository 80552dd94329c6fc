// SPDX-License-Identifier: Apache-2.0
package android.view;

/** Surfaces that only the platform can make. */
public final class Surfaces {
    private Surfaces() {}

    /** One that nobody reads from. */
    public static Surface withoutConsumer() {
        return new Surface();
    }
}
