// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** Draws thumbnails of a film: a program with two arguments, the film and how many. */
final class Thumbnails {
    private Thumbnails() {}

    public static void main(String[] arguments) throws Exception {
        int count = Integer.parseInt(arguments[1]);
        try (OrvMediaPlayer player = new OrvMediaPlayer()) {
            player.setDataSource(arguments[0]);
            player.prepare();
            int duration = player.getDuration();
            for (int i = 0; i < count; i++) {
                player.seekTo(duration * i / count);
                player.pictures().thumbnail(320, 180, ColorMode.XRGB8888).orElseThrow();
            }
        }
    }
}
