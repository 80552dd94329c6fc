// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** Draws thumbnails of a film: a program whose arguments are the film and times in milliseconds. */
final class Thumbnails {
    private Thumbnails() {}

    public static void main(String[] arguments) throws Exception {
        try (OrvMediaPlayer player = new OrvMediaPlayer()) {
            player.setDataSource(arguments[0]);
            player.prepareAndWait();
            for (int i = 1; i < arguments.length; i++) {
                player.seekToAndWait(Integer.parseInt(arguments[i]));
                player.pictures().thumbnailAndWait(320, 180, ColorMode.XRGB8888).orElseThrow();
            }
        }
    }
}
