// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.fail;

import java.time.Duration;
import java.util.concurrent.Callable;

/** Waits for conditions, with a bound that slow machines can stretch. */
public final class Wait {
    /** How many times slower than a usual machine this one may be. */
    public static final int PATIENCE = Integer.getInteger("orv.test.patience", 1);

    /** The bound, generous: only broken code ever waits so long. */
    public static final Duration LIMIT = Duration.ofSeconds(20L * PATIENCE);

    private Wait() {}

    public static void until(String what, Callable<Boolean> condition) throws Exception {
        long end = System.nanoTime() + LIMIT.toNanos();
        while (!condition.call()) {
            if (System.nanoTime() > end) {
                fail("waited in vain until " + what);
            }
            Thread.sleep(5);
        }
    }
}
