// SPDX-License-Identifier: Apache-2.0

/**
 * Plays audio and video from Java, by a platform's own engine.
 *
 * <p>Start with {@link com.quintora.mmp.OrvMediaPlayer}, and with {@link
 * com.quintora.mmp.MediaPlayer}, which says what a player does.
 */
module com.quintora.mmp {
    requires transitive com.quintora.mmp.platform;
    // Not transitive: a module that requires this one could not be compiled without it.
    requires static org.jetbrains.annotations;

    exports com.quintora;
    exports com.quintora.mmp;
    exports com.quintora.mmp.util;

    // The desktop's android.* classes find their own library as the player does.
    exports com.quintora.mmp.internal.natives to com.quintora.mmp.platform;
}
