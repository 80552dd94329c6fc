// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.FileInputStream;
import java.io.IOException;
import java.util.ArrayList;
import java.util.List;
import java.util.Locale;
import java.util.Set;
import java.util.concurrent.CountDownLatch;
import java.util.stream.Collectors;
import java.util.stream.Stream;

/** Faults of this program's own, planted to show that a run fails of them. */
final class Plant {
    /** What can be planted; the first five each cycle. */
    enum Kind { LEAK, HEAP, THREADS, DESCRIPTORS, REFERENCES, HANG, EXCEPTION, UNNOTICED, CRASH }

    static final int LEAKED_BYTES = 4096;
    /** The cycle in which what happens once happens. */
    private static final int ONCE = 3;

    private static final List<Object> KEPT = new ArrayList<>();

    private final Set<Kind> kinds;

    private Plant(Set<Kind> kinds) {
        this.kinds = kinds;
    }

    static Plant of(String names) {
        return new Plant(Stream.of(names.split(",")).filter(name -> !name.isEmpty())
                .map(name -> Kind.valueOf(name.toUpperCase(Locale.ROOT)))
                .collect(Collectors.toSet()));
    }

    boolean has(Kind kind) {
        return kinds.contains(kind);
    }

    void eachCycle() throws IOException {
        if (has(Kind.LEAK)) {
            NativeMemory.leak(LEAKED_BYTES);
        }
        if (has(Kind.REFERENCES)) {
            NativeMemory.leakReference(new Object());
        }
        if (has(Kind.HEAP)) {
            keep(new byte[LEAKED_BYTES]);
        }
        if (has(Kind.DESCRIPTORS)) {
            keep(new FileInputStream("/dev/null"));
        }
        if (has(Kind.THREADS)) {
            Thread thread = new Thread(Plant::blockForever, "planted");
            thread.setDaemon(true);
            thread.start();
        }
    }

    /** What happens once, as an action of that cycle. */
    void inAction(int cycle) {
        if (cycle != ONCE) {
            return;
        }
        if (has(Kind.HANG)) {
            blockForever();
        }
        if (has(Kind.EXCEPTION)) {
            throw new UnsupportedOperationException("planted");
        }
        if (has(Kind.CRASH)) {
            NativeMemory.crash();
        }
    }

    /** Whether that cycle's media have no fault where one is expected to be reported. */
    boolean isUnnoticed(int cycle) {
        return has(Kind.UNNOTICED) && cycle == ONCE;
    }

    private static synchronized void keep(Object object) {
        KEPT.add(object);
    }

    private static void blockForever() {
        try {
            new CountDownLatch(1).await();
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }
}
