// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.sun.management.OperatingSystemMXBean;
import java.lang.management.ManagementFactory;
import java.util.ArrayList;
import java.util.List;

/**
 * Many players that do nothing: a program with two arguments, how many and for how many seconds.
 * Prints, a line each, the seconds that it took to make them, those of the processors that all of
 * them used afterwards, and the seconds that it took to release them.
 */
final class Players {
    private Players() {}

    public static void main(String[] arguments) throws InterruptedException {
        int count = Integer.parseInt(arguments[0]);
        new OrvMediaPlayer().close(); // Loads what the first one alone has to.
        List<OrvMediaPlayer> players = new ArrayList<>(count);
        long begin = System.nanoTime();
        for (int i = 0; i < count; i++) {
            players.add(new OrvMediaPlayer());
        }
        System.out.println((System.nanoTime() - begin) / 1e9);
        System.out.println(processorSecondsIn(Long.parseLong(arguments[1])));
        begin = System.nanoTime();
        players.forEach(OrvMediaPlayer::close);
        System.out.println((System.nanoTime() - begin) / 1e9);
    }

    private static double processorSecondsIn(long seconds) throws InterruptedException {
        var system =
                (OperatingSystemMXBean) ManagementFactory.getOperatingSystemMXBean();
        Thread.sleep(1000); // What was begun by making them ends.
        long before = system.getProcessCpuTime();
        Thread.sleep(1000 * seconds);
        return (system.getProcessCpuTime() - before) / 1e9;
    }
}
