// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.util.ArrayList;
import java.util.Collections;
import java.util.List;
import java.util.Locale;
import java.util.Map;
import java.util.TreeMap;
import java.util.concurrent.atomic.AtomicInteger;
import java.util.concurrent.atomic.AtomicLong;

/** What the cycles did: the players, the faults, how long opens and seeks took. */
final class Tally {
    final AtomicInteger living = new AtomicInteger();
    final AtomicLong players = new AtomicLong();
    final AtomicInteger forgotten = new AtomicInteger();
    final AtomicInteger found = new AtomicInteger();

    private final List<Double> opens = new ArrayList<>();
    private final List<Double> seeks = new ArrayList<>();
    private final Map<String, Integer> counts = new TreeMap<>();
    private int most;

    /** A player was made. */
    void made() {
        players.incrementAndGet();
        int now = living.incrementAndGet();
        synchronized (this) {
            most = Math.max(most, now);
        }
    }

    synchronized void opened(double seconds) {
        opens.add(seconds * 1000);
    }

    synchronized void sought(double seconds) {
        seeks.add(seconds * 1000);
    }

    /** Counts a cycle of a kind, or a failure that was reported as it must be. */
    synchronized void count(String what) {
        counts.merge(what, 1, Integer::sum);
    }

    /** Since the last time: medians in milliseconds, null without any; totals since the start. */
    synchronized String takeJson() {
        String json = String.format(Locale.ROOT,
                "\"players\": %d, \"most\": %d, \"forgotten\": %d, \"open\": %s, \"seek\": %s",
                players.get(), most, found.get(), median(opens), median(seeks));
        opens.clear();
        seeks.clear();
        return json;
    }

    synchronized String countsJson() {
        List<String> entries = new ArrayList<>();
        counts.forEach((what, count) -> entries.add("\"" + what + "\": " + count));
        return "{\"counts\": {" + String.join(", ", entries) + "}}";
    }

    private static String median(List<Double> values) {
        if (values.isEmpty()) {
            return "null";
        }
        Collections.sort(values);
        return String.format(Locale.ROOT, "%.2f", values.get(values.size() / 2));
    }
}
