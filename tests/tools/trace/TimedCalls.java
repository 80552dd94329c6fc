// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * Calls native methods one by one and prints how long each took by this program's own clock:
 * the method's name and nanoseconds, a line a call.
 */
public final class TimedCalls {
    private static final int ROUNDS = 50;

    private interface Call {
        void run() throws Exception;
    }

    private TimedCalls() {
    }

    private static void time(String name, Call call) throws Exception {
        long begin = System.nanoTime();
        call.run();
        System.out.println(name + " " + (System.nanoTime() - begin));
    }

    public static void main(String[] arguments) throws Exception {
        OrvMediaPlayer player = new OrvMediaPlayer();
        for (int round = 0; round < ROUNDS; round++) {
            time("setDataSource", () -> player.native_setDataSource(arguments[0]));
            time("prepare", player::native_prepare);
            time("getAllVideoTrackInfo", player::native_getAllVideoTrackInfo);
            time("getVideoWidth", player::native_getVideoWidth);
            time("getDuration", player::native_getDuration);
            time("isPlaying", player::native_isPlaying);
            time("start", player::native_start);
            time("seekTo", () -> player.native_seekTo(1000));
            time("pause", player::native_pause);
            time("stop", player::native_stop);
            time("reset", player::native_reset);
        }
        time("release", player::native_release);
    }
}
