// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.concurrent.atomic.AtomicInteger;
import java.util.logging.Filter;
import java.util.logging.Logger;

/** Counts the warnings of forgotten players, and keeps them out of the log. */
final class WarningCount implements AutoCloseable {
    private final Logger logger = Logger.getLogger(ForgottenPlayer.class.getName());
    private final Filter before = logger.getFilter();
    private final AtomicInteger count = new AtomicInteger();

    WarningCount() {
        logger.setFilter(line -> {
            count.incrementAndGet();
            return false;
        });
    }

    int count() {
        return count.get();
    }

    @Override
    public void close() {
        logger.setFilter(before);
    }
}
