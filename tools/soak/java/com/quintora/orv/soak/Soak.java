// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.PrintWriter;
import java.io.StringWriter;
import java.nio.file.Files;
import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.ExecutionException;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import java.util.concurrent.Future;
import java.util.logging.Handler;
import java.util.logging.LogRecord;
import java.util.logging.Logger;
import javax.management.JMException;

/**
 * Runs cycles, a checkpoint after each batch. Prints a line of JSON for each checkpoint; ends with
 * 0 when nothing failed, otherwise with 1 and what failed in the file {@code failure}.
 */
public final class Soak {
    private static final long WATCH_MILLIS = 200;

    // The logger must not be collected, or its handler would be gone.
    private static final Logger FORGOTTEN = Logger.getLogger("com.quintora.mmp.ForgottenPlayer");

    private final Run run;
    private final long from = System.nanoTime();

    private Soak(Settings settings) throws Exception {
        run = new Run(settings);
    }

    /** Runs what {@code name=value} arguments say. */
    public static void main(String[] arguments) throws Exception {
        Soak soak = new Soak(new Settings(arguments));
        try {
            soak.watch();
            soak.countForgotten();
            soak.soak();
            soak.run.close();
        } catch (Exception | Error e) {
            soak.fail(e);
        }
        System.exit(0);
    }

    private void soak() throws Exception {
        Settings settings = run.settings;
        ExecutorService workers = Executors.newFixedThreadPool(settings.workers());
        int done = 0;
        while (done < settings.cycles() && seconds() < settings.minutes() * 60) {
            int count = Math.min(settings.batch(), settings.cycles() - done);
            live(workers, settings.first() + done, count);
            done += count;
            run.awaitForgotten();
            System.out.println(Checkpoint.take(done, seconds(), run.tally));
        }
        System.out.println(run.tally.countsJson());
        workers.shutdown();
    }

    private void live(ExecutorService workers, int first, int count) throws Exception {
        List<Future<?>> cycles = new ArrayList<>();
        for (int i = 0; i < count; i++) {
            int number = first + i;
            cycles.add(workers.submit(() -> {
                try {
                    new Cycle(run, number).live();
                } catch (Exception | Error e) {
                    fail(e);
                }
            }));
        }
        for (Future<?> cycle : cycles) {
            try {
                cycle.get();
            } catch (ExecutionException e) {
                fail(e);
            }
        }
    }

    private double seconds() {
        return (System.nanoTime() - from) / 1e9;
    }

    /** Exceptions that nobody caught fail the run, and actions that do not end. */
    private void watch() {
        Thread.setDefaultUncaughtExceptionHandler((thread, thrown) -> fail(thrown));
        Thread watchdog = new Thread(() -> {
            while (true) {
                run.journal.running().stream()
                        .filter(action -> action.seconds() > run.settings.limit())
                        .findFirst()
                        .ifPresent(this::failOfHang);
                sleep();
            }
        }, "soak-watchdog");
        watchdog.setDaemon(true);
        watchdog.start();
    }

    private static void sleep() {
        try {
            Thread.sleep(WATCH_MILLIS);
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }

    private void countForgotten() {
        FORGOTTEN.setUseParentHandlers(false);
        FORGOTTEN.addHandler(new Handler() {
            @Override
            public void publish(LogRecord line) {
                run.tally.found.incrementAndGet();
            }

            @Override
            public void flush() {}

            @Override
            public void close() {}
        });
    }

    private void failOfHang(Journal.Action action) {
        String stacks;
        try {
            stacks = Checkpoint.threads();
        } catch (JMException e) {
            stacks = e.toString();
        }
        fail("cycle " + action.cycle + ": hangs since " + (int) action.seconds() + " s: "
                + action.what + "\n" + stacks);
    }

    private void fail(Throwable thrown) {
        StringWriter text = new StringWriter();
        thrown.printStackTrace(new PrintWriter(text));
        fail(text.toString());
    }

    /** The first failure is the run's; the others go on until the process is gone. */
    private synchronized void fail(String text) {
        try {
            Files.writeString(run.settings.folder().resolve("failure"), text);
            run.close();
        } catch (Exception e) {
            e.printStackTrace();
        }
        Runtime.getRuntime().halt(1);
    }
}
